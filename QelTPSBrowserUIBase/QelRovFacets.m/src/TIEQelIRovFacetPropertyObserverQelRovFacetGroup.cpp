// Forwards QelIRovFacetPropertyObserver to QelRovFacetGroup, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetGroup.h"

class TIEQelIRovFacetPropertyObserverQelRovFacetGroup final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override {
    return Impl<QelRovFacetGroup>()->CanChangeCheckState(property, newState);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override { return Impl<QelRovFacetGroup>()->OnPropertyChanged(object); }

 private:
  ~TIEQelIRovFacetPropertyObserverQelRovFacetGroup() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetGroup(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIRovFacetPropertyObserverQelRovFacetGroup>(impl);
}
