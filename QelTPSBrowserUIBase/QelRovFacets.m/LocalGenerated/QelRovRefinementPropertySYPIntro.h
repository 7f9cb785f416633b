#pragma once
// Introspection table of QelRovRefinementProperty, registered under
// "QelRovRefinementPropertySYPMetaClassBuilder".
#include "QelBaseUnknown.h"
#include "QelRovFacetsExport.h"

extern "C" QEL_ROV_EXPORT QelBaseUnknown* fctCreateQelRovRefinementPropertySYPMetaClassBuilder();
