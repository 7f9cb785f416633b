#include "QelDbrFilterAndClippingController.h"

#include "Qel3DViewpoint.h"

QelVar<QelPathElement> QelDbrFilterAndClippingController::GetRootPath(QelPathElement* path) {
  if (!path || path->GetSize() == 0) return {};
  auto root = QelMakeVar<QelPathElement>();
  root->AddChildElement((*path)[0].get());
  return root;
}

HRESULT QelDbrFilterAndClippingController::ApplyFilterAndClipping(QelDbrFilter* filter, QelDbrClipping* clipping,
                                                                  Qel3DViewpoint* viewpoint,
                                                                  QelDbrWidgetManagerInfoFilterAndCutting* /*info*/) {
  if (!viewpoint) return E_FAIL;
  if (filter) viewpoint->SetFilter(filter);
  if (clipping) viewpoint->AddClippingPlane(clipping->GetPlane());
  return S_OK;
}

HRESULT QelDbrFilterAndClippingController::RemoveFilterAndClipping(Qel3DViewpoint* viewpoint, int /*mode*/) {
  if (!viewpoint) return E_FAIL;
  viewpoint->SetFilter(nullptr);
  viewpoint->RemoveClippingPlanes();
  return S_OK;
}
