#pragma once
// The binary contract between the host and a plug-in module: a module exports, unmangled,
// an int named by kQelModuleAbiSymbol holding the ABI version it was built against. The
// host reads it before it uses anything else of the library and refuses any other value.
// Raise the version whenever a class, interface or factory signature the two share changes.
inline constexpr int kQelModuleAbiVersion = 1;
inline constexpr const char* kQelModuleAbiSymbol = "QelModuleAbiVersion";
