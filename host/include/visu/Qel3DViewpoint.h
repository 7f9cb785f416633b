#pragma once
// Qel3DViewpoint: the eye of a 3D viewer: eye point (double precision), sight and up
// (single-precision directions), target, the field of view and the aspect of the surface
// it is shown on, plus the clipping planes and display filter currently applied to it.
// Owned by its viewer; others hold it through handles for the length of a call.
#include <vector>

#include "QelI3DCamera.h"
#include "QelIVisuObjectFilter.h"
#include "QelMathPlane.h"
#include "QelMathVectorf.h"

class Qel3DViewpoint : public QelBaseUnknown {
 public:
  Qel3DViewpoint() = default;

  const QelMathPoint& GetOrigin() const { return eye_; }
  void SetOrigin(const QelMathPoint& eye) { eye_ = eye; }
  const QelMathDirectionf& GetSightDirection() const { return sight_; }
  const QelMathDirectionf& GetUpDirection() const { return up_; }
  void SetOrientation(const QelMathDirectionf& sight, const QelMathDirectionf& up) {
    sight_ = sight;
    up_ = up;
  }
  const QelMathPointf& GetTarget() const { return target_; }
  void SetTarget(const QelMathPointf& target) { target_ = target; }
  // Vertical angle of view in degrees.
  float GetFieldOfView() const { return fieldOfView_; }
  void SetFieldOfView(float degrees) { fieldOfView_ = degrees; }

  // Brings the viewpoint in line with a display surface: its origin and size in pixels.
  void SetSupportArea(float x, float y, float width, float height);
  float GetAspectRatio() const { return aspect_; }

  // Clipping: what lies on the side a plane's normal points to is cut away.
  void AddClippingPlane(const QelMathPlane& plane) { clipping_.push_back(plane); }
  void RemoveClippingPlanes() { clipping_.clear(); }
  const std::vector<QelMathPlane>& GetClippingPlanes() const { return clipping_; }
  void SetFilter(QelIVisuObjectFilter* filter) { filter_ = QelVar<QelIVisuObjectFilter>::Retain(filter); }
  QelIVisuObjectFilter* GetFilter() const { return filter_.get(); }

 protected:
  ~Qel3DViewpoint() override = default;

 private:
  QelMathPoint eye_{0.0, 0.0, 1000.0};
  QelMathDirectionf sight_{QelMathVector{0.0, 0.0, -1.0}};
  QelMathDirectionf up_{QelMathVector{0.0, 1.0, 0.0}};
  QelMathPointf target_{};
  float fieldOfView_ = 30.0f;
  float aspect_ = 4.0f / 3.0f;
  std::vector<QelMathPlane> clipping_;
  QelVar<QelIVisuObjectFilter> filter_;
};

// Puts `camera` into `viewpoint`: eye, target, sight and up (the up direction made square
// to the sight). `mode` 0 is the only mode: a plain copy, no animation.
HRESULT ApplyCameraToViewpoint(Qel3DViewpoint* viewpoint, QelI3DCamera* camera, int mode);
