#pragma once
// QelString: an 8-bit string for names, keys and column identifiers. A plain value type;
// lengths and positions count bytes. Texts shown to a person are QelUnicodeString.
#include <string>
#include <string_view>

class QelString {
 public:
  QelString() = default;
  QelString(const char* text) : text_(text ? text : "") {}
  QelString(std::string text) : text_(std::move(text)) {}
  QelString(std::string_view text) : text_(text) {}

  const char* CastToCharPtr() const { return text_.c_str(); }
  const std::string& Str() const { return text_; }
  bool IsEmpty() const { return text_.empty(); }
  int GetLengthInChar() const { return static_cast<int>(text_.size()); }

  QelString& operator+=(const QelString& other) {
    text_ += other.text_;
    return *this;
  }
  friend QelString operator+(QelString a, const QelString& b) { return a += b; }
  friend bool operator==(const QelString& a, const QelString& b) { return a.text_ == b.text_; }
  friend bool operator!=(const QelString& a, const QelString& b) { return a.text_ != b.text_; }
  friend bool operator<(const QelString& a, const QelString& b) { return a.text_ < b.text_; }

 private:
  std::string text_;
};
