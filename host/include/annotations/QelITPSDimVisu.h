#pragma once
// Marks a dimension visualisation object among the annotations (never filtered by type).
#include "QelVar.h"

class QelITPSDimVisu : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSDimVisu;
  static constexpr QelIID IID = QelIID::Parse("{EDEA2D8F-8843-4EF6-A064-937B3A982E61}");

 protected:
  ~QelITPSDimVisu() override = default;
};
