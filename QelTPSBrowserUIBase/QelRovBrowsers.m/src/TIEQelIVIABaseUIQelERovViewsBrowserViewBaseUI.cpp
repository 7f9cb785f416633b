// QelIVIABaseUI on QelERovViewsBrowserViewBaseUI, through the review framework's tie.
#include "QelERovViewsBrowserViewBaseUI.h"
#include "QelRovBrowsersFactories.h"
#include "QelTieVIABaseUI.h"

extern "C" QelBaseUnknown* CreateTIEQelIVIABaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl) {
  return QelCreateTie<QelTieVIABaseUI<QelERovViewsBrowserViewBaseUI>>(impl);
}
