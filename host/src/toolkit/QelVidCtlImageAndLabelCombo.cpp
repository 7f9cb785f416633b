#include "QelVidCtlImageAndLabelCombo.h"

#include "QelSYPEventFactory.h"

void QelVidCtlImageAndLabelCombo::ClearLines() {
  lines_.clear();
  selected_ = -1;
  SetAttribute("selected", QelUnicodeString());
}

int QelVidCtlImageAndLabelCombo::SetLine(const QelUnicodeString& text, const char*, int index, int) {
  const int count = GetLineCount();
  if (index < 0 || index == count) {
    lines_.push_back(text);
    return count;
  }
  if (index > count) return -1;
  lines_[index] = text;
  if (index == selected_) SetAttribute("selected", text);
  return index;
}

QelUnicodeString QelVidCtlImageAndLabelCombo::GetLine(int index) const {
  return index >= 0 && index < GetLineCount() ? lines_[index] : QelUnicodeString();
}

bool QelVidCtlImageAndLabelCombo::SetSelectedIndex(int index) {
  if (index < -1 || index >= GetLineCount()) return false;
  selected_ = index;
  // The shown text, for whoever draws the tree.
  SetAttribute("selected", GetLine(index));
  return true;
}

bool QelVidCtlImageAndLabelCombo::Select(int index) {
  if (!IsEnabled() || index < 0 || !SetSelectedIndex(index)) return false;
  return Raise(SelectionChangedEvent());
}

QelSYPEvent* QelVidCtlImageAndLabelCombo::SelectionChangedEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("SelectionChanged", QelSYPEvent::Local, "QelSYPEventArgs", &QelVidCtl::MetaObject());
  return event;
}

QelSYPEvent* QelVidCtlImageAndLabelCombo::FindEvent(const std::string& name) const {
  if (name == "SelectionChanged") return SelectionChangedEvent();
  return QelVidCtl::FindEvent(name);
}
