// Cost of the facet model on large groups: one click on a check-box group (push down,
// apply every item, climb to the owner) and one RefreshCheckState pass reading every
// item's display. Both should grow linearly with the number of items.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "QelIRovFacetPropertyObserver.h"
#include "QelModelBuilder.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetPropertyItemCustomAnnot.h"

namespace {

class SilentObserver : public QelIRovFacetPropertyObserver {
 public:
  HRESULT CanChangeCheckState(QelBaseUnknown*, QelCheckState) override { return S_OK; }
  HRESULT OnPropertyChanged(QelBaseUnknown*) override { return S_OK; }

 protected:
  ~SilentObserver() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<QelIRovFacetPropertyObserver>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }
};

// A model with one set of `count` annotations, and a check-box group holding one
// annotation item per annotation.
struct AnnotationGroup {
  explicit AnnotationGroup(int count) {
    QelModelBuilder builder;
    QelModelSetDesc setDesc;
    setDesc.alias = "Set";
    QelBaseUnknown_var set = builder.AddSet(builder.Root(), setDesc);
    std::vector<QelBaseUnknown_var> annotations;
    annotations.reserve(count);
    QelModelAnnotationDesc desc;
    desc.typeName = "Tol";
    for (int i = 0; i < count; ++i) {
      desc.alias = std::to_string(i);
      annotations.push_back(builder.AddAnnotation(set, desc));
    }
    root = builder.Finish();
    owner = QelMakeVar<SilentObserver>();
    filter = QelMakeVar<QelRovFacetFilterData>();
    group = QelMakeVar<QelRovFacetPropertyGroup>(QelUnicodeString("Tol"), QelUnicodeString(), owner.get(), false);
    for (auto& annotation : annotations) {
      auto item = QelMakeVar<QelRovFacetPropertyItemCustomAnnot>(annotation.get(), filter.get(), group.get());
      group->AddProperty(item.get());
    }
    group->UpdateCheckStateFromChildren();
  }
  QelBaseUnknown_var root;
  QelVar<SilentObserver> owner;
  QelVar<QelRovFacetFilterData> filter;
  QelVar<QelRovFacetPropertyGroup> group;
};

void BM_ClickCheckBoxGroup(benchmark::State& state) {
  AnnotationGroup model(static_cast<int>(state.range(0)));
  bool checked = false;
  for (auto _ : state) {
    benchmark::DoNotOptimize(model.group->SetCheck(checked));
    checked = !checked;
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_ClickCheckBoxGroup)->RangeMultiplier(10)->Range(1000, 100000)->Complexity(benchmark::oN)
    ->Unit(benchmark::kMillisecond);

// The model's own share of a click: items without an object apply nothing.
void BM_ClickCheckBoxGroupPlainItems(benchmark::State& state) {
  auto owner = QelMakeVar<SilentObserver>();
  auto group = QelMakeVar<QelRovFacetPropertyGroup>(QelUnicodeString("g"), QelUnicodeString(), owner.get(), false);
  for (int64_t i = 0; i < state.range(0); ++i)
    group->AddProperty(QelMakeVar<QelRovFacetPropertyItem>("i", group.get()).get());
  bool checked = true;
  for (auto _ : state) {
    benchmark::DoNotOptimize(group->SetCheck(checked));
    checked = !checked;
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_ClickCheckBoxGroupPlainItems)->RangeMultiplier(10)->Range(1000, 100000)->Complexity(benchmark::oN)
    ->Unit(benchmark::kMillisecond);

void BM_RefreshCheckState(benchmark::State& state) {
  AnnotationGroup model(static_cast<int>(state.range(0)));
  for (auto _ : state) benchmark::DoNotOptimize(model.group->RefreshCheckState());
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_RefreshCheckState)->RangeMultiplier(10)->Range(1000, 100000)->Complexity(benchmark::oN)
    ->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
