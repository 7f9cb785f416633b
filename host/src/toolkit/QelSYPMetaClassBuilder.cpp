#include "QelSYPMetaClassBuilder.h"

#include <map>
#include <memory>
#include <vector>

#include "QelAssert.h"

namespace {
struct Entry {
  QelSYPMetaClassBuilder::Creator creator;
  std::string framework;
};
std::map<std::string, Entry>& Builders() {
  // Never destroyed: a module's unloader may still remove its builders during exit.
  static auto* builders = new std::map<std::string, Entry>();
  return *builders;
}
}  // namespace

void QelSYPMetaClassBuilder::Register(const char* builderName, Creator creator, const char* framework) {
  if (!builderName || !creator) return;
  Builders()[builderName] = {creator, framework ? framework : ""};
}

void QelSYPMetaClassBuilder::RemoveFramework(const std::string& framework) {
  auto& builders = Builders();
  for (auto it = builders.begin(); it != builders.end();)
    it = it->second.framework == framework ? builders.erase(it) : std::next(it);
  QelSYPMetaClass::RemoveFramework(framework);
}

QelSYPMetaClassBuilder::Creator QelSYPMetaClassBuilder::FindCreator(const std::string& builderName) {
  auto it = Builders().find(builderName);
  return it == Builders().end() ? nullptr : it->second.creator;
}

std::string QelSYPMetaClassBuilder::FrameworkOf(const std::string& builderName) {
  auto it = Builders().find(builderName);
  return it == Builders().end() ? std::string() : it->second.framework;
}

QelSYPMetaClassBuilder::QelSYPMetaClassBuilder(const char* className, const char* framework)
    : className_(className ? className : ""), framework_(framework ? framework : "") {}

namespace {
// The record kinds differ only in which getter and setter of the property they fill; a
// property without a setter, or marked read-only, keeps a null setter.
template <class Record, class Getter, class Setter>
void AppendProperties(std::vector<QelSYPMetaClass::Property>& properties, const Record* records, int count,
                      Getter QelSYPMetaClass::Property::*getter, Setter QelSYPMetaClass::Property::*setter) {
  for (int i = 0; records && i < count; ++i) {
    QelSYPMetaClass::Property p;
    p.name = records[i].name;
    p.type = records[i].type;
    p.readOnly = records[i].readOnly != 0 || !records[i].setter;
    p.*getter = records[i].getter;
    if (!p.readOnly) p.*setter = records[i].setter;
    properties.push_back(std::move(p));
  }
}
}  // namespace

void QelSYPMetaClassBuilder::SetProperties(const QelSYPPropertyRecord_Boxed* records, int count) {
  AppendProperties(properties_, records, count, &QelSYPMetaClass::Property::getBoxed,
                   &QelSYPMetaClass::Property::setBoxed);
}

void QelSYPMetaClassBuilder::SetProperties_int(const QelSYPPropertyRecord_int* records, int count) {
  AppendProperties(properties_, records, count, &QelSYPMetaClass::Property::getInt, &QelSYPMetaClass::Property::setInt);
}

void QelSYPMetaClassBuilder::SetProperties_QelUnicodeString(const QelSYPPropertyRecord_QelUnicodeString* records,
                                                            int count) {
  AppendProperties(properties_, records, count, &QelSYPMetaClass::Property::getText,
                   &QelSYPMetaClass::Property::setText);
}

void QelSYPMetaClassBuilder::SetProperties_QelVidColor(const QelSYPPropertyRecord_QelVidColor* records, int count) {
  for (int i = 0; records && i < count; ++i) {
    QelSYPMetaClass::Property p;
    p.name = records[i].name;
    p.type = records[i].type;
    p.readOnly = true;
    p.getColor = records[i].getter;
    properties_.push_back(std::move(p));
  }
}

void QelSYPMetaClassBuilder::SetEventHandlers(const QelSYPEventHandlerRecord* records, int count) {
  for (int i = 0; records && i < count; ++i)
    handlers_.push_back({records[i].name, records[i].argumentType ? records[i].argumentType : "", records[i].factory});
}

void QelSYPMetaClassBuilder::CreateMetaClass(QelSYPCreateFunction create, const char* baseMetaClass) {
  const QelSYPMetaClass* base = baseMetaClass ? QelSYPMetaClass::Find(baseMetaClass) : nullptr;
  if (baseMetaClass && !base) QelAssertPointer(baseMetaClass);
  auto made = std::make_unique<QelSYPMetaClass>(className_, framework_, std::move(properties_), std::move(handlers_),
                                                create, base);
  made_ = QelSYPMetaClass::Register(std::move(made));
}
