#pragma once
// QelVidCtlCheckButton: a check box, or a radio button when "radio" is 1. "checked" is
// 0, 1, or 2 for a partial state. A person's Click raises "Clicked" (while enabled) and
// changes nothing itself: the receiver decides what the new state is.
#include "QelVidCtl.h"

class QelVidCtlCheckButton : public QelVidCtl {
 public:
  QelVidCtlCheckButton(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "CheckButton"; }

  bool IsRadio() const { return IntAttribute("radio", 0) != 0; }
  int GetCheckState() const { return IntAttribute("checked", 0); }
  bool Click();

  QelSYPEvent* FindEvent(const std::string& name) const override;

 protected:
  ~QelVidCtlCheckButton() override = default;
};
