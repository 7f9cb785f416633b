#pragma once
// A representation occurrence under a product occurrence: gives its representation
// reference, the object that holds the annotation sets stored in it.
#include "QelVar.h"

class QelIPLMNavRepOccurrence : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIPLMNavRepOccurrence;
  static constexpr QelIID IID = QelIID::Parse("{523D6171-CFD0-4549-AFCD-17C2E7101768}");

  virtual HRESULT GetRepReference(QelBaseUnknown_var& reference) = 0;

 protected:
  ~QelIPLMNavRepOccurrence() override = default;
};
