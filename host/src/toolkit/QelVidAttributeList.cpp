#include "QelVidAttributeList.h"

#include <memory>
#include <mutex>
#include <new>
#include <set>

const std::string* QelVidAttributeName(std::string_view name) {
  // Never destroyed: widgets of a module unloaded at exit may still name theirs.
  static auto* names = new std::set<std::string, std::less<>>();
  static std::mutex guard;
  std::lock_guard lock(guard);
  auto it = names->find(name);
  if (it == names->end()) it = names->emplace(name).first;
  return &*it;
}

QelVidAttributeList::~QelVidAttributeList() {
  std::destroy_n(data_, size_);
  if (data_ != Inline()) ::operator delete(data_);
}

QelSYPValue* QelVidAttributeList::Find(std::string_view name) {
  for (QelVidAttribute* a = data_; a != data_ + size_; ++a)
    if (*a->name == name) return &a->value;
  return nullptr;
}

QelSYPValue* QelVidAttributeList::Find(const std::string* name) {
  for (QelVidAttribute* a = data_; a != data_ + size_; ++a)
    if (a->name == name) return &a->value;
  return nullptr;
}

void QelVidAttributeList::MoveTo(QelVidAttribute* grown, size_t capacity) {
  std::uninitialized_move_n(data_, size_, grown);
  std::destroy_n(data_, size_);
  if (data_ != Inline()) ::operator delete(data_);
  data_ = grown;
  capacity_ = static_cast<uint32_t>(capacity);
}

void QelVidAttributeList::Reserve(size_t count) {
  if (count > capacity_) MoveTo(static_cast<QelVidAttribute*>(::operator new(count * sizeof(QelVidAttribute))), count);
}

void QelVidAttributeList::Append(const std::string* name, const QelSYPValue& value) {
  if (size_ < capacity_) {
    new (data_ + size_) QelVidAttribute{name, value};
  } else {
    // The new one is made first: `value` may be one of the attributes about to move.
    const size_t capacity = size_t{capacity_} * 2;
    std::unique_ptr<void, void (*)(void*)> grown(::operator new(capacity * sizeof(QelVidAttribute)),
                                                 [](void* p) { ::operator delete(p); });
    new (static_cast<QelVidAttribute*>(grown.get()) + size_) QelVidAttribute{name, value};
    MoveTo(static_cast<QelVidAttribute*>(grown.release()), capacity);
  }
  ++size_;
}
