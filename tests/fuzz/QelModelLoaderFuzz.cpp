// Model files: the text loader and the file loader must agree, and a load must leave no
// object alive once its root is dropped (refused or not).
#include <fstream>

#include "QelBaseUnknown.h"
#include "QelFuzzTarget.h"
#include "QelModelLoader.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), size);
  const int64_t liveBefore = QelBaseUnknown::LiveObjectCount();
  HRESULT fromText, fromFile;
  {
    QelBaseUnknown_var root;
    std::string error;
    fromText = QelModelLoader::LoadText(text, "fuzz.json", root, error);
    QelFuzzCheck((fromText == S_OK) == static_cast<bool>(root), "a root exactly when the load succeeds");
    QelFuzzCheck(fromText == S_OK || !error.empty(), "a refusal says why");
  }
  QelFuzzCheck(QelBaseUnknown::LiveObjectCount() == liveBefore, "no object outlives the model's root");
  {
    const std::string path = QelFuzzScratchFolder() + "/fuzz.json";
    std::ofstream(path, std::ios::binary | std::ios::trunc) << text;
    QelBaseUnknown_var root;
    std::string error;
    fromFile = QelModelLoader::LoadFile(path, root, error);
  }
  QelFuzzCheck(fromText == fromFile, "the file and the text loaders agree");
  QelFuzzCheck(QelBaseUnknown::LiveObjectCount() == liveBefore, "no object outlives the model's root");
  return 0;
}
