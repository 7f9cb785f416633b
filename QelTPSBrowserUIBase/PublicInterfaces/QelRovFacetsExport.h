#pragma once
// What the module's library exports. The module is built with hidden visibility: only
// declarations marked QEL_ROV_EXPORT (the factories the host's dictionary names, the
// controller class, the browser view toolbox and the ABI version) are visible to a host.
#define QEL_ROV_EXPORT __attribute__((visibility("default")))
