#pragma once
// QelFrmWindow: the base of the document windows of a layout. A window holds its editor
// and its viewer; the kinds (Qel3DWindow, Qel2DLWindow, QelDftWindow) are subclasses so
// that IsAKindOf answers through their meta classes.
#include "QelFrmEditor.h"

class QelFrmWindow : public QelBaseUnknown {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // Borrowed; valid while the window lives.
  QelFrmEditor* GetEditor() const { return editor_.get(); }
  // The window's viewer, null until the host puts one in.
  QelBaseUnknown_var GetViewer() const { return viewer_; }
  void SetViewer(QelBaseUnknown* viewer) { viewer_ = QelVar<QelBaseUnknown>(viewer); }

 protected:
  explicit QelFrmWindow(QelFrmEditor* editor) : editor_(QelVar<QelFrmEditor>::Retain(editor)) {}
  ~QelFrmWindow() override = default;

 private:
  QelVar<QelFrmEditor> editor_;
  QelBaseUnknown_var viewer_;
};
