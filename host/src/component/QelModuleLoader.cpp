#include "QelModuleLoader.h"

#include <dlfcn.h>
#include <unistd.h>

#include <climits>

std::string QelModuleLoader::ProgramFolder() {
  char self[PATH_MAX];
  ssize_t n = readlink("/proc/self/exe", self, sizeof self - 1);
  if (n <= 0) return {};
  std::string path(self, static_cast<size_t>(n));
  return path.substr(0, path.find_last_of('/') + 1);
}

void* QelModuleLoader::Load(const std::string& path, std::string& error) {
  error.clear();
  if (path.empty()) {
    error = "no module file name given";
    return nullptr;
  }
  // RTLD_GLOBAL: the module's exported factories and classes are looked up by other
  // modules by name, as the application's frameworks do.
  auto fail = [&](const std::string& tried) -> void* {
    const char* why = dlerror();
    error = "cannot load module '" + tried + "': " + (why ? why : "unknown reason");
    return nullptr;
  };
  if (path.find('/') == std::string::npos) {
    std::string beside = ProgramFolder() + path;
    // A library found beside the program that does not load is the one meant: its own
    // reason (a missing symbol, a foreign file) is the one to report.
    if (access(beside.c_str(), R_OK) == 0) {
      if (void* module = dlopen(beside.c_str(), RTLD_NOW | RTLD_GLOBAL)) return module;
      return fail(beside);
    }
  }
  if (void* module = dlopen(path.c_str(), RTLD_NOW | RTLD_GLOBAL)) return module;
  return fail(path);
}

void QelModuleLoader::Unload(void* module) {
  if (module) dlclose(module);
}
