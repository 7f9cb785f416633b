#pragma once
// QelUnicodeString: a text shown to a person, stored as UTF-8. Lengths and positions count
// characters (code points), not bytes; positions are 0-based. A plain value type. Bytes
// that are not valid UTF-8 are replaced by U+FFFD on entry, so every stored text is valid
// and character positions are always well defined.
#include <string>
#include <string_view>

class QelUnicodeString {
 public:
  QelUnicodeString() = default;
  QelUnicodeString(const char* utf8);
  QelUnicodeString(std::string_view utf8);
  QelUnicodeString(const std::string& utf8) : QelUnicodeString(std::string_view(utf8)) {}

  const std::string& Utf8() const { return text_; }
  bool IsEmpty() const { return text_.empty(); }
  int GetLengthInChar() const;

  QelUnicodeString& Append(const QelUnicodeString& other);
  QelUnicodeString& operator+=(const QelUnicodeString& other) { return Append(other); }
  friend QelUnicodeString operator+(QelUnicodeString a, const QelUnicodeString& b) { return a.Append(b); }
  friend bool operator==(const QelUnicodeString& a, const QelUnicodeString& b) { return a.text_ == b.text_; }
  friend bool operator!=(const QelUnicodeString& a, const QelUnicodeString& b) { return a.text_ != b.text_; }
  // UTF-8 byte order is code point order.
  friend bool operator<(const QelUnicodeString& a, const QelUnicodeString& b) { return a.text_ < b.text_; }

  // The characters [start, start + length). A start outside 0..GetLengthInChar() gives an
  // empty text; a negative length, or one past the end, takes the rest of the text.
  QelUnicodeString SubString(int start, int length) const;
  // Character position of the first occurrence of `what` at or after `from`, or -1. An
  // empty `what` is found at `from` when that lies within the text.
  int SearchSubString(const QelUnicodeString& what, int from = 0) const;

  // Formats one number with a printf format. The format must hold exactly one conversion
  // of the value's type ("%g", "%.3f", "%d", "%5x" ...; literal text and "%%" around it are
  // fine); any other format, a length modifier that does not fit the type ("%ld" for an
  // int; only "%lf" and the like for a double), `*` widths, or a width or precision above
  // 1024, is refused and leaves the text empty.
  void BuildFromNum(double value, const char* format = "%g");
  void BuildFromNum(int value, const char* format = "%d");

  // Reads one number with a scanf-like format holding exactly one double conversion
  // ("%lf", "%le", "%lg", "%la", optional width; literal text around it must match).
  // Returns 1 when the whole text was read (leading and trailing blanks allowed), else 0:
  // an empty text, text that is not a number, characters left after the number ("1.5mm"),
  // a value out of the range of double, "nan" or "inf", or a refused format. On 0, *out is not touched,
  // so a caller that ignores the status keeps its previous value.
  int ConvertToNum(double* out, const char* format = "%lf") const;

  // True when `bytes` is well-formed UTF-8 (no overlong forms, no surrogates).
  static bool IsValidUtf8(std::string_view bytes);

 private:
  // Byte offset of character `index` (0..length); the text's size when past the end.
  size_t ByteOffsetOf(int index) const;

  std::string text_;
};
