#pragma once
// QelIContextualMenu: an object that offers a menu on a right click, through its container.
#include "QelIContextualMenuContainer.h"

class QelIContextualMenu : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIContextualMenu;
  static constexpr QelIID IID = QelIID::Parse("{7187AFC8-EB24-43FE-B773-18EC0FEEF702}");

  virtual HRESULT GetMenuContainer(QelVar<QelIContextualMenuContainer>& container) = 0;

 protected:
  ~QelIContextualMenu() override = default;
};
