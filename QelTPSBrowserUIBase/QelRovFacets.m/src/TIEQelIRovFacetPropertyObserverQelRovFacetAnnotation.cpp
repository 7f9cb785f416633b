// Forwards QelIRovFacetPropertyObserver to QelRovFacetAnnotation, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetAnnotation.h"

class TIEQelIRovFacetPropertyObserverQelRovFacetAnnotation final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override {
    return Impl<QelRovFacetAnnotation>()->CanChangeCheckState(property, newState);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override {
    return Impl<QelRovFacetAnnotation>()->OnPropertyChanged(object);
  }

 private:
  ~TIEQelIRovFacetPropertyObserverQelRovFacetAnnotation() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotation(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIRovFacetPropertyObserverQelRovFacetAnnotation>(impl);
}
