#include "QelSettingNotif.h"

#include "QelMetaObject.h"

const QelMetaObject& QelSettingNotif::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelSettingNotif", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}
