#pragma once
// Marks a text visualisation object among the annotations (never filtered by type).
#include "QelVar.h"

class QelITPSTextVisu : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSTextVisu;
  static constexpr QelIID IID = QelIID::Parse("{507D61E5-F9FB-447C-8E9D-CFA5651BD453}");

 protected:
  ~QelITPSTextVisu() override = default;
};
