#pragma once
// QelSetValQelUnicodeString: a set of distinct texts kept in ascending order (code point
// order), positions 1-based. Holds copies; a position outside 1..Size() is a broken
// contract (boolean assertion) and reads as an empty text.
#include <vector>

#include "QelUnicodeString.h"

class QelSetValQelUnicodeString {
 public:
  int Size() const { return static_cast<int>(items_.size()); }
  // True when the text was not there yet and has been inserted.
  bool Add(const QelUnicodeString& text);
  bool Append(const QelUnicodeString& text) { return Add(text); }
  const QelUnicodeString& operator[](int position) const;
  // 1-based position of the text, 0 when absent.
  int Locate(const QelUnicodeString& text) const;
  bool Remove(const QelUnicodeString& text);
  void RemoveAll() { items_.clear(); }

  auto begin() const { return items_.begin(); }
  auto end() const { return items_.end(); }

 private:
  std::vector<QelUnicodeString> items_;  // sorted, unique
};
