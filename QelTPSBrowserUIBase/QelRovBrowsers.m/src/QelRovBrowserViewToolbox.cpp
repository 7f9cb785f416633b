#include "QelRovBrowserViewToolbox.h"

#include <cmath>
#include <memory>

#include "QelAnnotationComponents.h"
#include "QelAssert.h"
#include "QelDbrFilterAndClippingController.h"
#include "QelDbrFilterComponent.h"
#include "QelFrm3DCamera.h"
#include "QelFrmLayout.h"
#include "QelFrmWindow.h"
#include "QelIAlias.h"
#include "QelIBuildPath.h"
#include "QelIDriClippingFactory.h"
#include "QelIDriFilterFactory.h"
#include "QelILumCameraGeometry.h"
#include "QelILumCapture.h"
#include "QelILumSet.h"
#include "QelITPSExtractionView.h"
#include "QelITPSLight.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelOffscreenSupport.h"
#include "QelRovActivateAndDisplayToolbox.h"
#include "QelRovPathElementToolbox.h"

namespace {
constexpr int kThumbnailWidth = 576;
constexpr int kThumbnailHeight = 432;
constexpr int kCameraGeometryComponent = 74;

// Exactly 1 keeps the vector, exactly 0 gives the x axis, anything else is scaled.
QelMathVector Normalised(const QelMathVector& v) {
  const double s = v.x * v.x + v.y * v.y + v.z * v.z;
  if (s == 1.0) return v;
  if (s == 0.0) return {1.0, 0.0, 0.0};
  return v * (1.0 / std::sqrt(s));
}

// The view a capture is linked to: only a successful link query answering true counts.
QelBaseUnknown_var LinkedView(QelILumCapture* capture) {
  bool linked = false;
  QelBaseUnknown_var view;
  if (capture && capture->IsLinkedToView(linked) == S_OK && linked) capture->GetLinkedView(view);
  return view;
}

// The viewpoint follows the surface the viewer shows it on.
void FollowSupport(Qel3DViewer* viewer, Qel3DViewpoint* viewpoint) {
  float area[4];
  viewer->GetSupport()->GetArea(area);
  viewpoint->SetSupportArea(area[0], area[1], area[2], area[3]);
}

// A path made by CreateObjectPath, released with its handle.
QelVar<QelPathElement> MakePath(QelBaseUnknown_var& object, QelPathElement* root,
                                QelPathElement* (*create)(QelBaseUnknown_var&, QelPathElement*)) {
  return QelVar<QelPathElement>::Adopt(create(object, root));
}
}  // namespace

QelPathElement* QelRovBrowserViewToolbox::CreateObjectPath(QelBaseUnknown_var& object, QelPathElement* rootPath) {
  if (!rootPath) {
    QelAssertPointer();
    return nullptr;
  }
  QelVar<QelIBuildPath> builder{object.get()};
  if (!builder) {
    QelAssertNullHandler();
    return nullptr;
  }
  if (!QelVar<QelITPSLight>(object.get())) return builder->BuildPath(rootPath).Detach();
  QelVar<QelPathElement> copy = rootPath->Copy();
  if (!copy) {
    QelAssertPointer();
    return nullptr;
  }
  copy->AddChildElement(object.get());
  return copy.Detach();
}

HRESULT QelRovBrowserViewToolbox::ComputeCameraFromView(QelVar<QelITPSView>& view, QelVar<QelI3DCamera>& camera) {
  if (!view || !camera) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelVar<QelITPSView> reference;
  if (QelVar<QelITPSExtractionView> extraction{view.get()}) {
    QelVar<QelILumCollection> references;
    uint32_t count = 0;
    if (extraction->GetReferenceViews(references) == S_OK && references && references->GetCount(count) == S_OK &&
        count != 0) {
      QelBaseUnknown_var first;
      references->GetItem(0, first);
      reference = QelVar<QelITPSView>(first.get());
    }
  }
  if (!reference) reference = view;
  if (!reference) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelMathPlane* allocated = nullptr;
  reference->GetPlane(allocated);
  if (!allocated) return S_FALSE;
  const QelMathPlane plane = *allocated;
  delete allocated;

  const QelMathVector n = plane.GetNormal();
  if (n.x == 0.0 && n.y == 0.0 && n.z == 0.0) return S_FALSE;
  const QelMathVector sight = Normalised(-n);
  const QelMathVector up = plane.GetSecondDirection();
  QelMathPoint target, origin;
  camera->GetTarget(target);
  camera->GetOrigin(origin);
  const double distance = origin.DistanceTo(target);
  const QelMathPoint projected = plane.Projection(target);
  camera->SetOrigin(projected - sight * distance);
  camera->SetTarget(projected);
  camera->SetDirection(sight);
  camera->SetZenith(up);
  return S_OK;
}

