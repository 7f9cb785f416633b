#pragma once
// An annotated geometry: an annotation made of a little drawable geometry. Its eighth
// operation gives an object that answers the type classifier.
#include "QelMathVector.h"
#include "QelVar.h"

class QelILumGeometry : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumGeometry;
  static constexpr QelIID IID = QelIID::Parse("{E702236A-E8EE-426C-AB01-D2DCE4E93223}");

  virtual HRESULT GetSet(QelBaseUnknown_var& set) = 0;
  virtual HRESULT GetAnchor(QelMathPoint& anchor) = 0;
  virtual HRESULT GetSegmentCount(int& count) = 0;
  virtual HRESULT GetSegment(int index, QelMathPoint& from, QelMathPoint& to) = 0;
  virtual HRESULT GetToleranceValue(double& value) = 0;  // S_FALSE: no tolerance value
  virtual HRESULT IsDefaultAnnotation(bool& isDefault) = 0;
  virtual HRESULT GetColor(float& red, float& green, float& blue) = 0;
  virtual HRESULT GetTypeServices(QelBaseUnknown_var& classifierOwner) = 0;

 protected:
  ~QelILumGeometry() override = default;
};
