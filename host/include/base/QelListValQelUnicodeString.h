#pragma once
// QelListValQelUnicodeString: an ordered list of texts, positions 1-based like every list
// of the component model. Holds copies; a position outside 1..Size() is a broken contract
// (boolean assertion) and reads as an empty text.
#include <vector>

#include "QelUnicodeString.h"

class QelListValQelUnicodeString {
 public:
  int Size() const { return static_cast<int>(items_.size()); }
  void Append(const QelUnicodeString& text) { items_.push_back(text); }
  void Append(const QelListValQelUnicodeString& other);
  QelUnicodeString& operator[](int position);
  const QelUnicodeString& operator[](int position) const;
  // 1-based position of the first equal text, 0 when absent.
  int Locate(const QelUnicodeString& text) const;
  void RemovePosition(int position);
  void RemoveAll() { items_.clear(); }

  auto begin() const { return items_.begin(); }
  auto end() const { return items_.end(); }

 private:
  std::vector<QelUnicodeString> items_;
};
