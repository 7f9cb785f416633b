// Importing each NIST annotation test model, tessellation included, from the file to the
// finished model (the files are read where they are kept; see tests/stepimport).
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "QelStepImporter.h"

namespace {
void Import(benchmark::State& state, const std::string& path) {
  size_t count = 0;
  for (auto _ : state) {
    QelBaseUnknown_var root;
    std::string error;
    std::vector<std::string> notes;
    if (QelStepImporter::ImportFile(path, root, error, notes) != S_OK) {
      state.SkipWithError(error.c_str());
      return;
    }
    benchmark::DoNotOptimize(root.get());
    ++count;
  }
  state.counters["imports"] = static_cast<double>(count);
}
}  // namespace

BENCHMARK_CAPTURE(Import, CTC01, std::string(QEL_NIST_MODELS) + "/nist_ctc_01_asme1_ap242-e1.stp")
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Import, FTC06, std::string(QEL_NIST_MODELS) + "/nist_ftc_06_asme1_ap242-e2.stp")
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Import, STC06, std::string(QEL_NIST_MODELS) + "/nist_stc_06_asme1_ap242-e3.stp")
    ->Unit(benchmark::kMillisecond);
BENCHMARK_MAIN();
