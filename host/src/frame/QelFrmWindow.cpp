#include "QelFrmWindow.h"

#include "QelMetaObject.h"

const QelMetaObject& QelFrmWindow::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelFrmWindow", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}
