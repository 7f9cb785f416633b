#pragma once
// QelSYPEvent: a named event kind. Events are made once by the event factory and live
// for the whole process, so widgets and handlers compare them by pointer.
#include <string>

class QelMetaObject;

class QelSYPEvent {
 public:
  // Local: only the dispatching widget's handlers; Ancestors: then those of every
  // ancestor, from the parent up.
  enum Propagation : int { Local = 0, Ancestors = 1 };

  QelSYPEvent(std::string name, Propagation propagation, std::string argumentType, const QelMetaObject* owner)
      : name_(std::move(name)), propagation_(propagation), argumentType_(std::move(argumentType)), owner_(owner) {}

  const std::string& GetName() const { return name_; }
  Propagation GetPropagation() const { return propagation_; }
  const std::string& GetArgumentType() const { return argumentType_; }
  const QelMetaObject* GetOwner() const { return owner_; }

 private:
  std::string name_;
  Propagation propagation_;
  std::string argumentType_;
  const QelMetaObject* owner_;
};
