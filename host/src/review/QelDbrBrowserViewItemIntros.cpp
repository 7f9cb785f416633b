#include "QelDbrBrowserViewItemIntros.h"

#include "QelIVIABaseUI.h"
#include "QelMetaObject.h"

const QelMetaObject& QelDbrBrowserViewItemIntros::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelDbrBrowserViewItemIntros", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelReviewFramework");
  return meta;
}

void* QelDbrBrowserViewItemIntros::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelISYPIntrospectable, QelIAfrListItem>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

void QelDbrBrowserViewItemIntros::DispatchModifyProperty(const char*) { ++redraws_; }

void QelDbrBrowserViewItemIntros::SetShadingColor(const QelAfrColor& color) {
  shading_ = color;
  ++redraws_;
}

QelUnicodeString QelDbrBrowserViewItemIntros::GetText(const char* column) const {
  QelVar<QelIVIABaseUI> item{item_.Get().get()};
  QelUnicodeString text;
  if (item) item->GetPropertyValue(QelString(column), text);
  return text;
}
