#include "QelDictionary.h"

#include <algorithm>

#include "QelInterfaceDescription.h"
#include "QelMetaObject.h"

QelDictionary& QelDictionary::Get() {
  static auto* dictionary = new QelDictionary;  // lives until the process ends
  return *dictionary;
}

void QelDictionary::Register(std::string_view classOrLateType, const QelIID& iid, QelFactory factory,
                             std::string_view framework) {
  for (auto& entry : factories_) {
    if (entry.key == classOrLateType && entry.iid == iid) {  // a later registration wins
      entry.factory = factory;
      entry.framework = framework;  // the entry now points into the overriding module
      return;
    }
  }
  factories_.push_back({std::string(classOrLateType), iid, factory, std::string(framework), nextOrder_++});
  if (!HasFactoryFor(iid)) interfaces_.push_back(iid);
}

bool QelDictionary::HasFactoryFor(const QelIID& iid) const {
  return std::find(interfaces_.begin(), interfaces_.end(), iid) != interfaces_.end();
}

void QelDictionary::IndexInterfaces() {
  interfaces_.clear();
  for (const auto& entry : factories_)
    if (!HasFactoryFor(entry.iid)) interfaces_.push_back(entry.iid);
}

void QelDictionary::RegisterExtension(std::string_view lateType, const QelMetaObject& extension,
                                      QelExtensionCreator creator, std::string_view framework) {
  for (auto& entry : extensions_) {
    if (entry.lateType == lateType && entry.extension == &extension) {
      entry.creator = creator;
      entry.framework = framework;  // the entry now points into the overriding module
      return;
    }
  }
  extensions_.push_back({std::string(lateType), &extension, creator, std::string(framework), nextOrder_++});
}

void QelDictionary::RegisterNamedCreator(std::string_view name, QelNamedCreator creator, std::string_view framework) {
  for (auto& entry : named_) {
    if (entry.name == name) {
      entry.creator = creator;
      entry.framework = framework;  // the entry now points into the overriding module
      return;
    }
  }
  named_.push_back({std::string(name), creator, std::string(framework), nextOrder_++});
}

void QelDictionary::RegisterExitAction(QelExitAction action, std::string_view framework) {
  if (action) exits_.push_back({action, std::string(framework), nextOrder_++});
}

void QelDictionary::RemoveFramework(std::string_view framework) {
  auto of = [&](const auto& entry) { return entry.framework == framework; };
  // Taken out before running, so an action that unloads more cannot run twice; the
  // entries stay while they run, since releasing the module's objects may still query.
  std::vector<ExitEntry> leaving;
  for (auto& entry : exits_)
    if (of(entry)) leaving.push_back(entry);
  std::erase_if(exits_, of);
  for (auto it = leaving.rbegin(); it != leaving.rend(); ++it) it->action();
  std::erase_if(factories_, of);
  IndexInterfaces();
  std::erase_if(extensions_, of);
  std::erase_if(named_, of);
}

QelFactory QelDictionary::FindFactory(std::string_view classOrLateType, const QelIID& iid) const {
  for (const auto& entry : factories_)
    if (entry.iid == iid && entry.key == classOrLateType) return entry.factory;
  return nullptr;
}

QelNamedCreator QelDictionary::FindNamedCreator(std::string_view name) const {
  for (const auto& entry : named_)
    if (entry.name == name) return entry.creator;
  return nullptr;
}

std::vector<const QelDictionary::ExtensionEntry*> QelDictionary::ExtensionsOf(std::string_view lateType) const {
  std::vector<const ExtensionEntry*> found;
  for (const auto& entry : extensions_)
    if (entry.lateType == lateType) found.push_back(&entry);
  return found;
}

std::vector<std::string> QelDictionary::Describe(std::string_view framework) const {
  std::vector<std::string> lines;
  auto wanted = [&](const std::string& owner) { return framework.empty() || owner == framework; };
  for (const auto& entry : factories_)
    if (wanted(entry.framework)) lines.push_back(entry.key + " " + QelInterfaceDescription::NameOf(entry.iid) + " " + entry.framework);
  for (const auto& entry : extensions_)
    if (wanted(entry.framework))
      lines.push_back(entry.lateType + " extension " + entry.extension->Name() + " " + entry.framework);
  for (const auto& entry : named_)
    if (wanted(entry.framework)) lines.push_back("component " + entry.name + " " + entry.framework);
  return lines;
}

std::vector<QelDictionary::Registration> QelDictionary::RegistrationsOf(std::string_view framework) const {
  std::vector<std::pair<uint64_t, Registration>> found;
  using Kind = Registration::Kind;
  for (const auto& e : factories_)
    if (e.framework == framework)
      found.push_back({e.order, {Kind::Factory, e.key, e.iid, nullptr, reinterpret_cast<const void*>(e.factory)}});
  for (const auto& e : extensions_)
    if (e.framework == framework)
      found.push_back({e.order, {Kind::Extension, e.lateType, {}, e.extension, reinterpret_cast<const void*>(e.creator)}});
  for (const auto& e : named_)
    if (e.framework == framework)
      found.push_back({e.order, {Kind::Component, e.name, {}, nullptr, reinterpret_cast<const void*>(e.creator)}});
  for (const auto& e : exits_)
    if (e.framework == framework)
      found.push_back({e.order, {Kind::ExitAction, {}, {}, nullptr, reinterpret_cast<const void*>(e.action)}});
  std::sort(found.begin(), found.end(), [](const auto& a, const auto& b) { return a.first < b.first; });
  std::vector<Registration> registrations;
  for (auto& [order, registration] : found) registrations.push_back(std::move(registration));
  return registrations;
}

HRESULT QelInstantiateComponent(const char* name, const QelIID& iid, void** out) {
  if (!out) return E_UNEXPECTED;
  *out = nullptr;
  QelNamedCreator creator = name ? QelDictionary::Get().FindNamedCreator(name) : nullptr;
  if (!creator) return E_FAIL;
  QelBaseUnknown_var component = QelBaseUnknown_var::Adopt(creator());
  if (!component) return E_FAIL;
  return component->QueryInterface(iid, out) == S_OK ? S_OK : E_NOINTERFACE;
}
