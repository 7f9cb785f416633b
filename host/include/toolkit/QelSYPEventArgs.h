#pragma once
// QelSYPEventArgs: the arguments of one dispatch: the event and the widget it started
// from (the origin). Counted; the origin is held while the arguments live.
#include "QelVar.h"

class QelSYPEvent;

class QelSYPEventArgs : public QelBaseUnknown {
 public:
  explicit QelSYPEventArgs(QelSYPEvent* event) : event_(event) {}

  QelSYPEvent* GetEvent() const { return event_; }
  void SetOrigin(QelBaseUnknown* origin) { origin_ = QelBaseUnknown_var(origin); }
  QelBaseUnknown* GetOrigin() const { return origin_.get(); }

 protected:
  ~QelSYPEventArgs() override = default;

 private:
  QelSYPEvent* event_;
  QelBaseUnknown_var origin_;
};
