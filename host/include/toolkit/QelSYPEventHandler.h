#pragma once
// QelSYPEventHandler: what a widget calls when an event reaches it. Counted; a widget
// holds one reference per connection. `args` is whatever the dispatcher passed; handlers
// check its type themselves.
#include "QelBaseUnknown.h"

class QelVidWidget;

class QelSYPEventHandler : public QelBaseUnknown {
 public:
  virtual void HandleEvent(QelVidWidget* current, QelBaseUnknown* args) = 0;

 protected:
  ~QelSYPEventHandler() override = default;
};
