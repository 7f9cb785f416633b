#pragma once
// QelISYPIntrospectable: an object whose properties the toolkit reads and writes by name
// (through its introspection meta class) and which tells the toolkit when one changed.
// The toolkit's widgets implement it directly.
#include "QelBaseUnknown.h"

class QelSYPMetaClass;

class QelISYPIntrospectable : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelISYPIntrospectable;
  static constexpr QelIID IID = QelIID::Parse("{9D3A6C21-4E8B-4F57-A1C2-5B7E0D914F36}");

  // The introspection meta class of the object's class; null when none is registered.
  virtual const QelSYPMetaClass* GetSYPMetaClass() const = 0;
  // Refreshes whatever shows the property; "" refreshes everything.
  virtual void DispatchModifyProperty(const char* propertyName) = 0;

 protected:
  ~QelISYPIntrospectable() override = default;
};

// The widgets' property-change notification: queries `self` for the interface; an
// implementation that is not a toolkit widget is reported ("Bad Introspectable
// implementation!") and nothing is dispatched; an object without it is left alone.
void QelSYPNotifyPropertyChange(QelBaseUnknown* self, const char* propertyName);
