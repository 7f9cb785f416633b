#include "PanelFixture.h"

#include <cstdlib>
#include <filesystem>

#include "Qel3DViewer.h"
#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelModelBuilder.h"
#include "QelRovFacetServices.h"

void PanelFixture::SetUp() {
  folder = std::filesystem::temp_directory_path() /
           ("qel-panel-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
  std::filesystem::remove_all(folder);
  setenv("QEL_SETTINGS_DIR", folder.c_str(), 1);
  QelSettingRepository::ForgetRepositories();
  QelRovFacetServices::SetRefinementDevActive(true);
  QelApplicationFrame::CreateFrame(QelString("LumReview"));
  layout = QelFrmLayout::GetCurrentLayout();
  repository = QelSettingRepository::GetRepository("QelRovDataFiltering");

  QelModelBuilder builder;
  partA = builder.AddProduct(builder.Root(), {.alias = "PartA"});
  QelBaseUnknown_var partB = builder.AddProduct(builder.Root(), {.alias = "PartB"});
  setA = builder.AddSet(partA, {.alias = "SetA"});
  builder.AddSet(partB, {.alias = "SetB"});
  root = builder.Finish();
  editor = OpenEditor();
  window = OpenWindow<Qel3DWindow>(editor.get());
}

void PanelFixture::TearDown() {
  controller = nullptr;
  QelRovFacetController::ReleaseAtUnload();
  window = nullptr;
  editor = nullptr;
  QelApplicationFrame::DestroyFrame();
  while (QelDelayedDestruction::PendingCount() > 0) QelDelayedDestruction::FlushIdle();
  QelSettingRepository::ForgetRepositories();
  std::filesystem::remove_all(folder);
}

QelVar<QelFrmEditor> PanelFixture::OpenEditor(bool active) {
  auto opened = QelMakeVar<QelFrmEditor>(root.get());
  if (active) {
    auto path = QelMakeVar<QelPathElement>();
    path->AddChildElement(root.get());
    opened->SetUIActivePath(path.get());
  }
  return opened;
}

QelBaseUnknown_var PanelFixture::NewViewer() {
  return QelBaseUnknown_var::Retain(static_cast<QelBaseUnknown*>(QelMakeVar<Qel3DViewer>(80, 60).get()));
}

QelRovFacetController* PanelFixture::Controller() {
  if (!controller) {
    void* out = nullptr;
    if (QelInstantiateComponent("QelRovFacetController", QelIHyxFacetCtrl::IID, &out) == S_OK)
      controller = QelBaseUnknown_var::Adopt(static_cast<QelIHyxFacetCtrl*>(out));
  }
  return QelSysDynamicCast<QelRovFacetController>(controller.get());
}

void PanelFixture::WriteSetting(const char* workbench, int value, bool silent) {
  repository->WriteSetting(("DataFilteringPanel_" + std::string(workbench)).c_str(), value, silent ? 1 : 0);
}
