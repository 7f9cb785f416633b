#include "QelSupport.h"

#include "QelViewer.h"

QelSupport::QelSupport(QelViewer* viewer, int width, int height) : viewer_(viewer), width_(width), height_(height) {}

void QelSupport::SetSize(int width, int height) {
  width_ = width;
  height_ = height;
}

void QelSupport::GetArea(float area[4]) const {
  area[0] = 0.0f;
  area[1] = 0.0f;
  area[2] = static_cast<float>(width_);
  area[3] = static_cast<float>(height_);
}

QelViewer* QelSupport::GetViewer() const { return dynamic_cast<QelViewer*>(viewer_.GetRaw()); }
