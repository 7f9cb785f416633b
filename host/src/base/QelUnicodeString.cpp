#include "QelUnicodeString.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

namespace {
constexpr std::string_view kReplacement = "\xEF\xBF\xBD";  // U+FFFD

bool IsContinuation(unsigned char byte) { return (byte & 0xC0) == 0x80; }

// Length of the well-formed UTF-8 sequence at `at`, or 0 when the bytes there are not one.
size_t SequenceLength(std::string_view bytes, size_t at) {
  const auto b0 = static_cast<unsigned char>(bytes[at]);
  if (b0 < 0x80) return 1;
  size_t length;
  unsigned char low = 0x80, high = 0xBF;  // allowed range of the second byte
  if (b0 >= 0xC2 && b0 <= 0xDF) {
    length = 2;
  } else if (b0 >= 0xE0 && b0 <= 0xEF) {
    length = 3;
    if (b0 == 0xE0) low = 0xA0;   // overlong
    if (b0 == 0xED) high = 0x9F;  // surrogates
  } else if (b0 >= 0xF0 && b0 <= 0xF4) {
    length = 4;
    if (b0 == 0xF0) low = 0x90;   // overlong
    if (b0 == 0xF4) high = 0x8F;  // above U+10FFFF
  } else {
    return 0;
  }
  if (at + length > bytes.size()) return 0;
  const auto b1 = static_cast<unsigned char>(bytes[at + 1]);
  if (b1 < low || b1 > high) return 0;
  for (size_t i = 2; i < length; ++i)
    if (!IsContinuation(static_cast<unsigned char>(bytes[at + i]))) return 0;
  return length;
}

std::string Sanitized(std::string_view bytes) {
  std::string out;
  out.reserve(bytes.size());
  for (size_t at = 0; at < bytes.size();) {
    size_t length = SequenceLength(bytes, at);
    if (length == 0) {
      out += kReplacement;
      ++at;
    } else {
      out.append(bytes.substr(at, length));
      at += length;
    }
  }
  return out;
}

// The one conversion of a printf format, located and classified, or nothing when the
// format holds zero conversions, more than one, a `*`, or a malformed directive.
struct PrintfConversion {
  bool ok = false;
  char type = 0;
  bool anyLength = false;    // any length modifier at all
  bool otherLength = false;  // anything but one 'l' (which only a double may carry, to no effect)
};

// A width or precision beyond this is refused: "%999999999d" would build a gigabyte of
// spaces, far past any text a person reads. "%.400f" of a huge double still fits.
constexpr long kMaxFieldSize = 1024;

// Skips a run of digits and answers its value, saturated just above kMaxFieldSize.
long ReadDigits(const char*& p) {
  long value = 0;
  for (; *p >= '0' && *p <= '9'; ++p) value = std::min(value * 10 + (*p - '0'), kMaxFieldSize + 1);
  return value;
}

PrintfConversion ParsePrintfFormat(const char* format) {
  PrintfConversion found;
  int conversions = 0;
  for (const char* p = format; *p; ++p) {
    if (*p != '%') continue;
    ++p;
    if (*p == '%') continue;
    while (*p && std::strchr("-+ #0'", *p)) ++p;
    if (ReadDigits(p) > kMaxFieldSize) return {};
    if (*p == '.') {
      ++p;
      if (ReadDigits(p) > kMaxFieldSize) return {};
    }
    if (*p == '*' || *p == '$') return {};
    const char* length = p;
    while (*p && std::strchr("hljztL", *p)) ++p;
    const bool anyLength = p != length;
    const bool otherLength = anyLength && !(p - length == 1 && *length == 'l');
    if (!*p || !std::strchr("diouxXeEfFgGaAcspn", *p)) return {};
    if (++conversions > 1) return {};
    found = {true, *p, anyLength, otherLength};
  }
  return conversions == 1 ? found : PrintfConversion{};
}

template <class T>
std::string FormatOne(const char* format, T value) {
  int needed = std::snprintf(nullptr, 0, format, value);
  if (needed < 0) return {};
  std::vector<char> buffer(static_cast<size_t>(needed) + 1);
  std::snprintf(buffer.data(), buffer.size(), format, value);
  return std::string(buffer.data(), static_cast<size_t>(needed));
}

bool IsBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\f' || c == '\v'; }
}  // namespace

QelUnicodeString::QelUnicodeString(const char* utf8) : QelUnicodeString(std::string_view(utf8 ? utf8 : "")) {}

QelUnicodeString::QelUnicodeString(std::string_view utf8)
    : text_(IsValidUtf8(utf8) ? std::string(utf8) : Sanitized(utf8)) {}

