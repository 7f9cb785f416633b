#pragma once
// QelVidSpacer: empty room in a layout; its minimum dimension is all it has.
#include "QelVidWidget.h"

class QelVidSpacer : public QelVidWidget {
 public:
  QelVidSpacer() : QelVidWidget(nullptr, QelString("Spacer")) {}
  QelVidSpacer(QelVidWidget* parent, const QelString& name) : QelVidWidget(parent, name) {}
  const char* GetWidgetKind() const override { return "Spacer"; }

 protected:
  ~QelVidSpacer() override = default;
};
