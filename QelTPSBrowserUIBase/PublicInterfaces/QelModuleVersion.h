#pragma once
// How the plug-in identifies itself to a host that loads it by file name: its name, and
// the module ABI version it was built against (checked by the host before anything else).
#include "QelModuleAbi.h"
#include "QelRovFacetsExport.h"

extern "C" QEL_ROV_EXPORT const char* QelRovFacetsModuleName();
extern "C" QEL_ROV_EXPORT const int QelModuleAbiVersion;
