// qelhost: the reference host program. It stands in for the design application: opens a
// product model, loads the QelRovFacets plug-in and shows what a reviewer would see.
#include <cstdio>
#include <cstring>
#include <iostream>
#include <string>

#include "QelModelLoader.h"
#include "QelModelPrinter.h"
#include "QelSampleProduct.h"

namespace {
const char kUsage[] =
    "usage: qelhost [options] [model.json]\n"
    "\n"
    "Opens a product model (the shipped sample when none is given) and shows its\n"
    "annotation sets, annotations, views and captures.\n"
    "\n"
    "options:\n"
    "  -h, --help       show this help and exit\n"
    "  -V, --version    show the version and exit\n";
}  // namespace

int main(int argc, char** argv) {
  std::string modelPath;
  for (int i = 1; i < argc; ++i) {
    std::string arg = argv[i];
    if (arg == "-h" || arg == "--help") {
      std::fputs(kUsage, stdout);
      return 0;
    }
    if (arg == "-V" || arg == "--version") {
      std::printf("qelhost %s\n", QEL_VERSION);
      return 0;
    }
    if (!arg.empty() && arg[0] == '-') {
      std::fprintf(stderr, "qelhost: unknown option '%s'\n%s", arg.c_str(), kUsage);
      return 2;
    }
    if (!modelPath.empty()) {
      std::fprintf(stderr, "qelhost: only one model file may be given\n%s", kUsage);
      return 2;
    }
    modelPath = arg;
  }

  QelBaseUnknown_var root;
  std::string error;
  HRESULT loaded = modelPath.empty()
                       ? QelModelLoader::LoadText(kQelSampleProductText, kQelSampleProductName, root, error)
                       : QelModelLoader::LoadFile(modelPath, root, error);
  if (loaded != S_OK) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  QelModelPrinter::Print(root.get(), std::cout);
  return 0;
}
