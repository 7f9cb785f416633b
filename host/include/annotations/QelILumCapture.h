#pragma once
// A capture: a stored point of view on an annotation set, optionally linked to one of
// its views and carrying a camera. The first operation gives the owning set (as QelITPSSet).
#include "QelICamera.h"
#include "QelVar.h"

class QelILumCapture : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumCapture;
  static constexpr QelIID IID = QelIID::Parse("{FDD59F65-8985-4FFB-9123-8FED03F4EE4F}");

  virtual HRESULT GetSet(QelBaseUnknown_var& set) = 0;
  // Only S_OK with `linked` true counts as a link.
  virtual HRESULT IsLinkedToView(bool& linked) = 0;
  virtual HRESULT GetLinkedView(QelBaseUnknown_var& view) = 0;
  // S_FALSE and a null camera when the capture has none.
  virtual HRESULT GetCamera(QelVar<QelICamera>& camera) = 0;

 protected:
  ~QelILumCapture() override = default;
};
