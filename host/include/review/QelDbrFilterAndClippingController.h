#pragma once
// QelDbrFilterAndClippingController: puts a review filter and a clipping on a viewpoint
// and takes them off again. Static operations; the viewpoint holds what is applied.
#include "QelDbrClipping.h"
#include "QelDbrFilter.h"
#include "QelDbrWidgetManagerInfoFilterAndCutting.h"

class Qel3DViewpoint;

class QelDbrFilterAndClippingController {
 public:
  QelDbrFilterAndClippingController() = delete;

  // A new path holding only the root element of `path`; null for a null or empty path.
  static QelVar<QelPathElement> GetRootPath(QelPathElement* path);
  // Either may be null. E_FAIL for a null viewpoint.
  static HRESULT ApplyFilterAndClipping(QelDbrFilter* filter, QelDbrClipping* clipping, Qel3DViewpoint* viewpoint,
                                        QelDbrWidgetManagerInfoFilterAndCutting* info);
  // Removes every filter and clipping plane of the viewpoint; `mode` 0 is the only mode.
  static HRESULT RemoveFilterAndClipping(Qel3DViewpoint* viewpoint, int mode);
};
