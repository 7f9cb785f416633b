#include "QelSYPEventFactory.h"

QelSYPEvent* QelSYPEventFactory::NewEvent(const char* name, QelSYPEvent::Propagation propagation,
                                          const char* argumentType, const QelMetaObject* owner) {
  const std::string key = name ? name : "";
  if (QelSYPEvent* known = Find(key, owner)) return known;
  events_.push_back(std::make_unique<QelSYPEvent>(key, propagation, argumentType ? argumentType : "", owner));
  return events_.back().get();
}

QelSYPEvent* QelSYPEventFactory::Find(const std::string& name, const QelMetaObject* owner) const {
  for (const auto& event : events_)
    if (event->GetName() == name && event->GetOwner() == owner) return event.get();
  return nullptr;
}
