#include "QelViewer.h"

QelViewer::QelViewer(int width, int height)
    : viewpoint_(QelMakeVar<Qel3DViewpoint>()), support_(QelMakeVar<QelSupport>(this, width, height)) {
  PrepareViewpoint();
}

QelViewer::~QelViewer() = default;

void QelViewer::PrepareViewpoint() {
  float area[4];
  support_->GetArea(area);
  viewpoint_->SetSupportArea(area[0], area[1], area[2], area[3]);
}
