#pragma once
// A display filter a viewpoint carries while a review filter is applied: it says which
// model objects are left out of the picture. Counted; the viewpoint holds it until removed.
#include "QelVar.h"

class QelIVisuObjectFilter : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIVisuObjectFilter;
  static constexpr QelIID IID = QelIID::Parse("{9E3B6C21-47A0-4D8F-B2C5-6A1E0F3D7B94}");

  virtual bool IsFilteredOut(QelBaseUnknown* object) = 0;
  // True for an object the picture shows even while the display hides it: a capture's
  // preview shows what activating the capture will show, whatever the panel hides now.
  virtual bool IsKeptIn(QelBaseUnknown* /*object*/) { return false; }

 protected:
  ~QelIVisuObjectFilter() override = default;
};
