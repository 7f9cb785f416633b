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
  factories_.push_back({std::string(classOrLateType), iid, factory, std::string(framework)});
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
  extensions_.push_back({std::string(lateType), &extension, creator, std::string(framework)});
}

void QelDictionary::RegisterNamedCreator(std::string_view name, QelNamedCreator creator, std::string_view framework) {
  for (auto& entry : named_) {
    if (entry.name == name) {
      entry.creator = creator;
      entry.framework = framework;  // the entry now points into the overriding module
      return;
    }
  }
  named_.push_back({std::string(name), creator, std::string(framework)});
}

void QelDictionary::RemoveFramework(std::string_view framework) {
  auto of = [&](const auto& entry) { return entry.framework == framework; };
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

HRESULT QelInstantiateComponent(const char* name, const QelIID& iid, void** out) {
  if (!out) return E_UNEXPECTED;
  *out = nullptr;
  QelNamedCreator creator = name ? QelDictionary::Get().FindNamedCreator(name) : nullptr;
  if (!creator) return E_FAIL;
  QelBaseUnknown_var component = QelBaseUnknown_var::Adopt(creator());
  if (!component) return E_FAIL;
  return component->QueryInterface(iid, out) == S_OK ? S_OK : E_NOINTERFACE;
}
