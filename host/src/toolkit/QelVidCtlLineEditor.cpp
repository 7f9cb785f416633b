#include "QelVidCtlLineEditor.h"

#include "QelSYPEventFactory.h"

bool QelVidCtlLineEditor::Enter(const QelUnicodeString& text) {
  if (!IsEnabled()) return false;
  SetText(text);
  return Raise(TextEnteredEvent());
}

QelSYPEvent* QelVidCtlLineEditor::TextEnteredEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("TextEntered", QelSYPEvent::Local, "QelSYPEventArgs", &QelVidCtl::MetaObject());
  return event;
}

QelSYPEvent* QelVidCtlLineEditor::FindEvent(const std::string& name) const {
  if (name == "TextEntered") return TextEnteredEvent();
  return QelVidCtl::FindEvent(name);
}
