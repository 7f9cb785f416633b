// Peak memory of loading a model file, for docs/model-memory.md. Not a benchmark of
// speed (bench_annotations is): it loads once and reports the peak resident set.
//   measure_model_load generate <annotations> <file>   writes a generated model
//   measure_model_load load <file>                     loads it and prints the figures
#include <malloc.h>
#include <sys/resource.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>

#include "QelModelGenerator.h"
#include "QelModelLoader.h"

namespace {
long PeakKiB() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  return usage.ru_maxrss;
}

// Resident now, after giving freed heap back, so that what remains is the model's.
long ResidentKiB() {
  malloc_trim(0);
  long pages = 0, resident = 0;
  if (std::FILE* statm = std::fopen("/proc/self/statm", "r")) {
    if (std::fscanf(statm, "%ld %ld", &pages, &resident) != 2) resident = 0;
    std::fclose(statm);
  }
  return resident * (sysconf(_SC_PAGESIZE) / 1024);
}
}  // namespace

int main(int argc, char** argv) {
  const std::string action = argc > 1 ? argv[1] : "";
  if (action == "generate" && argc == 4) {
    std::ofstream out(argv[3], std::ios::binary);
    out << QelModelGenerator::MakeModelText(std::atoi(argv[2]));
    return out ? 0 : 1;
  }
  if (action == "load" && argc == 3) {
    const long before = PeakKiB();
    const auto start = std::chrono::steady_clock::now();
    QelBaseUnknown_var root;
    std::string error;
    if (QelModelLoader::LoadFile(argv[2], root, error) != S_OK) {
      std::fprintf(stderr, "%s\n", error.c_str());
      return 1;
    }
    const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    const long loaded = PeakKiB();
    std::printf("load %.2f s, peak resident %ld KiB (at start %ld KiB), the model alone %ld KiB\n", seconds, loaded,
                before, ResidentKiB());
    return 0;
  }
  std::fprintf(stderr, "usage: measure_model_load generate <annotations> <file> | load <file>\n");
  return 2;
}
