#include "QelVidCtlCheckButton.h"

#include "QelVidCtlButton.h"

bool QelVidCtlCheckButton::Click() {
  if (!IsEnabled()) return false;
  return Raise(QelVidCtlButton::ClickedEvent());
}

QelSYPEvent* QelVidCtlCheckButton::FindEvent(const std::string& name) const {
  if (name == "Clicked") return QelVidCtlButton::ClickedEvent();
  return QelVidCtl::FindEvent(name);
}
