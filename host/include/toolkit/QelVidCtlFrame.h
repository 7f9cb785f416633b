#pragma once
// QelVidCtlFrame: a plain container of a template. Attribute "layout" is "row" (its
// children side by side, one line of text) or "column" (the default, one under another);
// "background" and "border" are colours.
#include "QelVidWidget.h"

class QelVidCtlFrame : public QelVidWidget {
 public:
  using QelVidWidget::QelVidWidget;
  const char* GetWidgetKind() const override { return "Frame"; }
  bool IsRow() const { return TextAttribute("layout") == QelUnicodeString("row"); }

 protected:
  ~QelVidCtlFrame() override = default;
};
