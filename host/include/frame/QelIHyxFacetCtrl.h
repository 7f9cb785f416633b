#pragma once
// QelIHyxFacetCtrl: what the host asks of the controller of the data filtering panel,
// which a plug-in provides as the component "QelRovFacetController". The component lives
// as long as the plug-in; callers hold it only for the call.
#include "QelVar.h"

class QelIHyxFacetCtrl : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIHyxFacetCtrl;
  static constexpr QelIID IID = QelIID::Parse("{5B0E8C21-7D4A-4E39-B2F6-91C3A7D04E18}");

  // Shows or removes the current editor's panel as the current workbench's setting says.
  virtual void CreateDataFilteringPanelIfNecessary() = 0;
  // Switches the panel off for the current workbench.
  virtual void CloseDataFilteringPanel() = 0;

 protected:
  ~QelIHyxFacetCtrl() override = default;
};
