// qelhost: the reference host program. It stands in for the design application: opens a
// product model, loads the QelRovFacets plug-in and shows what a reviewer would see.
#include <cstdio>
#include <cstring>
#include <string>

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
  }
  return 0;
}
