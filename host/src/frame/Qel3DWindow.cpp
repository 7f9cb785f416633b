#include "Qel3DWindow.h"

#include "QelMetaObject.h"

const QelMetaObject& Qel3DWindow::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("Qel3DWindow", QelMetaKind::Implementation, &QelFrmWindow::MetaObject(), "QelHost");
  return meta;
}
