// The group's panel: which window takes it, what it is made with, hiding and showing it
// without losing its state, and a close followed by a new panel over refreshed facets.
#include "PanelFixture.h"

#include "Qel2DLWindow.h"
#include "QelDbrFraPanel.h"
#include "QelDftWindow.h"
#include "QelRovFacet.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetProperty.h"
#include "QelRovFacetServices.h"
#include "QelRovRefinementDlg.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidWidgetPrinter.h"

namespace {
using GroupPanelTest = PanelFixture;

// The check state of the first property whose label holds `label`, anywhere under the facet.
QelCheckState StateOf(QelRovFacet* facet, const std::string& label) {
  std::vector<QelBaseUnknown_var> todo;
  QelListValQelBaseUnknown_var list;
  facet->GetProperties(list);
  for (const auto& p : list) todo.push_back(p);
  while (!todo.empty()) {
    auto* property = QelSysDynamicCast<QelRovFacetProperty>(todo.back().get());
    QelBaseUnknown_var hold = todo.back();
    todo.pop_back();
    if (!property) continue;
    QelUnicodeString name;
    property->GetName(name);
    if (name.Utf8().find(label) != std::string::npos) return property->GetCheckState();
    QelListValQelBaseUnknown_var children;
    if (property->GetChildren(children) == S_OK)
      for (const auto& c : children) todo.push_back(c);
  }
  return static_cast<QelCheckState>(-1);
}

TEST_F(GroupPanelTest, CreatePanelChoosesTheWindowAndBuildsOnce) {
  QelRovFacetGroup* group = Controller()->InitFacetGroupOfEditor(editor.get());
  ASSERT_NE(group, nullptr);

  // From a 2D layout window the panel goes into the editor's 3D window.
  OpenWindow<Qel2DLWindow>(editor.get());
  ASSERT_EQ(group->CreatePanel(), S_OK);
  QelDbrFraPanel* panel = group->GetPanel();
  ASSERT_TRUE(panel && group->GetDialog());
  EXPECT_EQ(QelDbrFraPanel::PanelsInViewer(window->GetViewer().get()), std::vector<QelDbrFraPanel*>{panel});
  EXPECT_EQ(panel->GetTitle().Utf8(), "Data Filtering");
  EXPECT_EQ(panel->GetIconName().Utf8(), "I_Hyq_DataFilteringCmd");
  EXPECT_EQ(panel->GetCloseButtonFlag(), 0);
  EXPECT_EQ(panel->GetMinimizeButtonFlag(), 1);
  EXPECT_EQ(panel->GetAllowedDockAreas(), 0x18);
  EXPECT_EQ(panel->GetDefaultButton(), static_cast<QelVidWidget*>(group->GetDialog()->GetCloseButton()));
  EXPECT_EQ(panel->GetApplicativeWidget(), static_cast<QelVidWidget*>(group->GetDialog()));

  EXPECT_EQ(group->CreatePanel(), S_FALSE);
  EXPECT_EQ(group->GetPanel(), panel);

  // Another editor: from its 2D layout window alone nothing is built; from a drafting
  // window the answer says so.
  auto other = OpenEditor();
  QelRovFacetGroup* otherGroup = Controller()->InitFacetGroupOfEditor(other.get());
  OpenWindow<Qel2DLWindow>(other.get());
  EXPECT_EQ(otherGroup->CreatePanel(), S_FALSE);
  OpenWindow<QelDftWindow>(other.get());
  EXPECT_EQ(otherGroup->CreatePanel(), QelRovFacetGroup::kDraftingWindow);
  EXPECT_FALSE(otherGroup->IsPanelInitialized());
}

TEST_F(GroupPanelTest, HidingKeepsTheDialogAndClosingThenCreatingRefreshesTheFacets) {
  QelRovFacetGroup* group = Controller()->InitFacetGroupOfEditor(editor.get());
  ASSERT_EQ(group->CreatePanel(), S_OK);
  QelRovRefinementDlg* dialog = group->GetDialog();
  dialog->GetScrollableArea()->SetVScrollOffset(40);
  const std::string before = QelVidPrintText(dialog);

  group->ShowPanel(false);
  EXPECT_EQ(group->GetPanel()->GetVisibleFlag(), 0);
  group->ShowPanel(true);
  EXPECT_EQ(group->GetDialog(), dialog);
  EXPECT_EQ(dialog->GetScrollableArea()->GetVScrollOffset(), 40);
  EXPECT_EQ(QelVidPrintText(dialog), before);

  QelListValQelBaseUnknown_var facets;
  group->ListFacets(facets);
  auto* sets = QelSysDynamicCast<QelRovFacet>(facets[1].get());
  ASSERT_EQ(StateOf(sets, "SetA"), Checked);
  // A change made behind the panel's back shows once the panel is made again.
  QelRovFacetServices::EnableDisableDisplay(setA.get(), 0, nullptr);
  QelVar<QelDbrFraPanel> old = QelVar<QelDbrFraPanel>::Retain(group->GetPanel());
  group->ClosePanel();
  EXPECT_TRUE(old->IsDestructionRequested());
  EXPECT_EQ(old->GetVisibleFlag(), 0);
  EXPECT_FALSE(group->IsPanelInitialized());
  EXPECT_EQ(group->CreatePanel(), S_OK);
  EXPECT_NE(group->GetPanel(), old.get());
  EXPECT_EQ(StateOf(sets, "SetA"), Unchecked);
}
}  // namespace
