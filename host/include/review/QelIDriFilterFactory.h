#pragma once
// Gives the review filter of a view or capture, built for its path under a context.
#include "QelDbrFilter.h"

class QelIDriFilterFactory : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDriFilterFactory;
  static constexpr QelIID IID = QelIID::Parse("{C3A2F8D1-5E6B-4A09-9D7C-1B4E0F2A8C57}");

  // S_OK and a new filter; S_FALSE and null when the object filters nothing. `flag`: also
  // keep the objects of other sets (true) or leave them out (false).
  virtual HRESULT GetFilter(QelPathElement* path, bool flag, QelVar<QelDbrFilter>& filter) = 0;

 protected:
  ~QelIDriFilterFactory() override = default;
};
