#pragma once
// QelDictionary: the host's component dictionary. It maps (class name or late type,
// interface identifier) to the factory that gives that interface on such an object, maps
// late types to the data extensions that extend them, and component names to their
// creation functions. QueryInterface consults it after an object's own interfaces.
//
// Entries carry the framework that registered them so that a module being unloaded can
// take all of its entries back (its factories would otherwise dangle).
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "QelVar.h"

class QelMetaObject;

// Gives a new reference to an object that answers the interface on `impl`: a new tie
// holding one reference to `impl`, or `impl` itself (direct implementation).
using QelFactory = QelBaseUnknown* (*)(QelBaseUnknown* impl);
// Creates the data extension of `extended` (a new reference, kept by the extended object).
using QelExtensionCreator = QelBaseUnknown* (*)(QelBaseUnknown* extended);
// Creates (or hands out) a named component, with a new reference.
using QelNamedCreator = QelBaseUnknown* (*)();
// Run when the framework that registered it is taken out of the dictionary (its module is
// being unloaded): the last moment its code may still run.
using QelExitAction = void (*)();

class QelDictionary {
 public:
  static QelDictionary& Get();

  void Register(std::string_view classOrLateType, const QelIID& iid, QelFactory factory,
                std::string_view framework = {});
  void RegisterExtension(std::string_view lateType, const QelMetaObject& extension, QelExtensionCreator creator,
                         std::string_view framework = {});
  void RegisterNamedCreator(std::string_view name, QelNamedCreator creator, std::string_view framework = {});
  void RegisterExitAction(QelExitAction action, std::string_view framework);
  // Runs the framework's exit actions (latest first), then removes every entry
  // registered under its name.
  void RemoveFramework(std::string_view framework);

  QelFactory FindFactory(std::string_view classOrLateType, const QelIID& iid) const;
  // Whether any factory is registered for `iid`: when none is, no tie or extension can
  // answer it, and a query that the object itself refused ends without walking the
  // dictionary for each class of the object.
  bool HasFactoryFor(const QelIID& iid) const;
  QelNamedCreator FindNamedCreator(std::string_view name) const;

  struct ExtensionEntry {
    std::string lateType;
    const QelMetaObject* extension;
    QelExtensionCreator creator;
    std::string framework;
    uint64_t order = 0;
  };
  // One line per entry ("<key> <interface name or identifier> <framework>", "<late type> extension <class>",
  // "component <name>"), for a person to see what a module registered.
  std::vector<std::string> Describe(std::string_view framework = {}) const;

  // One registration of a framework, as a host lists it: `function` is the factory,
  // extension creator, named creator or exit action (a host can name it from its module).
  struct Registration {
    enum class Kind { Factory, Extension, Component, ExitAction };
    Kind kind;
    std::string key;  // class or late type; component name; empty for an exit action
    QelIID iid;       // factories only
    const QelMetaObject* extension = nullptr;
    const void* function = nullptr;
  };
  // The framework's registrations in the order they were made.
  std::vector<Registration> RegistrationsOf(std::string_view framework) const;

  // The extensions registered for a late type, in order of registration.
  std::vector<const ExtensionEntry*> ExtensionsOf(std::string_view lateType) const;

 private:
  QelDictionary() = default;
  struct FactoryEntry {
    std::string key;
    QelIID iid;
    QelFactory factory;
    std::string framework;
    uint64_t order;
  };
  struct NamedEntry {
    std::string name;
    QelNamedCreator creator;
    std::string framework;
    uint64_t order;
  };
  struct ExitEntry {
    QelExitAction action;
    std::string framework;
    uint64_t order;
  };
  std::vector<FactoryEntry> factories_;
  std::vector<QelIID> interfaces_;  // distinct identifiers of factories_
  void IndexInterfaces();
  std::vector<ExtensionEntry> extensions_;
  std::vector<NamedEntry> named_;
  std::vector<ExitEntry> exits_;
  uint64_t nextOrder_ = 0;
};

// Creates the component registered under `name` and queries `iid` on it. E_FAIL when no
// such component exists, E_NOINTERFACE when it lacks the interface.
HRESULT QelInstantiateComponent(const char* name, const QelIID& iid, void** out);

template <class I>
QelVar<I> QelInstantiateComponent(const char* name) {
  void* out = nullptr;
  if (QelInstantiateComponent(name, I::IID, &out) != S_OK) return nullptr;
  return QelVar<I>::Adopt(static_cast<I*>(out));
}
