#pragma once
// QelIRovFacetPropertyObserver: how a change travels upward through the facet model. The
// owner of a property (a property group or a facet) and the owner of a facet (the facet
// group) answer it; the property holds its owner weakly, so an observer is never kept
// alive by what it observes.
#include "QelBaseUnknown.h"
#include "QelVar.h"

class QelIRovFacetPropertyObserver : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIRovFacetPropertyObserver;
  static constexpr QelIID IID = QelIID::Parse("{27B4F7EE-22B2-4983-9C0E-E83B932B725B}");

  // S_OK allows `property` to take `newState`; any other answer vetoes the change.
  virtual HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) = 0;
  // Told after a change: `object` is the property that changed, or the facet when the
  // observer is the facet group. Callers ignore the answer.
  virtual HRESULT OnPropertyChanged(QelBaseUnknown* object) = 0;

 protected:
  ~QelIRovFacetPropertyObserver() override = default;
};

using QelIRovFacetPropertyObserver_var = QelVar<QelIRovFacetPropertyObserver>;
