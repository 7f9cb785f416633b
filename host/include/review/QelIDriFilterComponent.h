#pragma once
// One component of a review filter: the paths of the objects it leaves out of the
// picture, and a few typed settings (component infos).
#include "QelPathElement.h"

class QelIDriFilterComponent : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDriFilterComponent;
  static constexpr QelIID IID = QelIID::Parse("{71C05A9E-3D48-4B2F-A6E7-9B1C8D0F4E63}");

  virtual HRESULT AddPathElement(QelPathElement* path) = 0;
  virtual int GetPathCount() = 0;
  virtual QelPathElement* GetPath(int index) = 0;
  virtual HRESULT SetFilterComponentInfo(int type, int value) = 0;
  // E_FAIL when no info of that type was set.
  virtual HRESULT GetFilterComponentInfo(int type, int& value) = 0;

 protected:
  ~QelIDriFilterComponent() override = default;
};
