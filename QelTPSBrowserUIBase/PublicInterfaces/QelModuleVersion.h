#pragma once
// Name under which the plug-in identifies itself to a host that loads it by file name.
extern "C" const char* QelRovFacetsModuleName();
