#pragma once
// QelApplicationFrame: the one application frame of the process, owner of the layout and
// the workbench context, and the dispatcher of application-wide notifications. The host
// makes it with CreateFrame and ends it with DestroyFrame; everything else borrows it.
#include <string_view>

#include "QelCallbackManager.h"
#include "QelFrmContext.h"
#include "QelFrmLayout.h"

class QelApplicationFrame : public QelBaseUnknown {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // Makes the process's frame in `workbench`, or gives the existing one unchanged.
  static QelApplicationFrame* CreateFrame(const QelString& workbench = {});
  // Releases the frame, its layout, windows and context; pointers lent before dangle.
  static void DestroyFrame();
  // Borrowed, null before CreateFrame.
  static QelApplicationFrame* GetFrame();

  QelFrmLayout* GetLayout() const { return layout_.get(); }
  QelFrmContext* GetContext() const { return context_.get(); }
  // The frame publishes application-wide notifications (kQelAfrAccessChanged) itself.
  QelBaseUnknown* GetDispatcher() { return this; }
  // The top-level window that dialogs take as parent; null until the toolkit sets one.
  QelBaseUnknown* GetMainWindow() const { return mainWindow_.get(); }
  void SetMainWindow(QelBaseUnknown* window) { mainWindow_ = QelVar<QelBaseUnknown>(window); }

  // Forwarders to QelCallbackManager, for code written against the frame.
  QelCallbackId AddCallback(QelBaseUnknown* publisher, std::string_view notification, QelBaseUnknown* subscriber,
                            QelCallbackFn fn);
  bool RemoveCallback(QelCallbackId id);
  int RemoveCallbacksOn(QelBaseUnknown* publisher, QelBaseUnknown* subscriber, std::string_view notification = {});

 protected:
  explicit QelApplicationFrame(const QelString& workbench);
  ~QelApplicationFrame() override = default;

 private:
  QelVar<QelFrmLayout> layout_;
  QelVar<QelFrmContext> context_;
  QelBaseUnknown_var mainWindow_;
};
