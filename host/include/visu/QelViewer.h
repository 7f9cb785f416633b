#pragma once
// QelViewer: a viewer of a window: its main 3D viewpoint, its display support, its view
// modes (bit flags) and what it shows (a scene source). Owns viewpoint and support; holds
// the source counted. A window holds its viewer.
#include <cstdint>

#include "Qel3DViewpoint.h"
#include "QelIVisuSceneSource.h"
#include "QelSupport.h"

// View mode bits a renderer looks at; the other bits are kept and copied but mean nothing
// to the off-screen renderer.
enum QelViewModeBits : uint32_t {
  QelViewModeShading = 0x1,      // Lambert shading; off: flat colours
  QelViewModeEdges = 0x2,        // outline of each shape's silhouette triangles
  QelViewModeAnnotations = 0x4,  // annotation marks and texts
};

class QelViewer : public QelBaseUnknown {
 public:
  QelViewer(int width = 800, int height = 600);

  Qel3DViewpoint* GetMain3DViewpoint() const { return viewpoint_.get(); }
  QelSupport* GetSupport() const { return support_.get(); }

  // 1 when `bit` is set; `bit` is one flag.
  int ViewMode(uint32_t bit) const { return (modes_ & bit) ? 1 : 0; }
  void SetViewMode(uint32_t bit, int on) { modes_ = on ? (modes_ | bit) : (modes_ & ~bit); }
  uint32_t GetViewModes() const { return modes_; }

  // Removes every clipping plane of the main viewpoint.
  void RemoveClippingPlane() { viewpoint_->RemoveClippingPlanes(); }

  void SetSceneSource(QelIVisuSceneSource* source) { source_ = QelVar<QelIVisuSceneSource>::Retain(source); }
  QelIVisuSceneSource* GetSceneSource() const { return source_.get(); }

  // The preparation before a capture's viewpoint is applied: the viewpoint follows the support.
  void PrepareViewpoint();
  // Makes changed modes take effect; counts the updates.
  void Update() { ++updates_; }
  int GetUpdateCount() const { return updates_; }

 protected:
  ~QelViewer() override;

 private:
  QelVar<Qel3DViewpoint> viewpoint_;
  QelVar<QelSupport> support_;
  QelVar<QelIVisuSceneSource> source_;
  uint32_t modes_ = QelViewModeShading | QelViewModeAnnotations;
  int updates_ = 0;
};
