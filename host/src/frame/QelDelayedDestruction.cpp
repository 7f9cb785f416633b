#include "QelDelayedDestruction.h"

#include <utility>
#include <vector>

#include "QelVar.h"

namespace {
// Never freed: a static destructor releasing objects at exit could reach services that
// are already gone.
std::vector<QelBaseUnknown_var>& Queue() {
  static auto* queue = new std::vector<QelBaseUnknown_var>;
  return *queue;
}
}  // namespace

void QelDelayedDestruction::Request(QelBaseUnknown* object) {
  if (object) Queue().emplace_back(object);
}

int QelDelayedDestruction::FlushIdle() {
  // Taken out whole before any release, so a destructor that requests more appends to a
  // fresh queue that waits for the next flush.
  std::vector<QelBaseUnknown_var> due = std::exchange(Queue(), {});
  const int count = static_cast<int>(due.size());
  for (auto& object : due) object.Reset();
  return count;
}

int QelDelayedDestruction::PendingCount() { return static_cast<int>(Queue().size()); }
