#pragma once
// QelIAfrListItem: a row of a list display. Setting its shading colour redraws it.
#include "QelIDbrBrowserViewBaseUI.h"

class QelIAfrListItem : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIAfrListItem;
  static constexpr QelIID IID = QelIID::Parse("{A201ACF8-BD8D-4EC4-880D-F387E1119160}");

  virtual QelAfrColor GetShadingColor() = 0;
  virtual void SetShadingColor(const QelAfrColor& color) = 0;

 protected:
  ~QelIAfrListItem() override = default;
};
