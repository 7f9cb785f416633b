#pragma once
// QelDbrFraPanel: a docked panel window around one applicative widget (its content), with
// a title, an icon, button flags and a default button. Once inserted into a viewer the
// viewer's dock holds it; RequestDelayedDestruction takes it out of the dock and lets the
// host's idle loop release it (and its content) after the dispatch that asked for it.
#include <vector>

#include "QelUnicodeString.h"
#include "QelVidWidget.h"

class QelDbrFraPanel : public QelVidWidget {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // Dock areas are bits (0x08 left, 0x10 right); `floating` may leave the dock.
  QelDbrFraPanel(QelBaseUnknown* parentCommand, const QelString& name, QelVidWidget* content, int allowedDockAreas,
                 int dockArea, bool floating);
  const char* GetWidgetKind() const override { return "Panel"; }

  void SetTitle(const QelUnicodeString& title) { SetAttribute("text", title); }
  QelUnicodeString GetTitle() const { return TextAttribute("text"); }
  void SetIconName(const QelString& icon) { SetAttribute("icon", QelUnicodeString(icon.CastToCharPtr())); }
  QelUnicodeString GetIconName() const { return TextAttribute("icon"); }
  void SetCloseButtonFlag(int flag) { SetAttribute("closeButton", flag ? 1 : 0); }
  int GetCloseButtonFlag() const { return IntAttribute("closeButton", 1); }
  void SetMinimizeButtonFlag(int flag) { SetAttribute("minimizeButton", flag ? 1 : 0); }
  int GetMinimizeButtonFlag() const { return IntAttribute("minimizeButton", 0); }
  int GetAllowedDockAreas() const { return allowedDockAreas_; }
  int GetDockArea() const { return dockArea_; }
  bool IsFloating() const { return floating_; }

  // The button a person's Enter key presses; held weakly, null once gone.
  void SetDefaultButton(QelVidWidget* button);
  QelVidWidget* GetDefaultButton() const;

  // Replaces the content; the old content leaves the panel (a caller that still needs it
  // holds it first). Null empties the panel.
  void SetApplicativeWidget(QelVidWidget* content);
  QelVidWidget* GetApplicativeWidget() const { return GetChildCount() > 0 ? GetChild(0) : nullptr; }

  // Docks the panel in `viewer`, whose dock then holds it; E_FAIL for a null viewer,
  // S_FALSE when already docked there. A panel docked elsewhere moves.
  HRESULT InsertInViewer(QelBaseUnknown* viewer);
  // The viewer the panel is docked in, or null.
  QelBaseUnknown* GetViewer() const;
  // The panels docked in `viewer`, in order of insertion.
  static std::vector<QelDbrFraPanel*> PanelsInViewer(QelBaseUnknown* viewer);

  // Leaves the dock and is queued for release when the host is idle. Once only.
  void RequestDelayedDestruction();
  bool IsDestructionRequested() const { return destructionRequested_; }

 protected:
  ~QelDbrFraPanel() override;

 private:
  void LeaveDock();

  QelBaseUnknown_WR defaultButton_;
  int allowedDockAreas_;
  int dockArea_;
  bool floating_;
  bool destructionRequested_ = false;
};
