#pragma once
// QelDelayedDestruction: releases objects later, when the host's loop is idle, so that an
// object asked to go away from inside a dispatch it is still part of survives until that
// dispatch is over. The queue holds one reference per request; FlushIdle drops the
// references queued before it started, and requests made during a flush (by a destructor,
// say) wait for the next one.
#include "QelBaseUnknown.h"

class QelDelayedDestruction {
 public:
  // Takes a reference of its own; null is ignored.
  static void Request(QelBaseUnknown* object);
  // Answers how many references were dropped.
  static int FlushIdle();
  static int PendingCount();

  QelDelayedDestruction() = delete;
};
