#pragma once
// QelSysKeepFreedHeap: how a host process keeps the memory its panels free. By default
// the C library hands freed memory at the top of its heap back to the system at once; a
// panel that releases a section of tens of thousands of widgets and builds the next one
// then has every page of it faulted in again, which on a virtual machine costs more than
// the build itself and grows faster than the section. A host calls this once at start:
// up to `bytes` of freed memory then stay with the process for the next build.
#include <cstddef>

// False where the C library offers no such setting (the call then changes nothing).
bool QelSysKeepFreedHeap(size_t bytes = size_t{512} << 20);