HRESULT QelRovBrowserViewToolbox::ApplyCaptureViewpoint(QelPathElement* capturePath, Qel3DViewer* viewer,
                                                        QelPathElement* rootPath) {
  if (!capturePath || !viewer) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  capturePath->InitToLeafElement();
  QelVar<QelILumCapture> capture{capturePath->NextFatherElement().get()};
  if (!capture) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelVar<QelICamera> stored;
  capture->GetCamera(stored);
  if (stored) {
    QelMathTransformation toContext;
    QelRovPathElementToolbox::GetMechPartToContextTransfo(capturePath, toContext);
    QelVar<QelFrm3DCamera> created = QelMakeVar<QelFrm3DCamera>("UndefCam");
    if (!created) {
      QelAssertPointer();
      return E_UNEXPECTED;
    }
    QelVar<QelI3DCamera> camera{created.get()};
    created = nullptr;
    if (!camera) {
      QelAssertNullHandler();
      return E_UNEXPECTED;
    }
    camera->CopyFrom(stored.get());
    QelBaseUnknown_var made;
    QelLumInstantiateComponentBase(kCameraGeometryComponent, made);
    QelVar<QelILumCameraGeometry> geometry{made.get()};
    if (!geometry) {
      QelAssertPointer();
      return E_UNEXPECTED;
    }
    geometry->Bind(camera.get(), capturePath);
    QelMathPoint eye, target;
    QelMathVector sight, up;
    geometry->GetEyePoint(eye);
    geometry->GetSightVector(sight);
    geometry->GetUpVector(up);
    geometry->GetTargetPoint(target);
    const QelMathPoint o = toContext.Apply(eye);
    const QelMathVector s = Normalised(toContext.ApplyToVector(sight));
    const QelMathVector u = Normalised(toContext.ApplyToVector(up));
    const QelMathPoint p = toContext.Apply(target);
    camera->SetOrigin(o);
    camera->SetDirection(s);
    camera->SetZenith(u);
    camera->SetTarget(p);
    geometry = nullptr;
    made = nullptr;
    ApplyCameraToViewpoint(viewpoint, camera.get(), 0);
    viewpoint->SetOrigin(o);
    viewpoint->SetOrientation(QelMathDirectionf(s), QelMathDirectionf(u));
    viewpoint->SetTarget(QelMathPointf(p));
    return S_OK;
  }
  FollowSupport(viewer, viewpoint);
  QelBaseUnknown_var view = LinkedView(capture.get());
  if (!view) return S_FALSE;
  QelVar<QelPathElement> viewPath = MakePath(view, rootPath, CreateObjectPath);
  QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(viewPath.get(), viewer, viewpoint);
  return S_OK;
}

