// Load-time entry of the module. Registration of the module's classes is added here, in
// the order the host expects, as the classes come.
#include "QelModuleVersion.h"

extern "C" const char* QelRovFacetsModuleName() { return "QelRovFacets"; }
