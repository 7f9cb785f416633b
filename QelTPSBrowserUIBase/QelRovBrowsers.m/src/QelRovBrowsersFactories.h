#pragma once
// The views browser's exported factories, found by the host's dictionary under these
// exact names. A tie factory gives a new tie holding one reference to the implementation
// (null for a null implementation); the direct factory gives the object itself.
#include "QelBaseUnknown.h"
#include "QelRovFacetsExport.h"

extern "C" {
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIDbrBrowserContextQelDbrBrowserContextLFT(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateBOAQelIDbrBrowserContextFactoryQelERovBrowserContextFactory(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIVIABaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl);
}
