#pragma once
// Adapters from the widgets' member functions to the plain function pointers of the
// introspection tables. A getter or setter handed an object of another class reads 0 (or
// an empty text) and writes nothing; a handler factory checks its object ("i_pObj",
// "pObj") and gives no handler when the check fails.
#include "QelSYPMetaClass.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelToolkitCheck.h"

// The object as a T: through T::From where the class answers its own identity (no
// dynamic_cast through the virtual base, for getters run per row), else a dynamic_cast.
template <class T>
T* QelRovSYPSelf(QelBaseUnknown* object) {
  if constexpr (requires { T::From(object); })
    return T::From(object);
  else
    return QelSysDynamicCast<T>(object);
}

template <class T, int (T::*Get)() const>
int QelRovSYPGetInt(QelBaseUnknown* object) {
  T* self = QelRovSYPSelf<T>(object);
  return self ? (self->*Get)() : 0;
}

template <class T, void (T::*Set)(int)>
void QelRovSYPSetInt(QelBaseUnknown* object, int value) {
  if (T* self = QelRovSYPSelf<T>(object)) (self->*Set)(value);
}

template <class T, QelUnicodeString (T::*Get)() const>
QelUnicodeString QelRovSYPGetText(QelBaseUnknown* object) {
  T* self = QelRovSYPSelf<T>(object);
  return self ? (self->*Get)() : QelUnicodeString();
}

template <class T, QelBaseUnknown* (T::*Get)() const>
QelBaseUnknown* QelRovSYPGetBoxed(QelBaseUnknown* object) {
  T* self = QelRovSYPSelf<T>(object);
  return self ? (self->*Get)() : nullptr;
}

template <class T, QelVidColor (T::*Get)() const>
QelVidColor QelRovSYPGetColor(QelBaseUnknown* object) {
  T* self = QelRovSYPSelf<T>(object);
  return self ? (self->*Get)() : QelVidColor();
}

template <class T, void (T::*Member)(QelBaseUnknown*, QelSYPEventArgs*)>
QelSYPEventHandler* QelRovSYPMakeHandler(QelBaseUnknown* i_pObj) {
  if (!QelTkCheckPointer(i_pObj, "i_pObj")) return nullptr;
  T* pObj = QelRovSYPSelf<T>(i_pObj);
  if (!QelTkCheckPointer(pObj, "pObj")) return nullptr;
  return new QelSYPWRefMethEventHandler<T>(pObj, Member);
}

template <class T>
QelBaseUnknown* QelRovSYPCreate() {
  return new T();
}
