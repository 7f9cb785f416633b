#include "QelListValQelUnicodeString.h"

#include "QelAssert.h"

void QelListValQelUnicodeString::Append(const QelListValQelUnicodeString& other) {
  if (&other == this) {
    // Appending to itself would read a vector that is growing.
    std::vector<QelUnicodeString> copy = items_;
    items_.insert(items_.end(), copy.begin(), copy.end());
    return;
  }
  items_.insert(items_.end(), other.items_.begin(), other.items_.end());
}

QelUnicodeString& QelListValQelUnicodeString::operator[](int position) {
  if (position < 1 || position > Size()) {
    QelAssertBool("list position out of range");
    // A fresh empty text each time, so a caller that wrote into it earlier leaks nothing.
    static QelUnicodeString none;
    none = QelUnicodeString();
    return none;
  }
  return items_[static_cast<size_t>(position - 1)];
}

const QelUnicodeString& QelListValQelUnicodeString::operator[](int position) const {
  return const_cast<QelListValQelUnicodeString&>(*this)[position];
}

int QelListValQelUnicodeString::Locate(const QelUnicodeString& text) const {
  for (size_t i = 0; i < items_.size(); ++i)
    if (items_[i] == text) return static_cast<int>(i) + 1;
  return 0;
}

void QelListValQelUnicodeString::RemovePosition(int position) {
  if (position < 1 || position > Size()) {
    QelAssertBool("list position out of range");
    return;
  }
  items_.erase(items_.begin() + (position - 1));
}
