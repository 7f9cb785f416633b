// A plug-in built against another module ABI: a host must refuse it and close it again.
#include "QelModuleAbi.h"

extern "C" __attribute__((visibility("default"))) const int QelModuleAbiVersion = kQelModuleAbiVersion + 1;
