#pragma once
// QelFrmLayout: the windows of the application and which one is current. The layout holds
// each window it lists (and, through it, the window's editor); the application frame owns
// the layout. Activating a window and closing an editor are announced on the layout.
#include "QelFrmWindow.h"
#include "QelListValQelBaseUnknown_var.h"

// Payload: the window that became current.
inline constexpr const char* kQelWindowActivated = "WINDOW_ACTIVATED";
// Payload: the editor that was closed, after its windows left the layout.
inline constexpr const char* kQelEditorCloseEnded = "EDITOR_CLOSE_ENDED";

class QelFrmLayout : public QelBaseUnknown {
 public:
  QelFrmLayout() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // The application frame's layout; borrowed, null without a frame.
  static QelFrmLayout* GetCurrentLayout();

  // Borrowed, may be null.
  QelFrmWindow* GetCurrentWindow() const { return current_.get(); }
  // The windows in the order they were added, kept to those of `editor` and of class
  // `kind` (IsAKindOf) when given.
  QelListValQelBaseUnknown_var GetWindowList(QelFrmEditor* editor = nullptr, const char* kind = nullptr) const;

  // S_FALSE when the window is already listed; E_FAIL for null. Does not activate it.
  HRESULT AddWindow(QelFrmWindow* window);
  // A removed current window hands over to the last remaining window (announced).
  HRESULT RemoveWindow(QelFrmWindow* window);
  // Announces kQelWindowActivated when the current window changes; E_FAIL for a window that
  // is not listed. Null leaves no window current, silently.
  HRESULT SetCurrentWindow(QelFrmWindow* window);

  // Removes the editor's windows, marks it closed, announces kQelEditorCloseEnded, then
  // activates the last remaining window when the current one went. S_FALSE when the editor
  // was already closed.
  HRESULT CloseEditor(QelFrmEditor* editor);

 protected:
  ~QelFrmLayout() override = default;

 private:
  void ActivateAfterRemoval();

  QelListValQelBaseUnknown_var windows_;
  QelVar<QelFrmWindow> current_;
};
