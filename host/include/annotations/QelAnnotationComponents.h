#pragma once
// The numbered annotation components. Each call makes a new component with one reference
// for the caller, who releases it after use (its handle does). Numbers:
//   45  QelITPSViewRelations    views grouped under a view
//   59  QelILumNamingComponent  type and sub-type names of an annotation
//   62  QelILumSetComponent     review modes, set kind and owner, owner's rep instances
//   74  QelILumCameraGeometry   a capture camera's geometry in its part's coordinates
// Unknown numbers answer E_FAIL and a null handle. Both entry points know every number.
#include "QelVar.h"

HRESULT QelLumInstantiateComponentBase(int kind, QelBaseUnknown_var& out);
HRESULT QelTPSInstantiateComponentBase(int kind, QelBaseUnknown_var& out);
