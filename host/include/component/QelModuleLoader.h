#pragma once
// QelModuleLoader: loads a plug-in module (a shared library) by file name, the way the
// design application loads its frameworks. Loading runs the module's load-time
// registration; the library stays loaded until Unload or the end of the process, and
// Unload runs its exit actions (the module's static destructors) before it is unmapped.
#include <string>

class QelModuleLoader {
 public:
  // Loads the library at `path` and checks its ABI version (QelModuleAbi.h). A bare file
  // name means the library beside the running program; any other relative path is taken
  // from the working folder. The library is opened by that absolute path only, never by
  // the system's search, so the file named is the one loaded. Null with `error` filled
  // (naming the file and the reason) when the file is missing, does not load, is no
  // module (no ABI version) or was built for another ABI; such a library is closed again.
  static void* Load(const std::string& path, std::string& error);
  static void Unload(void* module);
  // The absolute path `Load` opens for `path`.
  static std::string AbsolutePath(const std::string& path);
  // The folder of the running program, with a trailing slash; empty when unknown.
  static std::string ProgramFolder();
};
