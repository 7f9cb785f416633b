#include "QelSYP.h"

#include "QelVidCtl.h"

HRESULT QelSYP::LoadResources(QelBaseUnknown* introspectable) {
  auto* control = introspectable ? dynamic_cast<QelVidCtl*>(introspectable->GetImpl()) : nullptr;
  if (!control) return E_FAIL;
  control->DispatchModifyProperty("");
  return S_OK;
}
