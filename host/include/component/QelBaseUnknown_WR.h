#pragma once
// QelBaseUnknown_WR: the weak (upward) link. It never keeps its object alive and
// resolves to null once the object has started its destruction. It always refers to the
// implementation, so a weak reference made from a short-lived tie still resolves.
#include "QelVar.h"

struct QelWeakFlag {
  uint32_t refs;
  bool alive;
};

class QelBaseUnknown_WR {
 public:
  QelBaseUnknown_WR() = default;
  QelBaseUnknown_WR(QelBaseUnknown* object);
  template <class T>
  QelBaseUnknown_WR(const QelVar<T>& handle) : QelBaseUnknown_WR(static_cast<QelBaseUnknown*>(handle.get())) {}
  QelBaseUnknown_WR(const QelBaseUnknown_WR& other);
  QelBaseUnknown_WR& operator=(const QelBaseUnknown_WR& other);
  ~QelBaseUnknown_WR();

  // A new counted handle on the object, or null when it is gone.
  QelBaseUnknown_var Get() const;
  // The object without a reference, or null; valid only while someone else holds it.
  QelBaseUnknown* GetRaw() const;
  bool IsAlive() const { return GetRaw() != nullptr; }
  // Whether this refers to `object`'s implementation, even while that object is being
  // destroyed: lets a destructor find what was registered under its name.
  bool RefersTo(QelBaseUnknown* object) const { return object && flag_ && object_ == object->GetImpl(); }
  explicit operator bool() const { return IsAlive(); }
  void Reset();

 private:
  QelWeakFlag* flag_ = nullptr;
  QelBaseUnknown* object_ = nullptr;
};
