#include "Qel2DLWindow.h"

#include "QelMetaObject.h"

const QelMetaObject& Qel2DLWindow::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("Qel2DLWindow", QelMetaKind::Implementation, &QelFrmWindow::MetaObject(), "QelHost");
  return meta;
}
