#include "QelSetValQelUnicodeString.h"

#include <algorithm>

#include "QelAssert.h"

bool QelSetValQelUnicodeString::Add(const QelUnicodeString& text) {
  auto at = std::lower_bound(items_.begin(), items_.end(), text);
  if (at != items_.end() && *at == text) return false;
  items_.insert(at, text);
  return true;
}

const QelUnicodeString& QelSetValQelUnicodeString::operator[](int position) const {
  if (position < 1 || position > Size()) {
    QelAssertBool("set position out of range");
    static const QelUnicodeString none;
    return none;
  }
  return items_[static_cast<size_t>(position - 1)];
}

int QelSetValQelUnicodeString::Locate(const QelUnicodeString& text) const {
  auto at = std::lower_bound(items_.begin(), items_.end(), text);
  if (at == items_.end() || *at != text) return 0;
  return static_cast<int>(at - items_.begin()) + 1;
}

bool QelSetValQelUnicodeString::Remove(const QelUnicodeString& text) {
  auto at = std::lower_bound(items_.begin(), items_.end(), text);
  if (at == items_.end() || *at != text) return false;
  items_.erase(at);
  return true;
}
