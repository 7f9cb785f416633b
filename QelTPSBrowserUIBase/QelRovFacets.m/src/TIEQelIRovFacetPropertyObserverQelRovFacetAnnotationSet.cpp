// Forwards QelIRovFacetPropertyObserver to QelRovFacetAnnotationSet, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetAnnotationSet.h"

class TIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override {
    return Impl<QelRovFacetAnnotationSet>()->CanChangeCheckState(property, newState);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override {
    return Impl<QelRovFacetAnnotationSet>()->OnPropertyChanged(object);
  }

 private:
  ~TIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet>(impl);
}
