#include "QelRecord.h"

#include "QelMetaObject.h"

namespace {
QelVar<QelRecord>& Main() {
  static QelVar<QelRecord> main;
  return main;
}
}  // namespace

const QelMetaObject& QelRecord::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRecord", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelRecord* QelRecord::GetMain() { return Main().get(); }

void QelRecord::SetMain(QelRecord* recorder) { Main() = QelVar<QelRecord>::Retain(recorder); }
