#pragma once
// A collection of the annotation layer: a count and a 0-based item getter.
// Each item is handed out with its own reference, released by the caller's handle.
#include <cstdint>

#include "QelVar.h"

class QelILumCollection : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelILumCollection;
  static constexpr QelIID IID = QelIID::Parse("{0342F094-B211-4E1E-9300-0DF6A97A81B9}");

  virtual HRESULT GetCount(uint32_t& count) = 0;
  // E_FAIL and a null item past the end.
  virtual HRESULT GetItem(uint32_t index, QelBaseUnknown_var& item) = 0;

 protected:
  ~QelILumCollection() override = default;
};
