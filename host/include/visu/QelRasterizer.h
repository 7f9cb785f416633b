#pragma once
// QelRasterizer: draws a QelRenderScene into a pixel image with a z-buffer: pure functions
// of their arguments, no render state kept between calls. Shapes are flat or Lambert
// shaded with a light at the eye; back faces are culled unless clipping opens the shapes,
// then drawn flat and hatched as the cut's cap. Annotation marks are drawn over the shapes.
#include <string>
#include <vector>

#include "QelMathPlane.h"
#include "QelPixelImage.h"
#include "QelRenderScene.h"

class QelTextRenderer;

struct QelRenderView {
  QelMathPoint eye{0.0, 0.0, 1000.0};
  QelMathVector sight{0.0, 0.0, -1.0};
  QelMathVector up{0.0, 1.0, 0.0};
  float fieldOfView = 30.0f;  // vertical, degrees
  std::vector<QelMathPlane> clipping{};
  QelRenderColor background{0.5f, 0.5f, 0.5f};
  bool shading = true;
  bool annotations = true;
  const QelTextRenderer* text = nullptr;  // none: frames without texts
};

namespace QelRasterizer {
// Fills `image` with the background and draws `scene` seen from `view`. The texts of the
// labels that found no free place are appended to `unplaced` when given.
void Render(const QelRenderScene& scene, const QelRenderView& view, QelPixelImage& image,
            std::vector<std::string>* unplaced = nullptr);
}  // namespace QelRasterizer
