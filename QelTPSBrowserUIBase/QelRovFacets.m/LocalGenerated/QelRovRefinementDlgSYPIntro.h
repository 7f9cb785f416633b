#pragma once
// Introspection table of QelRovRefinementDlg, registered under
// "QelRovRefinementDlgSYPMetaClassBuilder".
#include "QelBaseUnknown.h"
#include "QelRovFacetsExport.h"

extern "C" QEL_ROV_EXPORT QelBaseUnknown* fctCreateQelRovRefinementDlgSYPMetaClassBuilder();
