#pragma once
// QelIContextualMenuContainer: hands out the contextual menu for a position (row, column).
#include "QelVar.h"

class QelIContextualMenuContainer : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIContextualMenuContainer;
  static constexpr QelIID IID = QelIID::Parse("{130CA547-6EE9-49D0-8926-2443BA3F4029}");

  virtual QelBaseUnknown_var GetMenu(int row, int column) = 0;

 protected:
  ~QelIContextualMenuContainer() override = default;
};