bool QelUnicodeString::IsValidUtf8(std::string_view bytes) {
  for (size_t at = 0; at < bytes.size();) {
    // Names are mostly ASCII: every text handed out is checked, so keep that path short.
    if (static_cast<unsigned char>(bytes[at]) < 0x80) {
      ++at;
      continue;
    }
    size_t length = SequenceLength(bytes, at);
    if (length == 0) return false;
    at += length;
  }
  return true;
}

int QelUnicodeString::GetLengthInChar() const {
  int count = 0;
  for (unsigned char byte : text_)
    if (!IsContinuation(byte)) ++count;
  return count;
}

size_t QelUnicodeString::ByteOffsetOf(int index) const {
  int seen = 0;
  for (size_t at = 0; at < text_.size(); ++at) {
    if (IsContinuation(static_cast<unsigned char>(text_[at]))) continue;
    if (seen == index) return at;
    ++seen;
  }
  return text_.size();
}

QelUnicodeString& QelUnicodeString::Append(const QelUnicodeString& other) {
  text_ += other.text_;  // both valid, so the result is too
  return *this;
}

QelUnicodeString QelUnicodeString::SubString(int start, int length) const {
  if (start < 0 || start > GetLengthInChar()) return {};
  size_t from = ByteOffsetOf(start);
  const long long end = static_cast<long long>(start) + length;
  size_t to = (length < 0 || end > GetLengthInChar()) ? text_.size() : ByteOffsetOf(static_cast<int>(end));
  QelUnicodeString part;
  part.text_ = text_.substr(from, to - from);
  return part;
}

int QelUnicodeString::SearchSubString(const QelUnicodeString& what, int from) const {
  if (from < 0 || from > GetLengthInChar()) return -1;
  size_t found = text_.find(what.text_, ByteOffsetOf(from));
  if (found == std::string::npos) return -1;
  // A match of valid UTF-8 in valid UTF-8 always starts on a character boundary.
  int index = 0;
  for (size_t at = 0; at < found; ++at)
    if (!IsContinuation(static_cast<unsigned char>(text_[at]))) ++index;
  return index;
}

void QelUnicodeString::BuildFromNum(double value, const char* format) {
  text_.clear();
  if (!format) return;
  PrintfConversion conversion = ParsePrintfFormat(format);
  if (!conversion.ok || conversion.otherLength) return;
  if (!std::strchr("eEfFgGaA", conversion.type)) return;
  text_ = Sanitized(FormatOne(format, value));
}

void QelUnicodeString::BuildFromNum(int value, const char* format) {
  text_.clear();
  if (!format) return;
  PrintfConversion conversion = ParsePrintfFormat(format);
  // An int takes no length modifier: "%ld" would read a long the caller never passed.
  if (!conversion.ok || conversion.anyLength) return;
  if (!std::strchr("diouxX", conversion.type)) return;
  text_ = Sanitized(FormatOne(format, value));
}

int QelUnicodeString::ConvertToNum(double* out, const char* format) const {
  if (!out || !format) return 0;
  // Walk the format by hand rather than through sscanf: sscanf leaves an out-of-range
  // number undefined and cannot tell "1.5" from "1.5mm".
  const char* text = text_.c_str();
  bool converted = false;
  double value = 0;
  for (const char* f = format; *f; ++f) {
    if (IsBlank(*f)) {
      while (IsBlank(*text)) ++text;
      continue;
    }
    if (*f != '%' || f[1] == '%') {
      if (*f == '%') ++f;
      if (*text != *f) return 0;
      ++text;
      continue;
    }
    if (converted) return 0;  // a second conversion: refused format
    ++f;
    size_t width = 0;
    while (*f >= '0' && *f <= '9') width = width * 10 + static_cast<size_t>(*f++ - '0');
    if (f[0] != 'l' || !f[1] || !std::strchr("eEfFgGaA", f[1])) return 0;
    ++f;
    while (IsBlank(*text)) ++text;
    std::string field = width ? std::string(text, strnlen(text, width)) : std::string(text);
    char* end = nullptr;
    errno = 0;
    value = std::strtod(field.c_str(), &end);
    if (end == field.c_str()) return 0;
    // strtod also reads "nan" and "inf"; no caller can compare or store those sensibly.
    if (!std::isfinite(value)) return 0;
    text += end - field.c_str();
    converted = true;
  }
  if (!converted) return 0;
  while (IsBlank(*text)) ++text;
  if (text != text_.data() + text_.size()) return 0;  // also catches an embedded NUL
  *out = value;
  return 1;
}
