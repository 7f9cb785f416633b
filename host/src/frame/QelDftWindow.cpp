#include "QelDftWindow.h"

#include "QelMetaObject.h"

const QelMetaObject& QelDftWindow::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelDftWindow", QelMetaKind::Implementation, &QelFrmWindow::MetaObject(), "QelHost");
  return meta;
}
