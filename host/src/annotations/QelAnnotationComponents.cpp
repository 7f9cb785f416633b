#include "QelAnnotationComponents.h"

#include "QelLumCameraGeometryComponent.h"
#include "QelLumNamingComponent.h"
#include "QelLumSetComponent.h"
#include "QelTPSViewRelationComponent.h"

namespace {
HRESULT InstantiateByNumber(int kind, QelBaseUnknown_var& out) {
  out = nullptr;
  switch (kind) {
    case 45: out = QelBaseUnknown_var::Adopt(new QelTPSViewRelationComponent()); break;
    case 59: out = QelBaseUnknown_var::Adopt(new QelLumNamingComponent()); break;
    case 62: out = QelBaseUnknown_var::Adopt(new QelLumSetComponent()); break;
    case 74: out = QelBaseUnknown_var::Adopt(new QelLumCameraGeometryComponent()); break;
    default: return E_FAIL;
  }
  return S_OK;
}
}  // namespace

HRESULT QelLumInstantiateComponentBase(int kind, QelBaseUnknown_var& out) { return InstantiateByNumber(kind, out); }
HRESULT QelTPSInstantiateComponentBase(int kind, QelBaseUnknown_var& out) { return InstantiateByNumber(kind, out); }
