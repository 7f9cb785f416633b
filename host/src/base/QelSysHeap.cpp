#include "QelSysHeap.h"

#include <climits>

#if defined(__GLIBC__)
#include <malloc.h>
#endif

bool QelSysKeepFreedHeap(size_t bytes) {
#if defined(__GLIBC__)
  // A fixed threshold also stops the library from lowering it again on its own.
  return mallopt(M_TRIM_THRESHOLD, bytes > INT_MAX ? INT_MAX : static_cast<int>(bytes)) == 1;
#else
  (void)bytes;
  return false;
#endif
}
