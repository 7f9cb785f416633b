// Load time of generated models and a full display pass over their annotations
// (ListAnnotationsOfVisibleSets + EnableDisableDisplay with filter data).
#include <benchmark/benchmark.h>

#include <stdexcept>

#include "QelModelGenerator.h"
#include "QelModelLoader.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"

namespace {
void BM_LoadModel(benchmark::State& state) {
  const std::string text = QelModelGenerator::MakeModelText(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    QelBaseUnknown_var root;
    std::string error;
    if (QelModelLoader::LoadText(text, "generated.json", root, error) != S_OK) state.SkipWithError(error.c_str());
    benchmark::DoNotOptimize(root.get());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_EnablePass(benchmark::State& state) {
  QelBaseUnknown_var root;
  std::string error;
  QelModelLoader::LoadText(QelModelGenerator::MakeModelText(static_cast<int>(state.range(0))), "generated.json", root,
                           error);
  auto filter = QelMakeVar<QelRovFacetFilterData>();
  filter->TolAnnot = true;
  double high = 0.5;
  filter->SetToleranceValues(QelPropertyOperatorGreater, nullptr, QelPropertyOperatorLessOrEqual, &high);
  for (auto _ : state) {
    QelListValQelBaseUnknown_var annotations;
    QelRovFacetServices::ListAnnotationsOfVisibleSets(root.get(), annotations);
    QelRovFacetServices::EnableDisableDisplay(annotations, 1, filter.get());
    benchmark::DoNotOptimize(annotations.Size());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
}  // namespace

BENCHMARK(BM_LoadModel)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_EnablePass)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);

BENCHMARK_MAIN();
