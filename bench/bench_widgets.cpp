// Cost of the panel widgets on a large facet, for what a person waits on: building the
// property widgets of a facet (one styled row per property, its bindings evaluated) as
// the panel opens, letting them go as it closes, and one click on a row, which changes
// the property and makes the panel build its section again. All should grow linearly;
// the target is under 20 ms at 10k properties.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "QelDictionary.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacet.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovRefinementFacet.h"
#include "QelRovRefinementProperty.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelTie.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidLayGrid.h"

namespace {
class BenchFacet final : public QelRovFacet {
 public:
  static const QelMetaObject& MetaObject() {
    static const QelMetaObject& meta =
        QelMetaObject::Declare("BenchFacet", QelMetaKind::Implementation, &QelRovFacet::MetaObject(), "bench");
    return meta;
  }
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  explicit BenchFacet(int count) : QelRovFacet(nullptr) {
    SetFacetName(QelUnicodeString("Items"));
    for (int i = 0; i < count; ++i) {
      auto item = QelMakeVar<QelRovFacetPropertyItem>(QelUnicodeString("Item " + std::to_string(i)), this);
      PropertyList().Append(item.get());
    }
  }
  void Refresh() override {}
  HRESULT ApplyPropertyChange(QelBaseUnknown*) override { return S_FALSE; }

 private:
  ~BenchFacet() override = default;
};

class TieObserverBenchFacet final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* p, QelCheckState s) override {
    return Impl<BenchFacet>()->CanChangeCheckState(p, s);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* p) override { return Impl<BenchFacet>()->OnPropertyChanged(p); }

 private:
  ~TieObserverBenchFacet() override = default;
};

const bool registered = [] {
  QelDictionary::Get().Register("BenchFacet", QelIRovFacetPropertyObserver::IID, &QelCreateTie<TieObserverBenchFacet>,
                                "bench");
  return true;
}();

// The dialog's part: rebuilds the facet widget on every SendFacetEvent.
class BenchPanel final : public QelVidWidget {
 public:
  explicit BenchPanel(QelBaseUnknown* facet) : QelVidWidget(nullptr, QelString("Panel")), facet_(facet) {
    grid_ = QelMakeVar<QelVidLayGrid>(this, QelString("DialogGrid"));
    AddChild(grid_.get());
  }
  void Rebuild() {
    while (grid_->GetChildCount() > 0) grid_->RemoveWidget(grid_->GetChild(0));
    auto widget = QelMakeVar<QelRovRefinementFacet>(this, QelString("Facet0"), facet_.get());
    widget->BuildPropertyWidgets();
    QelSYPWRefMethEventHandler<BenchPanel>::Connect(widget.get(), QelRovRefinementFacet::SendFacetEvent(), this,
                                                    &BenchPanel::OnFacetEvent);
    grid_->AddWidget(widget.get(), {0, 0, 1, 1, 1, 1, 1, 0});
    facetWidget_ = widget.get();
  }
  void OnFacetEvent(QelBaseUnknown*, QelSYPEventArgs*) { Rebuild(); }
  QelVidCtlCheckButton* FirstBox() const {
    auto* row = dynamic_cast<QelRovRefinementProperty*>(facetWidget_->GetGrid()->GetWidgetsInRow(0).at(0));
    return dynamic_cast<QelVidCtlCheckButton*>(row->RetrieveSypNamedObject(QelString("CheckBox")));
  }

 private:
  ~BenchPanel() override = default;
  QelBaseUnknown_var facet_;
  QelVar<QelVidLayGrid> grid_;
  QelRovRefinementFacet* facetWidget_ = nullptr;
};

// A new section built from nothing, as when the panel opens; letting it go is timed apart.
void BM_BuildPropertyWidgets(benchmark::State& state) {
  const int count = static_cast<int>(state.range(0));
  auto facet = QelMakeVar<BenchFacet>(count);
  for (auto _ : state) {
    auto widget = QelMakeVar<QelRovRefinementFacet>(nullptr, QelString("Facet0"), facet.get());
    benchmark::DoNotOptimize(widget->BuildPropertyWidgets());
    state.PauseTiming();
    widget = nullptr;
    state.ResumeTiming();
  }
  state.SetComplexityN(count);
}
BENCHMARK(BM_BuildPropertyWidgets)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond)->Complexity(benchmark::oN);

// Letting a built section go, as when the panel closes.
void BM_ReleasePropertyWidgets(benchmark::State& state) {
  const int count = static_cast<int>(state.range(0));
  auto facet = QelMakeVar<BenchFacet>(count);
  for (auto _ : state) {
    state.PauseTiming();
    auto widget = QelMakeVar<QelRovRefinementFacet>(nullptr, QelString("Facet0"), facet.get());
    widget->BuildPropertyWidgets();
    state.ResumeTiming();
    widget = nullptr;
  }
  state.SetComplexityN(count);
}
BENCHMARK(BM_ReleasePropertyWidgets)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond)->Complexity(benchmark::oN);

void BM_RebuildAfterClick(benchmark::State& state) {
  const int count = static_cast<int>(state.range(0));
  auto facet = QelMakeVar<BenchFacet>(count);
  auto panel = QelMakeVar<BenchPanel>(facet.get());
  panel->Rebuild();
  for (auto _ : state) benchmark::DoNotOptimize(panel->FirstBox()->Click());
  state.SetComplexityN(count);
}
BENCHMARK(BM_RebuildAfterClick)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond)->Complexity(benchmark::oN);
}  // namespace
