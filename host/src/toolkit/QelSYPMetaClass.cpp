#include "QelSYPMetaClass.h"

#include <map>
#include <memory>

#include "QelBoxingOfQelVidColor.h"
#include "QelSYPEventHandler.h"
#include "QelSYPMetaClassBuilder.h"
#include "QelVar.h"
#include "QelVidStyleSheet.h"

namespace {
// Transparent, so a look-up by a class name needs no string of its own.
using RegistryMap = std::map<std::string, std::unique_ptr<QelSYPMetaClass>, std::less<>>;
RegistryMap& Registry() {
  // Never destroyed: a module's unloader may still remove its classes during exit.
  static auto* registry = new RegistryMap();
  return *registry;
}

// The toolkit's own classes have no properties of their own but are bases of others.
const QelSYPMetaClass* ToolkitClass(std::string_view name) {
  static const QelSYPMetaClass widget("QelVidWidget", "toolkit", {}, {}, nullptr, nullptr);
  static const QelSYPMetaClass control("QelVidCtl", "toolkit", {}, {}, nullptr, &widget);
  if (name == "QelVidWidget") return &widget;
  if (name == "QelVidCtl") return &control;
  return nullptr;
}

// Builders in the middle of Build, so a class whose builder asks for itself fails.
std::map<std::string, bool>& Building() {
  static auto* building = new std::map<std::string, bool>();
  return *building;
}
}  // namespace

QelSYPMetaClass::QelSYPMetaClass(std::string className, std::string framework, std::vector<Property> properties,
                                 std::vector<Handler> handlers, QelSYPCreateFunction create,
                                 const QelSYPMetaClass* base)
    : className_(std::move(className)),
      framework_(std::move(framework)),
      properties_(std::move(properties)),
      handlers_(std::move(handlers)),
      create_(create),
      base_(base) {}

const QelSYPMetaClass* QelSYPMetaClass::Find(std::string_view name) {
  if (const QelSYPMetaClass* own = ToolkitClass(name)) return own;
  auto& registry = Registry();
  if (auto it = registry.find(name); it != registry.end()) return it->second.get();
  const std::string className(name);
  const std::string builderName = className + "SYPMetaClassBuilder";
  QelSYPMetaClassBuilder::Creator creator = QelSYPMetaClassBuilder::FindCreator(builderName);
  if (!creator || Building()[className]) return nullptr;
  Building()[className] = true;
  QelBaseUnknown_var object = QelBaseUnknown_var::Adopt(creator());
  const QelSYPMetaClass* made = nullptr;
  if (auto* builder = dynamic_cast<QelSYPMetaClassBuilder*>(object ? object->GetImpl() : nullptr)) {
    builder->Build();
    made = builder->GetMetaClass();
  }
  Building().erase(className);
  return made;
}

void QelSYPMetaClass::RemoveFramework(const std::string& framework) {
  // Compiled style templates point into the tables about to go.
  QelVidStyleSheet::ClearCache();
  auto& registry = Registry();
  for (auto it = registry.begin(); it != registry.end();)
    it = it->second->GetFramework() == framework ? registry.erase(it) : std::next(it);
}

const QelSYPMetaClass::Property* QelSYPMetaClass::FindProperty(const std::string& name) const {
  for (const QelSYPMetaClass* c = this; c; c = c->base_)
    for (const Property& p : c->properties_)
      if (p.name == name) return &p;
  return nullptr;
}

const QelSYPMetaClass::Handler* QelSYPMetaClass::FindHandler(const std::string& name) const {
  for (const QelSYPMetaClass* c = this; c; c = c->base_)
    for (const Handler& h : c->handlers_)
      if (h.name == name) return &h;
  return nullptr;
}

bool QelSYPMetaClass::GetProperty(QelBaseUnknown* object, const std::string& name, QelSYPValue& value) const {
  const Property* p = FindProperty(name);
  return p && Read(object, *p, value);
}

bool QelSYPMetaClass::Read(QelBaseUnknown* object, const Property& property, QelSYPValue& value) {
  const Property* p = &property;
  if (!object) return false;
  if (p->getInt) {
    value = p->getInt(object);
    return true;
  }
  if (p->getText) {
    value = p->getText(object);
    return true;
  }
  if (p->getColor) {
    value = p->getColor(object);
    return true;
  }
  if (p->getBoxed) {
    QelBaseUnknown_var boxed = QelBaseUnknown_var::Adopt(p->getBoxed(object));
    QelVidColor color;
    if (!QelBoxingOfQelVidColor::Unbox(boxed.get(), color)) return false;
    value = color;
    return true;
  }
  return false;
}

bool QelSYPMetaClass::SetProperty(QelBaseUnknown* object, const std::string& name, const QelSYPValue& value) const {
  const Property* p = FindProperty(name);
  if (!p || !object || p->readOnly) return false;
  if (p->setInt && (std::holds_alternative<int>(value) || std::holds_alternative<double>(value))) {
    p->setInt(object, QelSYPValueToInt(value));
    return true;
  }
  if (p->setText && std::holds_alternative<QelUnicodeString>(value)) {
    p->setText(object, std::get<QelUnicodeString>(value));
    return true;
  }
  if (p->setBoxed && std::holds_alternative<QelVidColor>(value)) {
    QelBaseUnknown_var boxed = QelBaseUnknown_var::Adopt(QelBoxingOfQelVidColor::Box(std::get<QelVidColor>(value)));
    p->setBoxed(object, boxed.get());
    return true;
  }
  return false;
}

QelSYPEventHandler* QelSYPMetaClass::CreateHandler(QelBaseUnknown* object, const std::string& name) const {
  const Handler* h = FindHandler(name);
  return h && h->factory ? h->factory(object) : nullptr;
}

const QelSYPMetaClass* QelSYPMetaClass::Register(std::unique_ptr<QelSYPMetaClass> metaClass) {
  if (!metaClass) return nullptr;
  std::unique_ptr<QelSYPMetaClass>& slot = Registry()[metaClass->GetClassName()];
  slot = std::move(metaClass);
  return slot.get();
}
