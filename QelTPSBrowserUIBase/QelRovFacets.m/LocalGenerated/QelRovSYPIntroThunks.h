#pragma once
// Adapters from the widgets' member functions to the plain function pointers of the
// introspection tables. A getter or setter handed an object of another class reads 0 (or
// an empty text) and writes nothing; a handler factory checks its object ("i_pObj",
// "pObj") and gives no handler when the check fails.
#include "QelSYPMetaClass.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelToolkitCheck.h"

template <class T, int (T::*Get)() const>
int QelRovSYPGetInt(QelBaseUnknown* object) {
  T* self = QelSysDynamicCast<T>(object);
  return self ? (self->*Get)() : 0;
}

template <class T, void (T::*Set)(int)>
void QelRovSYPSetInt(QelBaseUnknown* object, int value) {
  if (T* self = QelSysDynamicCast<T>(object)) (self->*Set)(value);
}

template <class T, QelUnicodeString (T::*Get)() const>
QelUnicodeString QelRovSYPGetText(QelBaseUnknown* object) {
  T* self = QelSysDynamicCast<T>(object);
  return self ? (self->*Get)() : QelUnicodeString();
}

template <class T, QelBaseUnknown* (T::*Get)() const>
QelBaseUnknown* QelRovSYPGetBoxed(QelBaseUnknown* object) {
  T* self = QelSysDynamicCast<T>(object);
  return self ? (self->*Get)() : nullptr;
}

template <class T, void (T::*Member)(QelBaseUnknown*, QelSYPEventArgs*)>
QelSYPEventHandler* QelRovSYPMakeHandler(QelBaseUnknown* i_pObj) {
  if (!QelTkCheckPointer(i_pObj, "i_pObj")) return nullptr;
  T* pObj = QelSysDynamicCast<T>(i_pObj);
  if (!QelTkCheckPointer(pObj, "pObj")) return nullptr;
  return new QelSYPWRefMethEventHandler<T>(pObj, Member);
}

template <class T>
QelBaseUnknown* QelRovSYPCreate() {
  return new T();
}
