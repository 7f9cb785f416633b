#pragma once
// A semantic annotation (datum, tolerance, dimension, roughness, weld, note...). Its third
// operation gives an object that answers the type classifier.
#include "QelVar.h"

class QelITPS : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPS;
  static constexpr QelIID IID = QelIID::Parse("{F4A2D390-3DDC-11D3-A929-006094B99C4B}");

  virtual HRESULT GetSet(QelBaseUnknown_var& set) = 0;
  virtual HRESULT GetToleranceValue(double& value) = 0;  // S_FALSE: no tolerance value
  virtual HRESULT GetTypeServices(QelBaseUnknown_var& classifierOwner) = 0;
  virtual HRESULT IsDefaultAnnotation(bool& isDefault) = 0;

 protected:
  ~QelITPS() override = default;
};
