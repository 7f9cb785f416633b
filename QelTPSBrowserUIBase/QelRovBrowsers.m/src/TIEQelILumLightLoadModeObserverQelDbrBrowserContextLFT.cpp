// Forwards QelILumLightLoadModeObserver to QelDbrBrowserContextLFT.
#include "QelDbrBrowserContextLFT.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelRovBrowsersFactories.h"
#include "QelTie.h"

class TIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT final : public QelTie<QelILumLightLoadModeObserver> {
 public:
  using QelTie::QelTie;
  HRESULT OnLightLoadModeChanged() override { return Impl<QelDbrBrowserContextLFT>()->OnLightLoadModeChanged(); }

 private:
  ~TIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT() override = default;
};

extern "C" QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT>(impl);
}
