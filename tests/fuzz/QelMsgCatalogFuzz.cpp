// Message catalogs: the input is a catalog file. Parsing reports and skips what it cannot
// read; every key it lists gives a valid UTF-8 message, with and without parameters.
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "QelFuzzTarget.h"
#include "QelMsgCatalog.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const std::string folder = [] {
    std::string resources = QelFuzzScratchFolder() + "/resources";
    std::filesystem::create_directories(resources + "/catalogs");
    ::setenv("QEL_RESOURCES_DIR", resources.c_str(), 1);
    return resources;
  }();
  std::ofstream(folder + "/catalogs/Fuzz.qelcat", std::ios::binary | std::ios::trunc)
      << std::string(reinterpret_cast<const char*>(data), size);
  QelMsgCatalog::ForgetCatalogs();
  const std::vector<QelString> keys = QelMsgCatalog::ListKeys("Fuzz");
  const std::vector<QelUnicodeString> params = {QelUnicodeString("first"), QelUnicodeString("/p1 again")};
  for (size_t i = 0; i < keys.size(); ++i) {
    QelFuzzCheck(i == 0 || keys[i - 1].Str() < keys[i].Str(), "keys are listed once, in order");
    for (const auto& used : {std::vector<QelUnicodeString>{}, params}) {
      QelUnicodeString text = QelMsgCatalog::BuildMessage("Fuzz", keys[i].CastToCharPtr(), used);
      QelFuzzCheck(QelUnicodeString::IsValidUtf8(text.Utf8()), "messages are valid UTF-8");
    }
  }
  return 0;
}
