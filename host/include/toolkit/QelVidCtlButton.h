#pragma once
// QelVidCtlButton: a push button ("text"). A person's Click raises "Clicked" only while
// the button is enabled.
#include "QelVidCtl.h"

class QelVidCtlButton : public QelVidCtl {
 public:
  QelVidCtlButton(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "Button"; }

  // False when disabled (nothing raised).
  bool Click();

  static QelSYPEvent* ClickedEvent();
  QelSYPEvent* FindEvent(const std::string& name) const override;

 protected:
  ~QelVidCtlButton() override = default;
};
