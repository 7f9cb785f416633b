#include "QelInterfaceDescription.h"

#include <map>
#include <memory>

namespace {
std::map<QelIID, std::unique_ptr<QelInterfaceDescription>>& Registry() {
  static auto* registry = new std::map<QelIID, std::unique_ptr<QelInterfaceDescription>>;  // never freed
  return *registry;
}
}  // namespace

const QelInterfaceDescription& QelInterfaceDescription::Declare(std::string_view name, const QelIID& iid,
                                                                std::string_view framework) {
  auto& registry = Registry();
  auto found = registry.find(iid);
  if (found != registry.end()) return *found->second;
  auto description = std::make_unique<QelInterfaceDescription>(std::string(name), iid, std::string(framework));
  return *registry.emplace(iid, std::move(description)).first->second;
}

const QelInterfaceDescription* QelInterfaceDescription::Find(const QelIID& iid) {
  auto& registry = Registry();
  auto found = registry.find(iid);
  return found == registry.end() ? nullptr : found->second.get();
}

std::string QelInterfaceDescription::NameOf(const QelIID& iid) {
  const QelInterfaceDescription* description = Find(iid);
  return description ? description->Name() : iid.ToString();
}
