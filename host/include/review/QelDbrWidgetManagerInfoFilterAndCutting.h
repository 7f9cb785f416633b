#pragma once
// How a filter and a clipping are shown while applied: whether the viewer's widgets are
// told. A small counted value handed to the controller; the defaults are what previews use.
#include "QelVar.h"

class QelDbrWidgetManagerInfoFilterAndCutting : public QelBaseUnknown {
 public:
  QelDbrWidgetManagerInfoFilterAndCutting() = default;
  bool notifyWidgets = false;

 protected:
  ~QelDbrWidgetManagerInfoFilterAndCutting() override = default;
};
