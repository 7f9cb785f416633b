#include "QelToolkitCheck.h"

#include <cstdio>
#include <cstring>

#include "QelAssert.h"

namespace {
const char* BaseName(const char* path) {
  const char* slash = std::strrchr(path, '/');
  return slash ? slash + 1 : path;
}
}  // namespace

std::string QelFormatToolkitCheck(const char* kind, const char* detail, const char* message, const char* file,
                                  int line) {
  // Bounded like the assertion text: 32 + 128 + 128 + 128 characters and the frame.
  char buffer[480];
  if (message && *message) {
    std::snprintf(buffer, sizeof buffer, ">> CHECK FAILED %.32s: %.128s: %.128s [File: %.128s:%4d].<<\n",
                  kind ? kind : "", detail ? detail : "", message, file ? file : "", line);
  } else {
    std::snprintf(buffer, sizeof buffer, ">> CHECK FAILED %.32s: %.128s [File: %.128s:%4d].<<\n", kind ? kind : "",
                  detail ? detail : "", file ? file : "", line);
  }
  return buffer;
}

void QelToolkitCheckFailed(const char* kind, const char* detail, const char* message, const char* file, int line) {
  const char* shortFile = BaseName(file ? file : "");
  std::string text = QelFormatToolkitCheck(kind, detail, message, shortFile, line);
  if (QelCaptureReport({kind ? kind : "", detail ? detail : "", shortFile, line, text})) return;
  QelSysLogError(text.c_str());
}
