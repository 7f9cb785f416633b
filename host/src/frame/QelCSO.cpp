#include "QelCSO.h"

#include "QelCallbackManager.h"
#include "QelMetaObject.h"

const QelMetaObject& QelCSO::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelCSO", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

bool QelCSO::SetSelection(const QelListValQelBaseUnknown_var& objects) {
  QelListValQelBaseUnknown_var fresh;
  for (const auto& object : objects)
    if (object) fresh.Append(object);
  bool same = fresh.Size() == elements_.Size();
  for (int i = 1; same && i <= fresh.Size(); ++i) same = fresh[i]->IsEqual(elements_[i].get());
  if (same) return false;
  elements_ = std::move(fresh);
  QelCallbackManager::Get().Dispatch(this, kQelCSOChangeNotification);
  return true;
}

bool QelCSO::SetSelection(QelBaseUnknown* object) {
  QelListValQelBaseUnknown_var one;
  if (object) one.Append(object);
  return SetSelection(one);
}

bool QelCSO::Empty() { return SetSelection(QelListValQelBaseUnknown_var()); }
