#pragma once
// Introspection table of QelRovRefinementDlg, registered under
// "QelRovRefinementDlgSYPMetaClassBuilder".
#include "QelBaseUnknown.h"

extern "C" QelBaseUnknown* fctCreateQelRovRefinementDlgSYPMetaClassBuilder();
