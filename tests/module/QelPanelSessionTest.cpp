// A whole review session with the plug-in loaded for real: the panel appears, twenty
// clicks go through its check boxes and radios, the editor closes and the plug-in is
// unloaded. Nothing may stay alive and nothing may wait for delayed destruction.
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDbrFraPanel.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelDlgNotify.h"
#include "QelIHyxFacetCtrl.h"
#include "QelModelBuilder.h"
#include "QelModuleLoader.h"
#include "QelSettingRepository.h"
#include "QelVidCtlCheckButton.h"

namespace {

void CollectButtons(QelVidWidget* w, std::vector<QelVidCtlCheckButton*>& buttons) {
  if (!w || !w->GetVisibleFlag()) return;
  if (auto* button = dynamic_cast<QelVidCtlCheckButton*>(w)) buttons.push_back(button);
  for (int i = 0; i < w->GetChildCount(); ++i) CollectButtons(w->GetChild(i), buttons);
}

TEST(QelPanelSession, TwentyClicksThenCloseAndUnloadLeaveNothingBehind) {
  const std::string folder = std::filesystem::temp_directory_path() / "qel-panel-session";
  std::filesystem::remove_all(folder);
  setenv("QEL_SETTINGS_DIR", folder.c_str(), 1);
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    std::string error;
    void* module = QelModuleLoader::Load(QEL_MODULE_PATH, error);
    ASSERT_NE(module, nullptr) << error;
    QelApplicationFrame::CreateFrame(QelString("LumReview"));
    QelSettingRepository::GetRepository("QelRovDataFiltering")->WriteSetting("DataFilteringPanel_LumReview", 1, 1);
    {
      QelModelBuilder builder;
      QelBaseUnknown_var part = builder.AddProduct(builder.Root(), {.alias = "Part"});
      QelBaseUnknown_var set = builder.AddSet(part, {.alias = "Set", .light = true});
      builder.AddAnnotation(set, {.alias = "Datum A", .typeName = "Datum", .subTypeName = "Simple Datum"});
      builder.AddSet(builder.Root(), {.alias = "Notes"});
      QelBaseUnknown_var root = builder.Finish();
      auto editor = QelMakeVar<QelFrmEditor>(root.get());
      auto path = QelMakeVar<QelPathElement>();
      path->AddChildElement(root.get());
      editor->SetUIActivePath(path.get());
      auto window = QelMakeVar<Qel3DWindow>(editor.get());
      window->SetViewer(QelMakeVar<Qel3DViewer>(80, 60).get());
      QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
      layout->AddWindow(window.get());
      layout->SetCurrentWindow(window.get());

      QelVar<QelIHyxFacetCtrl> controller = QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController");
      ASSERT_TRUE(controller);
      controller->CreateDataFilteringPanelIfNecessary();
      controller = nullptr;
      std::vector<QelDbrFraPanel*> panels = QelDbrFraPanel::PanelsInViewer(window->GetViewer().get());
      ASSERT_EQ(panels.size(), 1u);
      QelDbrFraPanel* panel = panels[0];

      for (int click = 0; click < 20; ++click) {
        QelDlgNotify::QueueAnswer(click % 4 == 0 ? QelDlgNotify::AnswerNo : QelDlgNotify::AnswerYes);
        std::vector<QelVidCtlCheckButton*> buttons;
        CollectButtons(panel->GetApplicativeWidget(), buttons);
        ASSERT_FALSE(buttons.empty());
        buttons[(click * 7) % buttons.size()]->Click();
        QelDelayedDestruction::FlushIdle();
      }
      QelDlgNotify::ClearAnswers();
      layout->CloseEditor(editor.get());
      window->SetViewer(nullptr);
    }
    QelModuleLoader::Unload(module);
    EXPECT_EQ(QelDelayedDestruction::PendingCount(), 0);
    QelApplicationFrame::DestroyFrame();
    QelSettingRepository::ForgetRepositories();
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
  std::filesystem::remove_all(folder);
}

}  // namespace
