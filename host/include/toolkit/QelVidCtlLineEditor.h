#pragma once
// QelVidCtlLineEditor: one line of editable text. SetText from code raises nothing; a
// person's Enter raises "TextEntered" with the editor as origin.
#include "QelVidCtl.h"

class QelVidCtlLineEditor : public QelVidCtl {
 public:
  QelVidCtlLineEditor(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "LineEditor"; }

  QelUnicodeString GetText() const { return TextAttribute("text"); }
  void SetText(const QelUnicodeString& text) { SetAttribute("text", text); }
  // False (nothing changed or raised) while disabled.
  bool Enter(const QelUnicodeString& text);

  static QelSYPEvent* TextEnteredEvent();
  QelSYPEvent* FindEvent(const std::string& name) const override;

 protected:
  ~QelVidCtlLineEditor() override = default;
};
