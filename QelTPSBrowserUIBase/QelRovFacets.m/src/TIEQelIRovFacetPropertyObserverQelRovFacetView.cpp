// Forwards QelIRovFacetPropertyObserver to QelRovFacetView, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetView.h"

class TIEQelIRovFacetPropertyObserverQelRovFacetView final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override {
    return Impl<QelRovFacetView>()->CanChangeCheckState(property, newState);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override {
    return Impl<QelRovFacetView>()->OnPropertyChanged(object);
  }

 private:
  ~TIEQelIRovFacetPropertyObserverQelRovFacetView() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetView(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIRovFacetPropertyObserverQelRovFacetView>(impl);
}
