#pragma once
// QelSupport: the display surface of a viewer: its area in pixels. Owned by its viewer,
// which it sees weakly; off-screen supports are made from it (createSupport).
#include "QelBaseUnknown_WR.h"

class QelViewer;

class QelSupport : public QelBaseUnknown {
 public:
  QelSupport(QelViewer* viewer, int width, int height);

  int GetWidth() const { return width_; }
  int GetHeight() const { return height_; }
  void SetSize(int width, int height);
  // The four values a viewpoint takes to follow this surface: x, y, width, height.
  void GetArea(float area[4]) const;
  // Null once the viewer is gone.
  QelViewer* GetViewer() const;

 protected:
  ~QelSupport() override = default;

 private:
  QelBaseUnknown_WR viewer_;
  int width_;
  int height_;
};
