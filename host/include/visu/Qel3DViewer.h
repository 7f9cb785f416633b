#pragma once
// Qel3DViewer: the viewer of a 3D window, the kind the review tools render with.
#include "QelViewer.h"

class Qel3DViewer : public QelViewer {
 public:
  using QelViewer::QelViewer;

 protected:
  ~Qel3DViewer() override = default;
};
