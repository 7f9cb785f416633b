// Forwards QelILumLightLoadModeObserver to QelRovFacetGroup, operation by operation in slot order.
#include "QelRovFacetsFactories.h"
#include "QelTie.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelRovFacetGroup.h"

class TIEQelILumLightLoadModeObserverQelRovFacetGroup final : public QelTie<QelILumLightLoadModeObserver> {
 public:
  using QelTie::QelTie;
  HRESULT OnLightLoadModeChanged() override { return Impl<QelRovFacetGroup>()->OnLightLoadModeChanged(); }

 private:
  ~TIEQelILumLightLoadModeObserverQelRovFacetGroup() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelRovFacetGroup(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelILumLightLoadModeObserverQelRovFacetGroup>(impl);
}
