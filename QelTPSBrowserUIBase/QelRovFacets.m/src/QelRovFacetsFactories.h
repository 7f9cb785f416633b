#pragma once
// The module's exported factories, found by the host's dictionary under these exact
// names. Each tie factory takes the implementation object and gives a new tie holding one
// reference to it (null for a null implementation).
#include "QelBaseUnknown.h"
#include "QelRovFacetsExport.h"

extern "C" {
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetGroup(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelILumLightLoadModeObserverQelRovFacetGroup(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetView(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotation(QelBaseUnknown* impl);
QEL_ROV_EXPORT QelBaseUnknown* CreateBOAQelIHyxFacetCtrlQelRovFacetController(QelBaseUnknown* impl);
}
