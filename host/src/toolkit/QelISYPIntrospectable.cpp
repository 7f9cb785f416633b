#include "QelISYPIntrospectable.h"

#include "QelToolkitCheck.h"
#include "QelVar.h"
#include "QelVidWidget.h"

void QelSYPNotifyPropertyChange(QelBaseUnknown* self, const char* propertyName) {
  if (!self) return;
  QelVar<QelISYPIntrospectable> introspectable(self);
  if (!introspectable) return;
  auto* adapter = dynamic_cast<QelVidWidget*>(introspectable->GetImpl());
  if (!QelTkCheckCondition(adapter != nullptr, "Bad Introspectable implementation!")) return;
  adapter->DispatchModifyProperty(propertyName);
}
