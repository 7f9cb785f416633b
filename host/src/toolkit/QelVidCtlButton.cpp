#include "QelVidCtlButton.h"

#include "QelSYPEventFactory.h"

bool QelVidCtlButton::Click() {
  if (!IsEnabled()) return false;
  return Raise(ClickedEvent());
}

QelSYPEvent* QelVidCtlButton::ClickedEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("Clicked", QelSYPEvent::Local, "QelSYPEventArgs", &QelVidCtl::MetaObject());
  return event;
}

QelSYPEvent* QelVidCtlButton::FindEvent(const std::string& name) const {
  if (name == "Clicked") return ClickedEvent();
  return QelVidCtl::FindEvent(name);
}
