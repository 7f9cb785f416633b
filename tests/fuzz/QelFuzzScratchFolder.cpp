#include <stdlib.h>
#include <unistd.h>

#include <filesystem>

#include "QelFuzzTarget.h"

std::string QelFuzzScratchFolder() {
  static const std::string folder = [] {
    std::string pattern = (::access("/dev/shm", W_OK) == 0 ? "/dev/shm" : std::filesystem::temp_directory_path().string()) +
                          "/qel-fuzz-XXXXXX";
    QelFuzzCheck(::mkdtemp(pattern.data()) != nullptr, "a scratch folder can be made");
    // Removed at exit, also after a run libFuzzer ends by a time or run limit.
    static struct Remover {
      std::string path;
      ~Remover() {
        std::error_code ignored;
        std::filesystem::remove_all(path, ignored);
      }
    } remover{pattern};
    return pattern;
  }();
  return folder;
}
