#pragma once
// QelVidCtlImageAndLabelCombo: a drop-down list of lines (text and optional image).
// SetSelectedIndex from code raises nothing; a person's Select raises "SelectionChanged".
#include <vector>

#include "QelVidCtl.h"

class QelVidCtlImageAndLabelCombo : public QelVidCtl {
 public:
  QelVidCtlImageAndLabelCombo(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "Combo"; }

  void ClearLines();
  // Sets the line at `index`, or appends it for -1 (or one past the end). `flags` is
  // reserved. The line's position, or -1 for an index beyond the end.
  int SetLine(const QelUnicodeString& text, const char* image, int index, int flags);
  int GetLineCount() const { return static_cast<int>(lines_.size()); }
  QelUnicodeString GetLine(int index) const;
  // -1 clears the selection; an index outside the lines is refused (false).
  bool SetSelectedIndex(int index);
  int GetSelectedIndex() const { return selected_; }

  // A person's choice: selects and raises; false (nothing raised) outside the lines or
  // while disabled.
  bool Select(int index);

  static QelSYPEvent* SelectionChangedEvent();
  QelSYPEvent* FindEvent(const std::string& name) const override;

 protected:
  ~QelVidCtlImageAndLabelCombo() override = default;

 private:
  std::vector<QelUnicodeString> lines_;
  int selected_ = -1;
};
