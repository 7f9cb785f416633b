// Number texts and formats: the input's first line is a format, the rest a text.
// ConvertToNum reads the text with the format; BuildFromNum formats a few awkward values
// with it (a format it accepts must match the value's type, or printf reads garbage);
// qelhost's tolerance range parser reads the whole input. Accepted numbers are finite.
#include <cfloat>
#include <climits>
#include <cmath>

#include "QelFuzzTarget.h"
#include "QelHostOptions.h"
#include "QelUnicodeString.h"

namespace {
// The length modifier of the format's first conversion ("" when it has none), read
// independently of the code under test: an int takes none, a double at most "l".
std::string LengthModifier(const std::string& format) {
  for (size_t at = 0; at < format.size(); ++at) {
    if (format[at] != '%') continue;
    if (at + 1 < format.size() && format[at + 1] == '%') {
      ++at;
      continue;
    }
    size_t p = format.find_first_not_of("-+ #0'123456789.", at + 1);
    size_t end = format.find_first_not_of("hlLjzt", p == std::string::npos ? format.size() : p);
    return p == std::string::npos ? "" : format.substr(p, (end == std::string::npos ? format.size() : end) - p);
  }
  return "";
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string input(reinterpret_cast<const char*>(data), size);
  const size_t newline = input.find('\n');
  const std::string format = input.substr(0, newline);
  const std::string text = newline == std::string::npos ? std::string() : input.substr(newline + 1);

  double read = 0.25;
  if (QelUnicodeString(text).ConvertToNum(&read, format.c_str()))
    QelFuzzCheck(std::isfinite(read), "ConvertToNum gives finite numbers");
  QelUnicodeString built;
  // A number's text is short whatever the format asks: no gigabyte of padding.
  const size_t longest = format.size() + 2048;
  for (double value : {read, -0.0, DBL_MAX, DBL_TRUE_MIN, double(NAN), -double(INFINITY)}) {
    built.BuildFromNum(value, format.c_str());
    QelFuzzCheck(QelUnicodeString::IsValidUtf8(built.Utf8()), "BuildFromNum gives valid UTF-8");
    QelFuzzCheck(built.Utf8().size() <= longest, "a formatted double stays short");
    const std::string length = LengthModifier(format);
    QelFuzzCheck(built.IsEmpty() || length.empty() || length == "l", "a double is formatted without L, h, ll ...");
  }
  for (int value : {0, -1, INT_MIN, INT_MAX}) {
    built.BuildFromNum(value, format.c_str());
    QelFuzzCheck(QelUnicodeString::IsValidUtf8(built.Utf8()), "BuildFromNum gives valid UTF-8");
    QelFuzzCheck(built.Utf8().size() <= longest, "a formatted int stays short");
    QelFuzzCheck(built.IsEmpty() || LengthModifier(format).empty(), "an int is formatted without a length modifier");
  }

  QelToleranceRange range;
  std::string error;
  if (QelHostOptions::ParseToleranceRange(input, range, error)) {
    QelFuzzCheck(!range.left || std::isfinite(*range.left), "range bounds are finite");
    QelFuzzCheck(!range.right || std::isfinite(*range.right), "range bounds are finite");
  } else {
    QelFuzzCheck(error.find("--tolerance") != std::string::npos, "a refusal names the option");
  }
  return 0;
}
