#pragma once
// The module's exported factories, found by the host's dictionary under these exact
// names. Each tie factory takes the implementation object and gives a new tie holding one
// reference to it (null for a null implementation).
#include "QelBaseUnknown.h"

extern "C" {
QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetGroup(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelRovFacetGroup(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetView(QelBaseUnknown* impl);
QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotation(QelBaseUnknown* impl);
QelBaseUnknown* CreateBOAQelIHyxFacetCtrlQelRovFacetController(QelBaseUnknown* impl);
}
