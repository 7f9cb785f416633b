#include "QelModuleLoader.h"

#include <dlfcn.h>
#include <unistd.h>

#include <climits>
#include <filesystem>

#include "QelModuleAbi.h"

std::string QelModuleLoader::ProgramFolder() {
  char self[PATH_MAX];
  ssize_t n = readlink("/proc/self/exe", self, sizeof self - 1);
  if (n <= 0) return {};
  std::string path(self, static_cast<size_t>(n));
  return path.substr(0, path.find_last_of('/') + 1);
}

std::string QelModuleLoader::AbsolutePath(const std::string& path) {
  if (path.empty() || path[0] == '/') return path;
  if (path.find('/') == std::string::npos) return ProgramFolder() + path;
  std::error_code ec;
  std::filesystem::path absolute = std::filesystem::absolute(path, ec);
  return ec ? path : absolute.lexically_normal().string();
}

namespace {
void* Open(const std::string& path, std::string& error) {
  error.clear();
  if (path.empty()) {
    error = "no module file name given";
    return nullptr;
  }
  const std::string absolute = QelModuleLoader::AbsolutePath(path);
  if (access(absolute.c_str(), R_OK) != 0) {
    error = "cannot load module '" + absolute + "': no such readable file";
    return nullptr;
  }
  dlerror();
  // RTLD_GLOBAL: the module's exported factories and classes are looked up by other
  // modules by name, as the application's frameworks do.
  if (void* module = dlopen(absolute.c_str(), RTLD_NOW | RTLD_GLOBAL)) return module;
  const char* why = dlerror();
  error = "cannot load module '" + absolute + "': " + (why ? why : "unknown reason");
  return nullptr;
}
}  // namespace

void* QelModuleLoader::Load(const std::string& path, std::string& error) {
  void* module = Open(path, error);
  if (!module) return nullptr;
  const std::string absolute = AbsolutePath(path);
  dlerror();
  const void* symbol = dlsym(module, kQelModuleAbiSymbol);
  const char* why = dlerror();
  if (!symbol || why) {
    error = "'" + absolute + "' is not a plug-in module: it exports no " + kQelModuleAbiSymbol;
    dlclose(module);
    return nullptr;
  }
  const int version = *static_cast<const int*>(symbol);
  if (version != kQelModuleAbiVersion) {
    error = "'" + absolute + "' was built for module ABI " + std::to_string(version) + ", this host needs ABI " +
            std::to_string(kQelModuleAbiVersion);
    dlclose(module);
    return nullptr;
  }
  return module;
}

void QelModuleLoader::Unload(void* module) {
  if (module) dlclose(module);
}
