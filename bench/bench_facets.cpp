// Cost of the facet model on large groups: one click on a check-box group (push down,
// apply every item, climb to the owner) and one RefreshCheckState pass reading every
// item's display. Both should grow linearly with the number of items.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "QelApplicationFrame.h"
#include "QelDlgNotify.h"
#include "QelFrmEditor.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacet.h"
#include "QelRovFacetGroup.h"
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

// The three facets of a facet group over a generated model: `count` annotations in 20
// sets, most of them of one type with 1000 sub-types (the case where finding a type row
// must not scan the rows), codes over the seven kinds, and 250 views and 250 captures.
class BenchFacetGroup final : public QelRovFacetGroup {
 public:
  using QelRovFacetGroup::QelRovFacetGroup;

 private:
  ~BenchFacetGroup() override = default;
};

struct FacetModel {
  explicit FacetModel(int count) {
    constexpr int kSets = 20;
    constexpr int kViews = 250;
    constexpr int kCodes[] = {3, 5, 6, 7, 8, 9, 13};
    QelModelBuilder builder;
    std::vector<QelBaseUnknown_var> sets;
    for (int s = 0; s < kSets; ++s) {
      QelModelProductDesc part;
      part.alias = "Part" + std::to_string(s);
      QelBaseUnknown_var owner = builder.AddProduct(builder.Root(), part);
      QelModelSetDesc desc;
      desc.alias = "Set" + std::to_string(s);
      desc.rootScope = s % 4 == 0 ? QelRootSetScope::Direct : QelRootSetScope::None;
      sets.push_back(builder.AddSet(owner, desc));
    }
    QelModelAnnotationDesc desc;
    for (int i = 0; i < count; ++i) {
      desc.alias = "A" + std::to_string(i);
      desc.typeName = i % 10 == 0 ? "Other" + std::to_string(i % 7) : "Tolerance";
      desc.subTypeName = "Sub" + std::to_string(i % 1000);
      desc.typeCode = kCodes[i % 7];
      desc.geometry = desc.typeCode == 13;
      desc.isDefault = i % 3 == 0;
      builder.AddAnnotation(sets[static_cast<size_t>(i % kSets)], desc);
    }
    for (int v = 0; v < kViews; ++v) {
      QelModelViewDesc view;
      view.alias = "V" + std::to_string(v);
      QelBaseUnknown_var made = builder.AddView(sets[static_cast<size_t>(v % kSets)], view);
      QelModelCaptureDesc capture;
      capture.alias = "C" + std::to_string(v);
      capture.view = made.get();
      builder.AddCapture(sets[static_cast<size_t>(v % kSets)], capture);
    }
    root = builder.Finish();
    QelApplicationFrame::CreateFrame();
    editor = QelMakeVar<QelFrmEditor>(root.get());
    group = QelMakeVar<BenchFacetGroup>(editor.get());
    group->InitFacets();
    QelListValQelBaseUnknown_var list;
    group->ListFacets(list);
    for (const auto& facet : list) facets.push_back(QelVar<QelRovFacet>(facet.get()));
  }
  QelRovFacet* Facet(int index) { return facets[static_cast<size_t>(index)].get(); }
  QelRovFacetProperty* Property(int facet, int position) {
    QelListValQelBaseUnknown_var properties;
    Facet(facet)->GetProperties(properties);
    return QelSysDynamicCast<QelRovFacetProperty>(properties[position].get());
  }

  QelBaseUnknown_var root;
  QelVar<QelFrmEditor> editor;
  QelVar<BenchFacetGroup> group;
  std::vector<QelVar<QelRovFacet>> facets;  // sets, views, types
};

enum { kSetFacet, kViewFacet, kTypeFacet };

void BM_FacetRefresh(benchmark::State& state) {
  FacetModel model(static_cast<int>(state.range(1)));
  QelRovFacet* facet = model.Facet(static_cast<int>(state.range(0)));
  for (auto _ : state) facet->Refresh();
  state.SetComplexityN(state.range(1));
}
BENCHMARK(BM_FacetRefresh)->ArgNames({"facet", "annotations"})->ArgsProduct({{kSetFacet, kViewFacet, kTypeFacet}, {1000, 10000, 100000}})
    ->Unit(benchmark::kMillisecond);

// A tick of "all" on each facet, with what the group refreshes after it. The choice is
// unset between ticks by a plain state assignment, outside the timing.
void BM_TickAll(benchmark::State& state) {
  FacetModel model(static_cast<int>(state.range(1)));
  QelRovFacetProperty* all = model.Property(static_cast<int>(state.range(0)), 1);
  for (auto _ : state) {
    state.PauseTiming();
    all->SetCheckState(Unchecked);
    QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
    state.ResumeTiming();
    benchmark::DoNotOptimize(all->SetCheck(true));
  }
  QelDlgNotify::ClearAnswers();
  state.SetComplexityN(state.range(1));
}
BENCHMARK(BM_TickAll)->ArgNames({"facet", "annotations"})->ArgsProduct({{kSetFacet, kViewFacet, kTypeFacet}, {10000, 100000}})
    ->Unit(benchmark::kMillisecond);

// Unticking and ticking the Datums kind group in turn.
void BM_TickKindGroup(benchmark::State& state) {
  FacetModel model(static_cast<int>(state.range(0)));
  auto* custom = QelSysDynamicCast<QelRovFacetPropertyGroup>(model.Property(kTypeFacet, 3));
  auto* datums = QelSysDynamicCast<QelRovFacetProperty>(custom->GetPropertyList()[1].get());
  bool checked = false;
  for (auto _ : state) {
    benchmark::DoNotOptimize(datums->SetCheck(checked));
    checked = !checked;
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_TickKindGroup)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
