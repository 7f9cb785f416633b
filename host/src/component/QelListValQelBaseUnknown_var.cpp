#include "QelListValQelBaseUnknown_var.h"

#include <unordered_set>

#include "QelAssert.h"

namespace {
bool Same(const QelBaseUnknown_var& entry, QelBaseUnknown* object) {
  if (!entry || !object) return !entry && !object;
  return entry->IsEqual(object);
}
}  // namespace

void QelListValQelBaseUnknown_var::Append(const QelListValQelBaseUnknown_var& other) {
  items_.insert(items_.end(), other.items_.begin(), other.items_.end());
}

const QelBaseUnknown_var& QelListValQelBaseUnknown_var::operator[](int position) const {
  if (position < 1 || position > Size()) {
    QelAssertBool("list position out of range");
    static const QelBaseUnknown_var none;
    return none;
  }
  return items_[position - 1];
}

int QelListValQelBaseUnknown_var::Locate(QelBaseUnknown* object) const {
  for (size_t i = 0; i < items_.size(); ++i)
    if (Same(items_[i], object)) return static_cast<int>(i) + 1;
  return 0;
}

int QelListValQelBaseUnknown_var::RemoveValue(QelBaseUnknown* object) {
  int position = Locate(object);
  if (position) items_.erase(items_.begin() + (position - 1));
  return position;
}

void QelListValQelBaseUnknown_var::RemovePosition(int position) {
  if (position < 1 || position > Size()) {
    QelAssertBool("list position out of range");
    return;
  }
  items_.erase(items_.begin() + (position - 1));
}

void QelListValQelBaseUnknown_var::RemoveDuplicates() {
  std::unordered_set<QelBaseUnknown*> seen;  // implementations; a null entry counts once too
  std::vector<QelBaseUnknown_var> kept;
  kept.reserve(items_.size());
  for (auto& item : items_)
    if (seen.insert(item ? item->GetImpl() : nullptr).second) kept.push_back(std::move(item));
  items_ = std::move(kept);
}
