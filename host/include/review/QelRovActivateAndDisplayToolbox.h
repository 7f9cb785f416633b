#pragma once
// QelRovActivateAndDisplayToolbox: frames a viewpoint on what a view shows. Static.
#include "QelPathElement.h"

class Qel3DViewer;
class Qel3DViewpoint;

class QelRovActivateAndDisplayToolbox {
 public:
  QelRovActivateAndDisplayToolbox() = delete;

  // Looks square at the plane of the view at the leaf of `path` (a path that ends at no
  // view keeps the viewpoint's direction) and from a distance at which everything the
  // viewer shows fits the picture. E_FAIL for a null argument.
  static HRESULT ReframeViewpointOnDisplayArea(QelPathElement* path, Qel3DViewer* viewer, Qel3DViewpoint* viewpoint);
};
