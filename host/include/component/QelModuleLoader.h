#pragma once
// QelModuleLoader: loads a plug-in module (a shared library) by file name, the way the
// design application loads its frameworks. Loading runs the module's load-time
// registration; the library stays loaded until Unload or the end of the process.
#include <string>

class QelModuleLoader {
 public:
  // Loads the library at `path` (a bare file name is searched next to the running program
  // first, then by the system loader). Null with `error` filled when it cannot be loaded.
  static void* Load(const std::string& path, std::string& error);
  static void Unload(void* module);
  // The folder of the running program, with a trailing slash; empty when unknown.
  static std::string ProgramFolder();
};
