#include "QelBoxingOfQelVidColor.h"

QelBaseUnknown* QelBoxingOfQelVidColor::Box(const QelVidColor& color) {
  return new QelBoxedQelVidColor(color);
}

bool QelBoxingOfQelVidColor::Unbox(QelBaseUnknown* boxed, QelVidColor& color) {
  auto* box = boxed ? dynamic_cast<QelBoxedQelVidColor*>(boxed->GetImpl()) : nullptr;
  if (!box) return false;
  color = box->Color();
  return true;
}
