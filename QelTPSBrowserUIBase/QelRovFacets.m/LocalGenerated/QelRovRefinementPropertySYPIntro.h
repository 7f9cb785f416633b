#pragma once
// Introspection table of QelRovRefinementProperty, registered under
// "QelRovRefinementPropertySYPMetaClassBuilder".
#include "QelBaseUnknown.h"

extern "C" QelBaseUnknown* fctCreateQelRovRefinementPropertySYPMetaClassBuilder();
