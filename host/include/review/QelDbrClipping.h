#pragma once
// QelDbrClipping: a clipping of the review: a plane in the context's coordinates; applied
// to a viewpoint, it cuts away what lies on the side the plane's normal points to.
#include "QelMathPlane.h"
#include "QelVar.h"

class QelDbrClipping : public QelBaseUnknown {
 public:
  explicit QelDbrClipping(const QelMathPlane& plane) : plane_(plane) {}
  const QelMathPlane& GetPlane() const { return plane_; }

 protected:
  ~QelDbrClipping() override = default;

 private:
  QelMathPlane plane_;
};