QelPixelImage* QelRovBrowserViewToolbox::GetThumbnailPreview(QelBaseUnknown_var& item, Qel3DViewer* viewer,
                                                             QelPathElement* rootPath) {
  if (!item) {
    QelAssertNullHandler();
    return nullptr;
  }
  if (!viewer) {
    QelAssertPointer();
    return nullptr;
  }
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  QelVar<QelITPSView> view{item.get()};
  QelVar<QelILumCapture> capture{item.get()};
  if (capture) view = QelVar<QelITPSView>(LinkedView(capture.get()).get());

  QelVar<QelDbrFilter> filter;
  QelVar<QelDbrClipping> clipping;
  if (view && !capture) {
    QelBaseUnknown_var setObject;
    if (view->GetSet(setObject) != S_OK) {
      QelAssertBool();
      return nullptr;
    }
    QelVar<QelILumSet> set{setObject.get()};
    if (!set) {
      QelAssertNullHandler();
      return nullptr;
    }
    QelVar<QelILumCollection> captures;
    if (set->GetCaptures(captures) != S_OK) {
      QelAssertBool();
      return nullptr;
    }
    if (!captures) {
      QelAssertPointer();
      return nullptr;
    }
    uint32_t count = 0;
    captures->GetCount(count);
    for (uint32_t i = 0; i < count; ++i) {
      QelBaseUnknown_var entry;
      if (captures->GetItem(i, entry) != S_OK) {
        QelAssertBool();
        continue;
      }
      if (!entry) {
        QelAssertPointer();
        continue;
      }
      QelVar<QelILumCapture> candidate{entry.get()};
      QelBaseUnknown_var linked = LinkedView(candidate.get());
      if (linked && view->IsEqual(linked.get())) {
        capture = candidate;
        break;
      }
    }
    if (!capture) {
      // A view no capture uses shows its set with everything the view does not hold left out.
      QelVar<QelPathElement> root = QelDbrFilterAndClippingController::GetRootPath(rootPath);
      filter = QelMakeVar<QelDbrFilter>(0, root.get());
      QelVar<QelDbrFilterComponent> component = QelMakeVar<QelDbrFilterComponent>();
      if (!component) {
        QelAssertPointer();
        return nullptr;
      }
      filter->AddFilterComponent(QelVar<QelIDriFilterComponent>(component.get()).get());
      component->SetFilterComponentInfo(0, 0);
      QelVar<QelILumCollection> held;
      view->GetElements(held);
      if (!held) {
        QelAssertPointer();
        return nullptr;
      }
      QelListValQelBaseUnknown_var kept;
      uint32_t heldCount = 0;
      held->GetCount(heldCount);
      for (uint32_t i = 0; i < heldCount; ++i) {
        QelBaseUnknown_var element;
        held->GetItem(i, element);
        if (element) kept.Append(element.get());
      }
      QelVar<QelILumCollection> all;
      set->GetElements(all);
      if (!all) {
        QelAssertPointer();
        return nullptr;
      }
      uint32_t allCount = 0;
      all->GetCount(allCount);
      for (uint32_t i = 0; i < allCount; ++i) {
        QelBaseUnknown_var element;
        all->GetItem(i, element);
        if (!element || kept.Locate(element.get()) != 0) continue;
        QelVar<QelPathElement> path = MakePath(element, rootPath, CreateObjectPath);
        component->AddPathElement(path.get());
      }
    }
  }

  if (capture) {
    QelVar<QelIDriFilterFactory> filters{capture.get()};
    QelVar<QelIDriClippingFactory> clippings{capture.get()};
    if (filters || clippings) {
      QelBaseUnknown_var asObject{capture.get()};
      QelVar<QelPathElement> path = MakePath(asObject, rootPath, CreateObjectPath);
      if (filters) filters->GetFilter(path.get(), false, filter);
      if (clippings && !view) clippings->GetClipping(path.get(), true, clipping);
    }
  }
  if (view) {
    if (QelVar<QelIDriClippingFactory> clippings{view.get()}) {
      QelBaseUnknown_var asObject{view.get()};
      QelVar<QelPathElement> path = MakePath(asObject, rootPath, CreateObjectPath);
      clippings->GetClipping(path.get(), true, clipping);
    }
  }
  const bool applied = filter || clipping;
  if (applied) {
    auto info = QelMakeVar<QelDbrWidgetManagerInfoFilterAndCutting>();
    QelDbrFilterAndClippingController::ApplyFilterAndClipping(filter.get(), clipping.get(), viewpoint, info.get());
  }

  if (capture) {
    viewer->PrepareViewpoint();
    QelBaseUnknown_var asObject{capture.get()};
    QelVar<QelPathElement> path = MakePath(asObject, rootPath, CreateObjectPath);
    ApplyCaptureViewpoint(path.get(), viewer, rootPath);
  } else {
    FollowSupport(viewer, viewpoint);
    QelBaseUnknown_var asObject{view.get()};
    QelVar<QelPathElement> path = MakePath(asObject, rootPath, CreateObjectPath);
    QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(path.get(), viewer, viewpoint);
  }

  auto image = QelMakeVar<QelPixelImage>(kThumbnailWidth, kThumbnailHeight, static_cast<int>(QelPixelImageFormat::RGB));
  InitializeViewModesFomCurrentViewer(viewer);
  QelVar<QelOffscreenSupport> support = createSupport(viewer->GetSupport(), image.get());
  if (!support) {
    QelAssertPointer();
    // Nothing may stay filtered or clipped in the viewer once the preview is given up.
    if (applied) QelDbrFilterAndClippingController::RemoveFilterAndClipping(viewpoint, 0);
    return nullptr;
  }
  // The picture is drawn for the thumbnail's own proportions, not the window's.
  viewpoint->SetSupportArea(0.0f, 0.0f, static_cast<float>(kThumbnailWidth), static_cast<float>(kThumbnailHeight));
  support->SetBackgroundColor(0.5f, 0.5f, 0.5f);
  if (support->GetTextSprites() != 1) {
    support->SetTextSprites(1);
    support->SetUpdateSpritesMapsFlag(1);
  }
  support->Draw();
  support = nullptr;
  if (applied)
    QelDbrFilterAndClippingController::RemoveFilterAndClipping(viewpoint, 0);
  else
    viewer->RemoveClippingPlane();
  return image.Detach();
}

