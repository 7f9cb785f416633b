#pragma once
// An annotation view: a plane of the owning set and the elements (annotations) shown in it.
// The first operation gives the owning set; the plane is handed out newly allocated.
#include "QelILumCollection.h"
#include "QelMathPlane.h"
#include "QelVar.h"

class QelITPSView : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSView;
  static constexpr QelIID IID = QelIID::Parse("{83AC740F-1500-11D4-949B-0004AC96129F}");

  virtual HRESULT GetSet(QelBaseUnknown_var& set) = 0;
  // A new plane the caller deletes; null (S_FALSE) when the view has none.
  virtual HRESULT GetPlane(QelMathPlane*& plane) = 0;
  virtual HRESULT GetElements(QelVar<QelILumCollection>& elements) = 0;

 protected:
  ~QelITPSView() override = default;
};
