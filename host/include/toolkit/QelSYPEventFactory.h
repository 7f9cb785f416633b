#pragma once
// QelSYPEventFactory: makes the process's events. An event is identified by its name and
// owner class; asking again for the same pair gives the same event. Events are never
// freed, so the pointers handed out stay valid for the whole process.
#include <memory>
#include <string>
#include <vector>

#include "QelSYPEvent.h"

class QelSYPEventFactory {
 public:
  QelSYPEvent* NewEvent(const char* name, QelSYPEvent::Propagation propagation, const char* argumentType,
                        const QelMetaObject* owner);
  // The event of that name and owner, or null.
  QelSYPEvent* Find(const std::string& name, const QelMetaObject* owner) const;
  int Count() const { return static_cast<int>(events_.size()); }

 private:
  std::vector<std::unique_ptr<QelSYPEvent>> events_;
};
