#include "QelMetaObject.h"

#include <map>
#include <memory>

namespace {
// Never destroyed: meta objects must outlive every object, including those released by
// other static destructors at exit.
std::map<std::string, std::unique_ptr<QelMetaObject>, std::less<>>& Registry() {
  static auto* registry = new std::map<std::string, std::unique_ptr<QelMetaObject>, std::less<>>;
  return *registry;
}
}  // namespace

QelMetaObject::QelMetaObject(std::string name, QelMetaKind kind, const QelMetaObject* base, std::string framework,
                             std::vector<std::string> lateTypes)
    : name_(std::move(name)),
      kind_(kind),
      base_(base),
      framework_(std::move(framework)),
      lateTypes_(std::move(lateTypes)) {}

const QelMetaObject& QelMetaObject::Declare(std::string_view name, QelMetaKind kind, const QelMetaObject* base,
                                            std::string_view framework, std::vector<std::string> lateTypes) {
  auto& registry = Registry();
  auto found = registry.find(name);
  if (found != registry.end()) return *found->second;
  auto meta = std::make_unique<QelMetaObject>(std::string(name), kind, base, std::string(framework),
                                              std::move(lateTypes));
  return *registry.emplace(std::string(name), std::move(meta)).first->second;
}

const QelMetaObject* QelMetaObject::Find(std::string_view name) {
  auto& registry = Registry();
  auto found = registry.find(name);
  return found == registry.end() ? nullptr : found->second.get();
}

bool QelMetaObject::IsAKindOf(std::string_view className) const {
  for (const QelMetaObject* meta = this; meta; meta = meta->base_)
    if (meta->name_ == className) return true;
  return false;
}
