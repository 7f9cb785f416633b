#include "QelDbrDisplayCaptureCommand.h"

#include "Qel3DViewer.h"
#include "Qel3DViewpoint.h"
#include "QelAnnotationComponents.h"
#include "QelFrmLayout.h"
#include "QelIBuildPath.h"
#include "QelICamera.h"
#include "QelILumCameraGeometry.h"
#include "QelILumCapture.h"
#include "QelILumCollection.h"
#include "QelILumSet.h"
#include "QelITPSView.h"
#include "QelRovActivateAndDisplayToolbox.h"
#include "QelRovFacetServices.h"
#include "QelRovPathElementToolbox.h"

namespace {
constexpr int kCameraGeometryComponent = 74;

QelMathVector Unit(const QelMathVector& v) {
  const double n = v.Norm();
  return n > 0 ? v * (1.0 / n) : QelMathVector{1, 0, 0};
}

void ForEach(QelILumCollection* collection, auto&& fn) {
  uint32_t count = 0;
  if (!collection || collection->GetCount(count) != S_OK) return;
  for (uint32_t i = 0; i < count; ++i) {
    QelBaseUnknown_var item;
    if (collection->GetItem(i, item) == S_OK && item) fn(item);
  }
}

// The path from the model's root down to `object`.
QelVar<QelPathElement> PathOf(QelBaseUnknown* object, QelBaseUnknown* root) {
  auto rootPath = QelMakeVar<QelPathElement>();
  rootPath->AddChildElement(root);
  QelVar<QelIBuildPath> build{object};
  return build ? build->BuildPath(rootPath.get()) : nullptr;
}
}  // namespace

void QelDbrDisplayCaptureCommand::Run() {
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  QelFrmWindow* window = layout ? layout->GetCurrentWindow() : nullptr;
  if (!editor || !window) return;
  QelBaseUnknown_var viewerObject = window->GetViewer();
  auto* viewer = QelSysDynamicCast<Qel3DViewer>(viewerObject.get());
  for (const auto& selected : editor->GetCSO()->GetElements())
    if (QelVar<QelILumCapture>(selected.get())) {
      Display(selected.get(), viewer);
      return;
    }
}

HRESULT QelDbrDisplayCaptureCommand::Display(QelBaseUnknown* captureObject, Qel3DViewer* viewer) {
  QelVar<QelILumCapture> capture{captureObject};
  QelBaseUnknown_var setObject;
  if (!capture || !viewer || capture->GetSet(setObject) != S_OK) return E_FAIL;
  QelBaseUnknown_var view;
  bool linked = false;
  if (capture->IsLinkedToView(linked) == S_OK && linked) capture->GetLinkedView(view);

  QelBaseUnknown_var root;
  QelRovFacetServices::GetRootPLMObject(QelFrmEditor::GetCurrentEditor(), root);

  // What the capture shows: its set, itself, its view and the view's elements. Every other
  // annotation of the model is hidden, whichever set holds it, so the display is exactly
  // the view.
  QelListValQelBaseUnknown_var shown, hidden;
  shown.Append(setObject);
  shown.Append(captureObject);
  QelVar<QelITPSView> asView{view.get()};
  QelVar<QelILumCollection> held;
  if (asView) {
    shown.Append(view);
    if (asView->GetElements(held) == S_OK) ForEach(held.get(), [&](const QelBaseUnknown_var& e) { shown.Append(e); });
  }
  QelListValQelBaseUnknown_var sets;
  if (root) QelRovFacetServices::ListAllSets(root.get(), sets, false);
  if (sets.Locate(setObject.get()) == 0) sets.Append(setObject);
  for (const QelBaseUnknown_var& each : sets) {
    QelVar<QelILumSet> other{each.get()};
    QelVar<QelILumCollection> elements;
    if (other && other->GetElements(elements) == S_OK)
      ForEach(elements.get(), [&](const QelBaseUnknown_var& e) {
        if (shown.Locate(e.get()) == 0) hidden.Append(e);
      });
  }
  QelRovFacetServices::EnableDisableDisplay(hidden, 0, nullptr);
  QelRovFacetServices::EnableDisableDisplay(shown, 1, nullptr);

  // The viewpoint: the stored camera placed in the root's coordinates, or, without one,
  // square to the linked view.
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  QelVar<QelICamera> camera;
  capture->GetCamera(camera);
  QelVar<QelPathElement> path = root ? PathOf(captureObject, root.get()) : nullptr;
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kCameraGeometryComponent, made);
  QelVar<QelILumCameraGeometry> geometry{made.get()};
  if (camera && path && geometry && geometry->Bind(camera.get(), path.get()) == S_OK) {
    QelMathTransformation toContext;
    QelRovPathElementToolbox::GetMechPartToContextTransfo(path.get(), toContext);
    QelMathPoint eye, target;
    QelMathVector sight, up;
    geometry->GetEyePoint(eye);
    geometry->GetSightVector(sight);
    geometry->GetUpVector(up);
    geometry->GetTargetPoint(target);
    viewpoint->SetOrigin(toContext.Apply(eye));
    viewpoint->SetOrientation(QelMathDirectionf(Unit(toContext.ApplyToVector(sight))),
                              QelMathDirectionf(Unit(toContext.ApplyToVector(up))));
    viewpoint->SetTarget(QelMathPointf(toContext.Apply(target)));
  } else if (view && root) {
    QelVar<QelPathElement> viewPath = PathOf(view.get(), root.get());
    QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(viewPath.get(), viewer, viewpoint);
  }
  viewer->Update();
  return S_OK;
}
