#pragma once
// The views component of an annotation set: its fourth operation lists the set's views,
// its fifth the further objects the views browser lists after the captures of the views.
#include "QelListValQelBaseUnknown_var.h"
#include "QelVar.h"

class QelIHyxViewsOfComponent : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIHyxViewsOfComponent;
  static constexpr QelIID IID = QelIID::Parse("{82FC8F10-54DC-497C-9D68-BDEEBC0717F2}");

  virtual HRESULT GetSet(QelBaseUnknown_var& set) = 0;
  virtual HRESULT CountViews(int& count) = 0;
  virtual HRESULT CountOtherElements(int& count) = 0;
  virtual HRESULT ListViews(QelListValQelBaseUnknown_var& views) = 0;
  virtual HRESULT ListOtherElements(QelListValQelBaseUnknown_var& elements) = 0;

 protected:
  ~QelIHyxViewsOfComponent() override = default;
};
