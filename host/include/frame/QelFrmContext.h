#pragma once
// QelFrmContext: the workbench the user works in. Switching announces
// kQelAfrAccessChanged on the application frame's dispatcher; while that notification
// runs, GetWorkbenchName is still the workbench being left and GetNextWorkbenchName the
// one being entered. Owned by the application frame.
#include "QelBaseUnknown.h"
#include "QelString.h"

// Payload: the context.
inline constexpr const char* kQelAfrAccessChanged = "QelAfrAccessChangedNotification";

class QelFrmContext : public QelBaseUnknown {
 public:
  explicit QelFrmContext(const QelString& workbench = {}) : current_(workbench), next_(workbench) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // The application frame's context; borrowed, null without a frame.
  static QelFrmContext* GetContext();

  QelString GetWorkbenchName() const { return current_; }
  // Outside a switch, the same as GetWorkbenchName.
  QelString GetNextWorkbenchName() const { return next_; }

  // S_FALSE (and no notification) when already in that workbench.
  HRESULT SwitchWorkbench(const QelString& workbench);

 protected:
  ~QelFrmContext() override = default;

 private:
  QelString current_;
  QelString next_;
};
