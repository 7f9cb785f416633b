// The controller's rules: which stored values switch the panel on for which caller, the
// three workbenches, the close button's route through the repository's notification, the
// retry while no window can take the panel, and one group per editor.
#include "PanelFixture.h"

#include "Qel2DLWindow.h"
#include "QelAssert.h"
#include "QelCallbackManager.h"
#include "QelDbrFraPanel.h"
#include "QelDelayedDestruction.h"
#include "QelFrmContext.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetServices.h"

namespace {
using ControllerTest = PanelFixture;

TEST_F(ControllerTest, SettingValuesAndWorkbenchesDecideThePanel) {
  QelRovFacetController* ctrl = Controller();
  ASSERT_NE(ctrl, nullptr);
  // Absent key: off.
  EXPECT_EQ(ctrl->ReadDataFilteringPanelSetting(QelString("LumReview")), 0);
  ctrl->CreateDataFilteringPanelIfNecessary();
  EXPECT_EQ(ctrl->GetGroupCount(), 0);

  // 2 is off for the explicit request, on for a window activation.
  WriteSetting("LumReview", 2, true);
  ctrl->CreateDataFilteringPanelIfNecessary();
  EXPECT_FALSE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  ctrl->OnWindowActivated();
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));

  // A fourth workbench never has the panel, whatever its key holds: entering it closes
  // the panel and keeps the group; the explicit request then drops the group.
  WriteSetting("Sketcher", 1, true);
  EXPECT_EQ(ctrl->ReadDataFilteringPanelSetting(QelString("Sketcher")), 0);
  QelFrmContext::GetContext()->SwitchWorkbench(QelString("Sketcher"));
  EXPECT_FALSE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  EXPECT_EQ(ctrl->GetGroupCount(), 1);
  // Coming back to a workbench that has the panel switched on brings it back.
  WriteSetting("TPSCfg", 1, true);
  QelFrmContext::GetContext()->SwitchWorkbench(QelString("TPSCfg"));
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  QelFrmContext::GetContext()->SwitchWorkbench(QelString("Sketcher"));
  ctrl->CreateDataFilteringPanelIfNecessary();
  EXPECT_EQ(ctrl->GetGroupCount(), 0);

  // Without a group, entering a panel workbench whose key holds 1 builds group and panel.
  QelFrmContext::GetContext()->SwitchWorkbench(QelString("TPSCfg"));
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
}

TEST_F(ControllerTest, NoControllerWhileTheRefinementSwitchIsOff) {
  QelRovFacetServices::SetRefinementDevActive(false);
  EXPECT_EQ(Controller(), nullptr);
  QelRovFacetServices::SetRefinementDevActive(true);
  EXPECT_NE(Controller(), nullptr);
}

TEST_F(ControllerTest, CloseWritesZeroSavesAndLeavesTheRemovalToTheNotification) {
  QelRovFacetController* ctrl = Controller();
  WriteSetting("LumReview", 1);  // the notification builds the panel
  ASSERT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  ASSERT_EQ(QelDbrFraPanel::PanelsInViewer(window->GetViewer().get()).size(), 1u);

  // Without the controller's subscription to the repository, closing only writes.
  QelCallbackManager::Get().RemoveCallbacksOn(repository, ctrl, kQelRepositoryModified);
  ctrl->CloseDataFilteringPanel();
  int value = -1;
  repository->ReadSetting("DataFilteringPanel_LumReview", value);
  EXPECT_EQ(value, 0);
  EXPECT_FALSE(repository->IsModified());
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));

  // With it, the repository's notification takes the panel away.
  QelCallbackManager::Get().AddCallback(repository, kQelRepositoryModified, ctrl,
                                        [ctrl](QelBaseUnknown*, QelBaseUnknown* n) { ctrl->OnSettingModified(n); });
  ctrl->CloseDataFilteringPanel();
  EXPECT_FALSE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  EXPECT_TRUE(QelDbrFraPanel::PanelsInViewer(window->GetViewer().get()).empty());
  EXPECT_GT(QelDelayedDestruction::PendingCount(), 0);
}

TEST_F(ControllerTest, WindowActivationRetriesUntilAPanelIsPlaced) {
  QelRovFacetController* ctrl = Controller();
  WriteSetting("LumReview", 1, true);
  auto second = OpenEditor();
  OpenWindow<Qel2DLWindow>(second.get());
  ctrl->CreateDataFilteringPanelIfNecessary();
  EXPECT_FALSE(ctrl->IsDataFilteringPanelInitialized(second.get()));
  EXPECT_TRUE(ctrl->IsWaitingForWindow());

  auto second3d = OpenWindow<Qel3DWindow>(second.get());  // activation: the retry places it
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(second.get()));
  EXPECT_FALSE(ctrl->IsWaitingForWindow());
  EXPECT_EQ(QelDbrFraPanel::PanelsInViewer(second3d->GetViewer().get()).size(), 1u);

  // An editor with nothing UI-active gets no group, and the retry ends.
  auto idle = OpenEditor(false);
  OpenWindow<Qel2DLWindow>(idle.get());
  ctrl->CreateDataFilteringPanelIfNecessary();
  EXPECT_EQ(ctrl->GiveExistingFacetGroupOfEditor(idle.get()), nullptr);
  EXPECT_FALSE(ctrl->IsWaitingForWindow());
}

TEST_F(ControllerTest, ClosingOneEditorOfTwoDropsOnlyItsGroupAndHideRestoreKeepThePanel) {
  QelRovFacetController* ctrl = Controller();
  WriteSetting("LumReview", 1, true);
  ctrl->CreateDataFilteringPanelIfNecessary();
  auto second = OpenEditor();
  OpenWindow<Qel3DWindow>(second.get());
  ctrl->CreateDataFilteringPanelIfNecessary();
  ASSERT_EQ(ctrl->GetGroupCount(), 2);

  QelRovFacetGroup* first = ctrl->GiveExistingFacetGroupOfEditor(editor.get());
  QelDbrFraPanel* panel = first->GetPanel();
  EXPECT_EQ(QelRovFacetController::HideDataFilteringPanel(editor.get()), S_OK);
  EXPECT_EQ(panel->GetVisibleFlag(), 0);
  EXPECT_EQ(QelRovFacetController::RestoreDataFilteringPanel(editor.get()), S_OK);
  EXPECT_EQ(first->GetPanel(), panel);
  EXPECT_EQ(panel->GetVisibleFlag(), 1);

  layout->CloseEditor(second.get());
  EXPECT_EQ(ctrl->GetGroupCount(), 1);
  EXPECT_EQ(ctrl->GiveExistingFacetGroupOfEditor(editor.get()), first);
  EXPECT_TRUE(ctrl->IsDataFilteringPanelInitialized(editor.get()));
  EXPECT_EQ(QelRovFacetController::HideDataFilteringPanel(second.get()), S_FALSE);
}
}  // namespace
