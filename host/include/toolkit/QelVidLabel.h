#pragma once
// QelVidLabel: a text ("text") or an icon ("icon", a resource name) shown in a template.
#include "QelVidWidget.h"

class QelVidLabel : public QelVidWidget {
 public:
  using QelVidWidget::QelVidWidget;
  const char* GetWidgetKind() const override { return "Label"; }

 protected:
  ~QelVidLabel() override = default;
};
