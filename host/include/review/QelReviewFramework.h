#pragma once
// QelReviewFramework: registers the review framework's interfaces on the model's objects
// (path building, filter and clipping factories of views and captures). Call once at start
// (the host program and the test fixtures do); further calls do nothing.
class QelReviewFramework {
 public:
  QelReviewFramework() = delete;
  static void Register();
};
