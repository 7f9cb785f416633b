#include "QelWidgetsPreview.h"

#include <dlfcn.h>

#include <cstdio>
#include <string>
#include <vector>

#include "QelModelLoader.h"
#include "QelModuleLoader.h"
#include "QelSampleProduct.h"

bool QelWidgetsPreviewWanted(int argc, char** argv) { return argc >= 2 && std::string(argv[1]) == "--widgets"; }

int QelWidgetsPreviewMain(int argc, char** argv) {
  bool json = false;
  std::vector<const char*> clicks;
  for (int i = 2; i < argc; ++i) {
    if (std::string(argv[i]) == "--json") json = true;
    else clicks.push_back(argv[i]);
  }
  QelBaseUnknown_var root;
  std::string error;
  if (QelModelLoader::LoadText(kQelSampleProductText, kQelSampleProductName, root, error) != S_OK) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  // The preview library carries its own copy of the module (it reaches the module's
  // internals, which the plug-in does not export), registered when it loads.
  void* preview = QelModuleLoader::Load("libQelWidgetsPreview.so", error);
  if (!preview) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  using Run = int (*)(QelBaseUnknown*, const char* const*, int, int);
  auto run = reinterpret_cast<Run>(dlsym(preview, "QelWidgetsPreviewRun"));
  if (!run) {
    std::fprintf(stderr, "qelhost: libQelWidgetsPreview.so has no QelWidgetsPreviewRun\n");
    return 1;
  }
  const int status = run(root.get(), clicks.data(), static_cast<int>(clicks.size()), json ? 1 : 0);
  return status;
}
