#include "QelCallbackManager.h"

#include <algorithm>

#include "QelAssert.h"

QelCallbackManager& QelCallbackManager::Get() {
  static auto* manager = new QelCallbackManager;  // lives until the process ends
  return *manager;
}

namespace {
// Two callables are the same function when they have the same type and, for plain
// function pointers, the same target. Each lambda expression has a type of its own, so a
// lambda written once and registered twice by one subscriber counts as the same function.
bool SameFunction(const QelCallbackFn& a, const QelCallbackFn& b) {
  if (a.target_type() != b.target_type()) return false;
  using Plain = void (*)(QelBaseUnknown*, QelBaseUnknown*);
  const Plain* pa = a.target<Plain>();
  const Plain* pb = b.target<Plain>();
  return !pa || !pb || *pa == *pb;
}
}  // namespace

// Counts a dispatch in progress for as long as it runs, however it ends: a callback that
// throws must not leave the manager believing it is still iterating, or removed entries
// would never be compacted again.
class QelCallbackManager::DispatchScope {
 public:
  explicit DispatchScope(QelCallbackManager& manager) : manager_(manager) { ++manager_.dispatchDepth_; }
  ~DispatchScope() {
    --manager_.dispatchDepth_;
    manager_.Compact();
  }
  DispatchScope(const DispatchScope&) = delete;
  DispatchScope& operator=(const DispatchScope&) = delete;

 private:
  QelCallbackManager& manager_;
};

QelCallbackId QelCallbackManager::AddCallback(QelBaseUnknown* publisher, std::string_view notification,
                                              QelBaseUnknown* subscriber, QelCallbackFn fn) {
  if (!publisher || !fn) return 0;
  for (const auto& entry : entries_) {
    if (entry.removed || entry.notification != notification || !entry.publisher.RefersTo(publisher)) continue;
    if (subscriber ? !entry.subscriber.RefersTo(subscriber) : entry.hasSubscriber) continue;
    if (!SameFunction(entry.fn, fn)) continue;
    // Called twice per notification would be the surprise; keep the first subscription.
    QelAssertBool("callback added twice");
    return entry.id;
  }
  QelCallbackId id = nextId_++;
  entries_.push_back({id, QelBaseUnknown_WR(publisher), std::string(notification), QelBaseUnknown_WR(subscriber),
                      subscriber != nullptr, std::move(fn)});
  return id;
}

bool QelCallbackManager::RemoveCallback(QelCallbackId id) {
  for (auto& entry : entries_) {
    if (entry.id == id && !entry.removed) {
      entry.removed = true;
      Compact();
      return true;
    }
  }
  return false;
}

int QelCallbackManager::RemoveCallbacksOn(QelBaseUnknown* publisher, QelBaseUnknown* subscriber,
                                          std::string_view notification) {
  int removed = 0;
  for (auto& entry : entries_) {
    if (entry.removed) continue;
    // By identity, not liveness: a subscriber removes its callbacks from its destructor.
    if (subscriber ? !entry.subscriber.RefersTo(subscriber) : entry.hasSubscriber) continue;
    if (publisher && !entry.publisher.RefersTo(publisher)) continue;
    if (!notification.empty() && entry.notification != notification) continue;
    entry.removed = true;
    ++removed;
  }
  Compact();
  return removed;
}

void QelCallbackManager::Dispatch(QelBaseUnknown* publisher, std::string_view notification,
                                  QelBaseUnknown* payload) {
  if (!publisher) return;
  QelBaseUnknown* publisherImpl = publisher->GetImpl();
  // Keeps the publisher and payload alive for the whole dispatch.
  QelBaseUnknown_var holdPublisher(publisher), holdPayload(payload);
  DispatchScope scope(*this);
  // Only the callbacks present now take part; entries_ may grow meanwhile, so walk by index.
  const size_t count = entries_.size();
  for (size_t i = 0; i < count && i < entries_.size(); ++i) {
    if (entries_[i].removed || entries_[i].notification != notification) continue;
    if (entries_[i].publisher.GetRaw() != publisherImpl) continue;
    // A subscriber that went away without removing its callback is skipped and dropped.
    QelBaseUnknown_var subscriber = entries_[i].subscriber.Get();
    if (entries_[i].hasSubscriber && !subscriber) {
      entries_[i].removed = true;
      continue;
    }
    QelCallbackFn fn = entries_[i].fn;  // a copy: the entry may be removed by the call
    fn(publisher, payload);
  }
}

int QelCallbackManager::CountCallbacks(QelBaseUnknown* publisher, std::string_view notification,
                                       QelBaseUnknown* subscriber) const {
  QelBaseUnknown* publisherImpl = publisher ? publisher->GetImpl() : nullptr;
  return static_cast<int>(std::count_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
    return !entry.removed && entry.publisher.GetRaw() == publisherImpl &&
           (notification.empty() || entry.notification == notification) &&
           (!entry.hasSubscriber || entry.subscriber.IsAlive()) &&
           (!subscriber || entry.subscriber.RefersTo(subscriber));
  }));
}

void QelCallbackManager::Compact() {
  if (dispatchDepth_ > 0) return;  // indexes of a running dispatch must stay valid
  std::erase_if(entries_, [](const Entry& entry) { return entry.removed || !entry.publisher.IsAlive(); });
}
