#include "QelAdapterVIABaseUI.h"

#include "QelMetaObject.h"

const QelMetaObject& QelAdapterVIABaseUI::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelAdapterVIABaseUI", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelReviewFramework");
  return meta;
}
