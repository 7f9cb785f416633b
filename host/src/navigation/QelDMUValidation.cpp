#include "QelDMUValidation.h"

#include "QelMetaObject.h"

const QelMetaObject& QelDMUValidation::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "PCCMemDMUValidationValidation", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelProductNavigation");
  return meta;
}
