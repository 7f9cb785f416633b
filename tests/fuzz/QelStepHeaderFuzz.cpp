// STEP file heads: the input is a whole file, read as the importer reads it before
// translating anything. Whatever the bytes, the answer is a plain verdict: a file that is
// not STEP names no schema, and only a STEP file can be taken for the annotated protocol.
#include <fstream>

#include "QelFuzzTarget.h"
#include "QelStepFileHeader.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const std::string path = QelFuzzScratchFolder() + "/model.stp";
  const std::string text(reinterpret_cast<const char*>(data), size);
  std::ofstream(path, std::ios::binary | std::ios::trunc) << text;
  QelStepFileHeader header;
  std::string error;
  const bool read = QelStepFileHeader::Read(path, header, error);
  QelFuzzCheck(read == (size > 0), "every non-empty regular file is read");
  QelFuzzCheck(read || !error.empty(), "a refusal says why");
  for (const QelStepFileHeader& seen : {header, QelStepFileHeader::Parse(text, text)}) {
    QelFuzzCheck(seen.isStep || seen.schemas.empty(), "a file that is not STEP names no schema");
    QelFuzzCheck(!seen.IsAP242() || seen.isStep, "only a STEP file is taken for the annotated protocol");
  }
  return 0;
}
