#pragma once
// QelSYPMetaClass: the introspection table of one widget class: its properties (name,
// type, getter, optional setter: no setter means read-only), its event handlers (name,
// argument type, handler factory), a creation function and a base meta class. Made by a
// builder (QelSYPMetaClassBuilder), then kept until the framework that built it unloads.
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "QelSYPValue.h"

class QelBaseUnknown;
class QelSYPEventHandler;

using QelSYPGetter_int = int (*)(QelBaseUnknown* object);
using QelSYPSetter_int = void (*)(QelBaseUnknown* object, int value);
using QelSYPGetter_QelUnicodeString = QelUnicodeString (*)(QelBaseUnknown* object);
using QelSYPSetter_QelUnicodeString = void (*)(QelBaseUnknown* object, const QelUnicodeString& value);
// Boxed values: the getter gives a new reference to a boxed object (QelBoxingOf...).
using QelSYPGetter_Boxed = QelBaseUnknown* (*)(QelBaseUnknown* object);
using QelSYPSetter_Boxed = void (*)(QelBaseUnknown* object, QelBaseUnknown* boxed);
// Colours read by value: no boxed object per read, for properties bound on every row.
using QelSYPGetter_QelVidColor = QelVidColor (*)(QelBaseUnknown* object);
// A new handler (one reference, the caller's) bound to `object`, or null.
using QelSYPHandlerFactory = QelSYPEventHandler* (*)(QelBaseUnknown* object);
// A new object of the class (one reference, the caller's).
using QelSYPCreateFunction = QelBaseUnknown* (*)();

// A property record as the generated tables write it: name, category, type, read-only,
// documentation, the value 1, getter, setter, the value 0.
template <class Getter, class Setter>
struct QelSYPPropertyRecord {
  const char* name;
  const char* category;
  const char* type;
  int readOnly;
  const char* documentation;
  int serializable;
  Getter getter;
  Setter setter;
  int reserved;
};
using QelSYPPropertyRecord_Boxed = QelSYPPropertyRecord<QelSYPGetter_Boxed, QelSYPSetter_Boxed>;
using QelSYPPropertyRecord_int = QelSYPPropertyRecord<QelSYPGetter_int, QelSYPSetter_int>;
using QelSYPPropertyRecord_QelUnicodeString =
    QelSYPPropertyRecord<QelSYPGetter_QelUnicodeString, QelSYPSetter_QelUnicodeString>;
// Read-only colours by value; the setter slot stays empty (a settable colour goes boxed).
using QelSYPPropertyRecord_QelVidColor = QelSYPPropertyRecord<QelSYPGetter_QelVidColor, std::nullptr_t>;

struct QelSYPEventHandlerRecord {
  const char* name;
  const char* argumentType;
  QelSYPHandlerFactory factory;
};

class QelSYPMetaClass {
 public:
  struct Property {
    std::string name;
    std::string type;
    bool readOnly = true;
    QelSYPGetter_int getInt = nullptr;
    QelSYPSetter_int setInt = nullptr;
    QelSYPGetter_QelUnicodeString getText = nullptr;
    QelSYPSetter_QelUnicodeString setText = nullptr;
    QelSYPGetter_Boxed getBoxed = nullptr;
    QelSYPGetter_QelVidColor getColor = nullptr;
    QelSYPSetter_Boxed setBoxed = nullptr;
  };
  struct Handler {
    std::string name;
    std::string argumentType;
    QelSYPHandlerFactory factory = nullptr;
  };

  QelSYPMetaClass(std::string className, std::string framework, std::vector<Property> properties,
                  std::vector<Handler> handlers, QelSYPCreateFunction create, const QelSYPMetaClass* base);

  // The class, registered by its own builder on first use; null when no builder is
  // registered under "<className>SYPMetaClassBuilder" and the class is not the toolkit's.
  static const QelSYPMetaClass* Find(std::string_view className);
  // Forgets the classes a framework built (its getters would dangle once it unloads).
  static void RemoveFramework(const std::string& framework);
  // Keeps a table made by a builder, replacing one of the same class name.
  static const QelSYPMetaClass* Register(std::unique_ptr<QelSYPMetaClass> metaClass);

  const std::string& GetClassName() const { return className_; }
  const std::string& GetFramework() const { return framework_; }
  const QelSYPMetaClass* GetBase() const { return base_; }
  const std::vector<Property>& GetProperties() const { return properties_; }
  const std::vector<Handler>& GetHandlers() const { return handlers_; }
  QelSYPCreateFunction GetCreateFunction() const { return create_; }

  // Looked up in this class, then its bases.
  const Property* FindProperty(const std::string& name) const;
  const Handler* FindHandler(const std::string& name) const;

  // False when the property does not exist, cannot be read or written, or the value's
  // type does not fit.
  bool GetProperty(QelBaseUnknown* object, const std::string& name, QelSYPValue& value) const;
  bool SetProperty(QelBaseUnknown* object, const std::string& name, const QelSYPValue& value) const;
  // Reads one property of this table (or a base's) from `object`.
  static bool Read(QelBaseUnknown* object, const Property& property, QelSYPValue& value);
  // A new handler bound to `object` for the named handler, or null.
  QelSYPEventHandler* CreateHandler(QelBaseUnknown* object, const std::string& name) const;

 private:
  std::string className_;
  std::string framework_;
  std::vector<Property> properties_;
  std::vector<Handler> handlers_;
  QelSYPCreateFunction create_;
  const QelSYPMetaClass* base_;
};
