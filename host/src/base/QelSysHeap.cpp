#include "QelSysHeap.h"

#include <climits>

#if defined(__GLIBC__)
#include <malloc.h>
#endif

bool QelSysKeepFreedHeap(size_t bytes) {
#if defined(__GLIBC__)
  // A fixed trim threshold also freezes the threshold above which blocks are mapped apart
  // (glibc raises it on its own otherwise): it is set to that adjustment's ceiling, so a
  // picture's buffers of a few megabytes come from the kept heap instead of fresh pages.
  const int keep = bytes > INT_MAX ? INT_MAX : static_cast<int>(bytes);
  return mallopt(M_TRIM_THRESHOLD, keep) == 1 && mallopt(M_MMAP_THRESHOLD, 32 << 20) == 1;
#else
  (void)bytes;
  return false;
#endif
}
