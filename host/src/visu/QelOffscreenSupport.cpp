#include "QelOffscreenSupport.h"

#include <cstdio>
#include <memory>

#include "QelRasterizer.h"
#include "QelTextRenderer.h"
#include "QelViewer.h"

QelOffscreenSupport::QelOffscreenSupport(QelSupport* source, QelPixelImage* image)
    : source_(source), image_(QelVar<QelPixelImage>::Retain(image)) {}

void QelOffscreenSupport::SetBackgroundColor(float red, float green, float blue) {
  background_[0] = red;
  background_[1] = green;
  background_[2] = blue;
}

namespace {
// One face for the process: opening the font costs more than drawing a thumbnail's texts.
// Said once when the font is missing, then pictures go on without texts.
const QelTextRenderer* SharedText() {
  static const std::unique_ptr<QelTextRenderer> text = [] {
    auto made = std::make_unique<QelTextRenderer>();
    if (!made->IsReady()) std::fprintf(stderr, "qelhost: annotation texts are left out: %s\n", made->Error().c_str());
    return made;
  }();
  return text->IsReady() ? text.get() : nullptr;
}
}  // namespace

HRESULT QelOffscreenSupport::Draw() {
  auto* support = dynamic_cast<QelSupport*>(source_.GetRaw());
  QelViewer* viewer = support ? support->GetViewer() : nullptr;
  if (!viewer) return E_FAIL;
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  QelRenderScene scene;
  if (QelIVisuSceneSource* source = viewer->GetSceneSource()) source->CollectScene(scene, viewpoint->GetFilter());

  QelRenderView view;
  view.eye = viewpoint->GetOrigin();
  view.sight = viewpoint->GetSightDirection().ToDouble();
  view.up = viewpoint->GetUpDirection().ToDouble();
  view.fieldOfView = viewpoint->GetFieldOfView();
  view.clipping = viewpoint->GetClippingPlanes();
  view.background = {background_[0], background_[1], background_[2]};
  view.shading = viewer->ViewMode(QelViewModeShading) != 0;
  view.annotations = viewer->ViewMode(QelViewModeAnnotations) != 0;
  view.text = textSprites_ ? SharedText() : nullptr;
  updateSprites_ = 0;
  unplaced_.clear();
  QelRasterizer::Render(scene, view, *image_, &unplaced_);
  return S_OK;
}

QelVar<QelOffscreenSupport> createSupport(QelSupport* support, QelPixelImage* image) {
  // A support without a surface (a window shrunk to nothing) has nothing to render from.
  if (!support || !image || image->GetWidth() == 0 || support->GetWidth() <= 0 || support->GetHeight() <= 0) return {};
  return QelMakeVar<QelOffscreenSupport>(support, image);
}
