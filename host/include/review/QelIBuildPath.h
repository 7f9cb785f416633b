#pragma once
// How an object of the model places itself under a root path: the path from the root
// down to the object. Answered through ties registered by QelReviewFramework.
#include "QelPathElement.h"

class QelIBuildPath : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIBuildPath;
  static constexpr QelIID IID = QelIID::Parse("{B4E81F2C-6A3D-4C97-8E15-2F90D7A6C3B8}");

  // A new path (one reference for the caller), or null when the object is not below `root`.
  virtual QelVar<QelPathElement> BuildPath(QelPathElement* root) = 0;

 protected:
  ~QelIBuildPath() override = default;
};
