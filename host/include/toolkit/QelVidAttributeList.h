#pragma once
// QelVidAttributeList: a widget's attributes in order of first setting. Names are kept
// once per process (QelVidAttributeName) and referred to by pointer; the first few
// attributes live inside the list itself, so a styled part, which has one to three,
// costs no allocation for them. The list belongs to its widget: it is never copied or
// moved.
#include <cstdint>
#include <string>
#include <string_view>

#include "QelSYPValue.h"

struct QelVidAttribute {
  const std::string* name;  // from QelVidAttributeName
  QelSYPValue value;
  const std::string& Name() const { return *name; }
};

// The process's one copy of an attribute name; it lives as long as the process.
const std::string* QelVidAttributeName(std::string_view name);

class QelVidAttributeList {
 public:
  QelVidAttributeList() = default;
  QelVidAttributeList(const QelVidAttributeList&) = delete;
  QelVidAttributeList& operator=(const QelVidAttributeList&) = delete;
  ~QelVidAttributeList();

  const QelVidAttribute* begin() const { return data_; }
  const QelVidAttribute* end() const { return data_ + size_; }
  size_t size() const { return size_; }
  bool empty() const { return size_ == 0; }

  QelSYPValue* Find(std::string_view name);
  const QelSYPValue* Find(std::string_view name) const { return const_cast<QelVidAttributeList*>(this)->Find(name); }
  // By the name's one copy: a pointer comparison per attribute.
  QelSYPValue* Find(const std::string* name);
  // Room for `count` attributes in all.
  void Reserve(size_t count);
  // Adds an attribute that is not in the list yet.
  void Append(const std::string* name, const QelSYPValue& value);

 private:
  static constexpr uint32_t kInline = 3;
  QelVidAttribute* Inline() { return reinterpret_cast<QelVidAttribute*>(inline_); }
  // Moves the attributes to `grown`, room for `capacity`, and frees the old heap room.
  void MoveTo(QelVidAttribute* grown, size_t capacity);

  QelVidAttribute* data_ = Inline();
  uint32_t size_ = 0;
  uint32_t capacity_ = kInline;
  alignas(QelVidAttribute) unsigned char inline_[kInline * sizeof(QelVidAttribute)];
};
