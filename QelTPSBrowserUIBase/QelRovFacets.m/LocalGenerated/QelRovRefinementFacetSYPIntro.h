#pragma once
// Introspection table of QelRovRefinementFacet, registered under
// "QelRovRefinementFacetSYPMetaClassBuilder".
#include "QelBaseUnknown.h"

extern "C" QelBaseUnknown* fctCreateQelRovRefinementFacetSYPMetaClassBuilder();
