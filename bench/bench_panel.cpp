// The road of one click on the data filtering panel, on generated models of 1k, 10k and
// 100k annotations: the click on the "Default annotations only" box goes through SetCheck,
// the display requests over every annotation of the visible sets, the refresh of the view
// facet and the dialog's rebuild. The panel is made as a host makes it, through the
// controller component. A last run counts live objects before and after 1,000 clicks.
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <filesystem>
#include <string>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDbrFraPanel.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelIHyxFacetCtrl.h"
#include "QelModelGenerator.h"
#include "QelModelLoader.h"
#include "QelSettingRepository.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlFrame.h"

// The module is linked, not loaded: naming one of its symbols keeps the linker from
// dropping it, and with it the registration of the controller component.
extern "C" const char* QelRovFacetsModuleName();

namespace {

// One editor of a generated model in a 3D window, with its panel shown.
struct PanelHost {
  explicit PanelHost(int annotations) {
    benchmark::DoNotOptimize(QelRovFacetsModuleName());
    const std::string folder = std::filesystem::temp_directory_path() / "qel-bench-panel";
    setenv("QEL_SETTINGS_DIR", folder.c_str(), 1);
    QelApplicationFrame::CreateFrame(QelString("LumReview"));
    QelSettingRepository::GetRepository("QelRovDataFiltering")->WriteSetting("DataFilteringPanel_LumReview", 1, 1);
    std::string error;
    QelModelLoader::LoadText(QelModelGenerator::MakeModelText(annotations), "generated", root, error);
    editor = QelMakeVar<QelFrmEditor>(root.get());
    auto path = QelMakeVar<QelPathElement>();
    path->AddChildElement(root.get());
    editor->SetUIActivePath(path.get());
    window = QelMakeVar<Qel3DWindow>(editor.get());
    window->SetViewer(QelMakeVar<Qel3DViewer>(80, 60).get());
    QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
    layout->AddWindow(window.get());
    layout->SetCurrentWindow(window.get());
    QelVar<QelIHyxFacetCtrl> controller = QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController");
    if (controller) controller->CreateDataFilteringPanelIfNecessary();
  }
  ~PanelHost() {
    QelFrmLayout::GetCurrentLayout()->CloseEditor(editor.get());
    window->SetViewer(nullptr);
    QelDelayedDestruction::FlushIdle();
  }

  // The box of the "Default annotations only" row of the panel as it is now, or null.
  QelVidCtlCheckButton* DefaultOnlyBox() const {
    std::vector<QelDbrFraPanel*> panels = QelDbrFraPanel::PanelsInViewer(window->GetViewer().get());
    if (panels.empty()) return nullptr;
    return Find(panels[0]->GetApplicativeWidget());
  }
  static QelVidCtlCheckButton* Find(QelVidWidget* w) {
    auto* frame = dynamic_cast<QelVidCtlFrame*>(w);
    if (frame && frame->IsRow())
      if (QelVidWidget* label = frame->FindDescendant("PropertyLabel");
          label && label->TextAttribute("text").Utf8() == "Default annotations only")
        return dynamic_cast<QelVidCtlCheckButton*>(frame->FindDescendant("CheckBox"));
    for (int i = 0; w && i < w->GetChildCount(); ++i)
      if (QelVidCtlCheckButton* found = Find(w->GetChild(i))) return found;
    return nullptr;
  }

  QelBaseUnknown_var root;
  QelVar<QelFrmEditor> editor;
  QelVar<Qel3DWindow> window;
};

void BM_PanelClick(benchmark::State& state) {
  PanelHost host(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    state.PauseTiming();
    QelVidCtlCheckButton* box = host.DefaultOnlyBox();
    if (!box) {
      state.ResumeTiming();
      state.SkipWithError("no panel");
      break;
    }
    state.ResumeTiming();
    box->Click();
    state.PauseTiming();
    QelDelayedDestruction::FlushIdle();
    state.ResumeTiming();
  }
  state.SetComplexityN(state.range(0));
}
// Two seconds per size: the first rebuilds at 100k pay first-touch page faults on fresh heap,
// which a person's later clicks do not.
BENCHMARK(BM_PanelClick)->Arg(1000)->Arg(10000)->Arg(100000)->MinTime(2.0)->Unit(benchmark::kMillisecond)->Complexity();

void BM_PanelLiveObjectsAfter1000Clicks(benchmark::State& state) {
  for (auto _ : state) {
    PanelHost host(1000);
    host.DefaultOnlyBox()->Click();  // first-use statics (events, tables) made before counting
    host.DefaultOnlyBox()->Click();
    QelDelayedDestruction::FlushIdle();
    const int64_t before = QelBaseUnknown::LiveObjectCount();
    for (int i = 0; i < 1000; ++i) {
      host.DefaultOnlyBox()->Click();
      QelDelayedDestruction::FlushIdle();
    }
    state.counters["live_delta"] = static_cast<double>(QelBaseUnknown::LiveObjectCount() - before);
    if (QelBaseUnknown::LiveObjectCount() != before) state.SkipWithError("live objects grew over 1,000 clicks");
  }
}
BENCHMARK(BM_PanelLiveObjectsAfter1000Clicks)->Iterations(1)->Unit(benchmark::kMillisecond);

}  // namespace

