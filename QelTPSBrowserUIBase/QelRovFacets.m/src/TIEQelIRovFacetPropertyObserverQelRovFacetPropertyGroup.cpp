// Forwards QelIRovFacetPropertyObserver to QelRovFacetPropertyGroup, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetPropertyGroup.h"

class TIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override {
    return Impl<QelRovFacetPropertyGroup>()->CanChangeCheckState(property, newState);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override { return Impl<QelRovFacetPropertyGroup>()->OnPropertyChanged(object); }

 private:
  ~TIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup>(impl);
}
