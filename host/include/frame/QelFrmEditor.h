#pragma once
// QelFrmEditor: one open document: its root object, its selection (QelCSO) and its
// UI-active path. Windows of the layout hold their editor; the editor knows nothing of its
// windows. Closing goes through QelFrmLayout::CloseEditor; a closed editor lives on while
// handles remain, but has no windows any more.
#include "QelCSO.h"
#include "QelPathElement.h"

// Published on the current layout (payload: the editor) and on the editor itself (no
// payload) when the editor's UI-active path changes.
inline constexpr const char* kQelUIActiveObjectChanged = "UIACTIVEOBJECT_CHANGED";

class QelFrmEditor : public QelBaseUnknown {
 public:
  explicit QelFrmEditor(QelBaseUnknown* root = nullptr);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // The editor of the current window of the current layout; borrowed, may be null.
  static QelFrmEditor* GetCurrentEditor();

  QelBaseUnknown_var GetRootObject() const { return root_; }
  void SetRootObject(QelBaseUnknown* root) { root_ = QelVar<QelBaseUnknown>(root); }

  // Borrowed; lives as long as the editor.
  QelCSO* GetCSO() const { return cso_.get(); }
  bool SetSelection(const QelListValQelBaseUnknown_var& objects) { return cso_->SetSelection(objects); }
  bool SetSelection(QelBaseUnknown* object) { return cso_->SetSelection(object); }

  // A copy of the path, never null (empty when nothing is UI-active): changing the path
  // behind the editor's back would skip the notification, so it is never handed out.
  QelVar<QelPathElement> GetUIActivePath() const { return uiActivePath_->Copy(); }
  // Stores a copy (null: nothing UI-active) and announces kQelUIActiveObjectChanged when
  // the path differs from the one held.
  void SetUIActivePath(QelPathElement* path);

  bool IsClosed() const { return closed_; }

 protected:
  ~QelFrmEditor() override = default;

 private:
  friend class QelFrmLayout;
  QelBaseUnknown_var root_;
  QelVar<QelCSO> cso_;
  QelVar<QelPathElement> uiActivePath_;
  bool closed_ = false;
};
