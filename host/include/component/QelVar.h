#pragma once
// QelVar<T>: the counted handle. Ownership is visible where a handle is made:
//   QelMakeVar<T>(args...)  creates an object and adopts its first reference;
//   QelVar<T>::Adopt(p)     takes over a reference the caller already owns;
//   QelVar<T>::Retain(p)    adds a reference of its own to an object of type T;
//   QelVar<T> v(object)     queries T (for an interface) or casts (for a class) and adds a
//                           reference; null when the object is neither. Explicit, so that
//                           `QelVar<T> v = new X;` (a leak) does not compile.
// Assignment takes its argument by value and swaps, so `p = p->next` reads the source
// before it lets go of the old object.
#include <type_traits>
#include <utility>

#include "QelBaseUnknown.h"

template <class T>
concept QelInterface = std::is_same_v<typename T::QelInterfaceSelf, T>;

template <class T>
class QelVar {
 public:
  QelVar() = default;
  QelVar(std::nullptr_t) {}
  explicit QelVar(QelBaseUnknown* any) { Assign(any); }
  QelVar(const QelVar& other) : p_(other.p_) { if (p_) Base(p_)->AddRef(); }
  QelVar(QelVar&& other) noexcept : p_(std::exchange(other.p_, nullptr)) {}
  template <class U>
    requires(!std::is_same_v<U, T>)
  QelVar(const QelVar<U>& other) { Assign(other.get()); }
  ~QelVar() {
    static_assert(!std::is_destructible_v<T>, "a counted type needs a non-public destructor: only Release deletes");
    Reset();
  }

  static QelVar Adopt(T* owned) {
    QelVar v;
    v.p_ = owned;
    if (owned) Base(owned)->NoteAdopted();
    return v;
  }
  static QelVar Retain(T* p) {
    QelVar v;
    if (p) Base(p)->AddRef();
    v.p_ = p;
    return v;
  }

  QelVar& operator=(QelVar other) noexcept {
    std::swap(p_, other.p_);
    return *this;
  }
  QelVar& operator=(std::nullptr_t) { Reset(); return *this; }

  T* get() const { return p_; }
  T* operator->() const { return p_; }
  T& operator*() const { return *p_; }
  explicit operator bool() const { return p_ != nullptr; }
  bool operator!() const { return p_ == nullptr; }
  // Pointer identity of the handles; IsEqual compares implementations.
  friend bool operator==(const QelVar& a, const QelVar& b) { return a.p_ == b.p_; }

  // Hands the reference to the caller.
  T* Detach() { return std::exchange(p_, nullptr); }
  void Reset() { if (T* p = std::exchange(p_, nullptr)) Base(p)->Release(); }

 private:
  static QelBaseUnknown* Base(T* p) { return p; }

  void Assign(QelBaseUnknown* any) {
    if (!any) return;
    if constexpr (std::is_same_v<T, QelBaseUnknown>) {
      any->AddRef();
      p_ = any;
    } else if constexpr (QelInterface<T>) {
      void* out = nullptr;
      if (any->QueryInterface(T::IID, &out) == S_OK) p_ = static_cast<T*>(out);  // the query's reference
    } else {
      if (T* cast = dynamic_cast<T*>(any->GetImpl())) { Base(cast)->AddRef(); p_ = cast; }
    }
  }

  T* p_ = nullptr;
};

using QelBaseUnknown_var = QelVar<QelBaseUnknown>;

// Creates a T and adopts the one reference it starts with.
template <class T, class... Args>
QelVar<T> QelMakeVar(Args&&... args) {
  return QelVar<T>::Adopt(new T(std::forward<Args>(args)...));
}

// The implementation object behind `p` as a class pointer, without a reference.
template <class T>
T* QelSysDynamicCast(QelBaseUnknown* p) {
  return p ? dynamic_cast<T*>(p->GetImpl()) : nullptr;
}

// The usual body of QueryDirect: answers for each listed interface the object implements
// itself, else nullptr.
template <class... Interfaces, class Self>
void* QelQueryDirect(Self* self, const QelIID& iid) {
  void* found = nullptr;
  ((found == nullptr && iid == Interfaces::IID ? (found = static_cast<Interfaces*>(self)) : nullptr), ...);
  return found;
}
