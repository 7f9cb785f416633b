#pragma once
// The views browser's exported factories, found by the host's dictionary under these
// exact names. A tie factory gives a new tie holding one reference to the implementation
// (null for a null implementation); the direct factory gives the object itself.
#include "QelBaseUnknown.h"

extern "C" {
QelBaseUnknown* CreateTIEQelIDbrBrowserContextQelDbrBrowserContextLFT(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT(QelBaseUnknown* impl);
QelBaseUnknown* CreateBOAQelIDbrBrowserContextFactoryQelERovBrowserContextFactory(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIVIABaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl);
}