QelUnicodeString QelRovBrowserViewToolbox::GetThumbnailDescription(QelBaseUnknown_var& item) {
  QelUnicodeString result;
  QelVar<QelITPSView> view{item.get()};
  QelVar<QelILumCapture> capture{item.get()};
  QelVar<QelILumSet> set;
  if (view) {
    QelBaseUnknown_var owner;
    view->GetSet(owner);
    if (!owner) {
      QelAssertPointer();
      return result;
    }
    set = QelVar<QelILumSet>(owner.get());
  } else if (capture) {
    QelBaseUnknown_var owner;
    capture->GetSet(owner);
    set = QelVar<QelILumSet>(owner.get());
  }
  if (!set) {
    QelAssertNullHandler();
    return result;
  }
  QelVar<QelILumCollection> captures;
  set->GetCaptures(captures);
  if (!captures) {
    QelAssertPointer();
    return result;
  }
  uint32_t count = 0;
  captures->GetCount(count);
  for (uint32_t i = 0; i < count; ++i) {
    QelBaseUnknown_var entry;
    captures->GetItem(i, entry);
    if (!entry) {
      QelAssertPointer();
      return result;
    }
    QelBaseUnknown_var linked = LinkedView(QelVar<QelILumCapture>(entry.get()).get());
    if (!linked) continue;
    QelBaseUnknown* named = nullptr;
    if (view && view->IsEqual(linked.get()))
      named = entry.get();
    else if (!view && entry->IsEqual(capture.get()))
      named = linked.get();
    if (!named) continue;
    QelVar<QelIAlias> alias{named};
    if (!alias) {
      QelAssertNullHandler();
      return result;
    }
    alias->GetAlias(result);
    return result;
  }
  return result;
}

HRESULT QelRovBrowserViewToolbox::InitializeViewModesFomCurrentViewer(Qel3DViewer* viewer) {
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  QelFrmWindow* window = layout ? layout->GetCurrentWindow() : nullptr;
  QelBaseUnknown_var held = window ? window->GetViewer() : QelBaseUnknown_var();
  auto* current = QelSysDynamicCast<QelViewer>(held.get());
  if (!layout || !window || !current || !viewer) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  // Bit 1 before bit 0, then every further bit up to 0x100000: 21 in all.
  viewer->SetViewMode(0x2, current->ViewMode(0x2));
  viewer->SetViewMode(0x1, current->ViewMode(0x1));
  for (uint32_t bit = 0x4; bit <= 0x100000; bit <<= 1) viewer->SetViewMode(bit, current->ViewMode(bit));
  viewer->Update();
  return S_OK;
}
