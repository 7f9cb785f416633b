#pragma once
// The entry point every fuzz target defines, and the check its invariants go through. The
// same target source is linked either with libFuzzer (the `fuzz` preset) or with
// QelFuzzReplay.cpp, which runs given files through it once, so the seeds and reproducers
// are replayed by CTest in every build.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

// A broken invariant must stop the run where it happened, so the input is kept as a
// reproducer; a fuzzer only notices crashes.
inline void QelFuzzCheck(bool holds, const char* what) {
  if (holds) return;
  std::fprintf(stderr, "fuzz invariant broken: %s\n", what);
  std::abort();
}

// A private folder for the files a target writes, made once per process: in memory when
// the machine has /dev/shm, since a target syncs files on every input.
std::string QelFuzzScratchFolder();
