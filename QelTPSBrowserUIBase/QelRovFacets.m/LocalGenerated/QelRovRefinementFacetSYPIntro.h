#pragma once
// Introspection table of QelRovRefinementFacet, registered under
// "QelRovRefinementFacetSYPMetaClassBuilder".
#include "QelBaseUnknown.h"
#include "QelRovFacetsExport.h"

extern "C" QEL_ROV_EXPORT QelBaseUnknown* fctCreateQelRovRefinementFacetSYPMetaClassBuilder();
