// The main of the benchmarks that build panels: the heap is kept as qelhost keeps it, so
// a section's freed memory stays for the next build instead of being faulted in again.
#include <benchmark/benchmark.h>

#include "QelSysHeap.h"

int main(int argc, char** argv) {
  QelSysKeepFreedHeap();
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  return 0;
}
