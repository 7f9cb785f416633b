#pragma once
// QelCallbackManager: named notifications from a publisher to its subscribers
// (AddCallback / RemoveCallback / RemoveCallbacksOn and Dispatch).
//
// Publishers and subscribers are held weakly: a subscriber that goes away without
// removing its callbacks is skipped, never called and never kept alive. Callbacks may
// be added or removed while a notification is being dispatched, including the one
// running; a removed callback is never called again, an added one waits for the next
// dispatch.
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "QelBaseUnknown_WR.h"

using QelCallbackId = uint32_t;  // 0 means "no subscription"

// The notification object may be null for notifications that carry nothing.
using QelCallbackFn = std::function<void(QelBaseUnknown* publisher, QelBaseUnknown* notification)>;

class QelCallbackManager {
 public:
  static QelCallbackManager& Get();

  // Adding the same function again for the same publisher, notification and subscriber is
  // reported and answers the existing subscription.
  QelCallbackId AddCallback(QelBaseUnknown* publisher, std::string_view notification, QelBaseUnknown* subscriber,
                            QelCallbackFn fn);
  // True when the callback existed.
  bool RemoveCallback(QelCallbackId id);
  // Removes the subscriber's callbacks on the publisher (every publisher when null), for
  // one notification name (every name when empty). Answers how many were removed.
  int RemoveCallbacksOn(QelBaseUnknown* publisher, QelBaseUnknown* subscriber, std::string_view notification = {});

  // Calls, in order of subscription, every live callback of the publisher for the name.
  void Dispatch(QelBaseUnknown* publisher, std::string_view notification, QelBaseUnknown* payload = nullptr);

  // The callbacks still to be called: those whose subscriber is gone do not count. With a
  // subscriber, only that subscriber's.
  int CountCallbacks(QelBaseUnknown* publisher, std::string_view notification = {},
                     QelBaseUnknown* subscriber = nullptr) const;
  // Entries held, removed ones included until they are compacted after the outermost
  // dispatch: a diagnostics aid that shows the list does not grow without bound.
  size_t StoredEntries() const { return entries_.size(); }

 private:
  QelCallbackManager() = default;
  struct Entry {
    QelCallbackId id;
    QelBaseUnknown_WR publisher;
    std::string notification;
    QelBaseUnknown_WR subscriber;
    bool hasSubscriber;
    QelCallbackFn fn;
    bool removed = false;
  };
  class DispatchScope;
  void Compact();
  std::vector<Entry> entries_;
  QelCallbackId nextId_ = 1;
  int dispatchDepth_ = 0;
};
