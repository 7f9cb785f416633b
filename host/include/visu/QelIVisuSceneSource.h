#pragma once
// What a viewer shows: something that lists, on request, the shapes and annotations that
// are visible now, in the viewer's world coordinates. The viewer holds its source counted;
// a source must not hold its viewer (a weak link at most).
#include "QelRenderScene.h"
#include "QelVar.h"

class QelIVisuObjectFilter;

class QelIVisuSceneSource : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIVisuSceneSource;
  static constexpr QelIID IID = QelIID::Parse("{2D7F4A90-1B6C-4E35-9C08-E5A3B1D6F742}");

  // Appends what is shown and not left out by `filter` (may be null).
  virtual void CollectScene(QelRenderScene& scene, QelIVisuObjectFilter* filter) = 0;

 protected:
  ~QelIVisuSceneSource() override = default;
};
