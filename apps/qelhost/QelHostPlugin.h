#pragma once
// QelHostPlugin: how qelhost loads and unloads the plug-in. Loading opens the library by
// absolute path, refuses it unless it carries this host's module ABI version, and reports
// what it registered; unloading closes it once everything of the session is gone, then
// proves that none of its registrations and none of the session's objects are left.
#include <cstdint>
#include <ostream>
#include <string>

namespace QelHostPlugin {
// Null, with the reason on stderr, when the plug-in cannot be used. `list` prints every
// registration: class or late type, interface and the exported factory it names.
void* Load(const std::string& path, bool list, std::ostream& out);
// The registrations of the loaded plug-in's framework, one line each, in order.
void List(std::ostream& out);
// Closes the plug-in and checks that it is unmapped and left nothing registered, and that
// no more objects are alive than `objectsBefore` (counted before the session began).
// False, with the reason on stderr, otherwise.
bool Unload(void* module, const std::string& path, int64_t objectsBefore, std::ostream& out);
}  // namespace QelHostPlugin
