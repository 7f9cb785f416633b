// STEP data sections: the input is a whole file's text, scanned as the importer scans it
// before the translator sees anything, then searched for tolerance magnitudes as the
// importer does after. Whatever the bytes, a refusal names its line, and what the scan
// lets through nests and lists within its bounds.
#include <algorithm>
#include <string>
#include <string_view>

#include "QelFuzzTarget.h"
#include "QelStepDataScan.h"
#include "QelStepToleranceValues.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  QelStepDataScan scan;
  std::string error;
  if (!QelStepDataScan::Scan(text, scan, error)) {
    QelFuzzCheck(error.rfind("line ", 0) == 0, "a refusal names its line");
    QelFuzzCheck(scan.Entities().size() <= size, "no more entities than bytes");
  } else {
    // What passed holds no list deeper than the bound: count outside strings and comments.
    size_t depth = 0, deepest = 0;
    bool quoted = false;
    for (size_t i = 0; i < size; ++i) {
      const char c = text[i];
      if (c == '\'') quoted = !quoted;
      if (quoted) continue;
      if (c == '/' && i + 1 < size && text[i + 1] == '*') {
        const size_t end = text.find("*/", i + 2);
        i = end == std::string_view::npos ? size : end + 1;
        continue;
      }
      if (c == '(') deepest = std::max(deepest, ++depth);
      if (c == ')' && depth > 0) --depth;
    }
    QelFuzzCheck(deepest <= QelStepDataScan::kMaxNesting, "a file that passed nests within the bound");
    QelFuzzCheck(depth == 0, "a file that passed closes its lists");
  }
  const QelStepToleranceValues values = QelStepToleranceValues::Scan(text);
  QelFuzzCheck(values.Size() <= size, "no more magnitudes than bytes");
  return 0;
}
