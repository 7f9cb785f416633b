#pragma once
// A representation instance of a product: the first operation gives the representation
// reference it instantiates.
#include "QelVar.h"

class QelIPLMNavRepInstance : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIPLMNavRepInstance;
  static constexpr QelIID IID = QelIID::Parse("{C6308C84-4BD1-49DF-AA27-5624089C90F4}");

  virtual QelBaseUnknown_var GetReferencedObject() = 0;
  virtual HRESULT GetFather(QelBaseUnknown_var& product) = 0;

 protected:
  ~QelIPLMNavRepInstance() override = default;
};
