#include "QelVidCtlExpander.h"

#include "QelSYPEventFactory.h"

void QelVidCtlExpander::SetHeader(QelVidWidget* header) {
  if (header_) RemoveChild(header_);
  header_ = header;
  if (header) AddChild(header);
}

void QelVidCtlExpander::SetBody(QelVidWidget* body) {
  if (body_) RemoveChild(body_);
  body_ = body;
  if (body) AddChild(body);
}

void QelVidCtlExpander::Expand() {
  SetExpandedState(true);
  Raise(ExpandedEvent());
}

void QelVidCtlExpander::Collapse() {
  SetExpandedState(false);
  Raise(CollapsedEvent());
}

QelSYPEvent* QelVidCtlExpander::ExpandedEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("Expanded", QelSYPEvent::Local, "QelSYPEventArgs", &QelVidCtl::MetaObject());
  return event;
}

QelSYPEvent* QelVidCtlExpander::CollapsedEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("Collapsed", QelSYPEvent::Local, "QelSYPEventArgs", &QelVidCtl::MetaObject());
  return event;
}

QelSYPEvent* QelVidCtlExpander::FindEvent(const std::string& name) const {
  if (name == "Expanded") return ExpandedEvent();
  if (name == "Collapsed") return CollapsedEvent();
  return QelVidCtl::FindEvent(name);
}
