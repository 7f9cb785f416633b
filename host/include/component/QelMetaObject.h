#pragma once
// QelMetaObject: the process-wide description of a class (name, kind, base, owning
// framework and, for a data extension, the late types it extends). Each is declared once
// on first use and never freed, so pointers to it stay valid for the whole process.
//
//   const QelMetaObject& QelRovFacet::MetaObject() {
//     static const QelMetaObject& meta = QelMetaObject::Declare(
//         "QelRovFacet", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(),
//         "QelTPSBrowserUIBase");
//     return meta;
//   }
#include <string>
#include <string_view>
#include <vector>

enum class QelMetaKind { Implementation, DataExtension };

class QelMetaObject {
 public:
  // Declares the class, or gives the existing description when the name is known.
  static const QelMetaObject& Declare(std::string_view name, QelMetaKind kind, const QelMetaObject* base,
                                      std::string_view framework, std::vector<std::string> lateTypes = {});
  static const QelMetaObject* Find(std::string_view name);

  const char* Name() const { return name_.c_str(); }
  QelMetaKind Kind() const { return kind_; }
  const QelMetaObject* Base() const { return base_; }
  const std::string& Framework() const { return framework_; }
  const std::vector<std::string>& LateTypes() const { return lateTypes_; }

  // True for the class's own name and the name of every ancestor.
  bool IsAKindOf(std::string_view className) const;

  QelMetaObject(std::string name, QelMetaKind kind, const QelMetaObject* base, std::string framework,
                std::vector<std::string> lateTypes);

 private:
  std::string name_;
  QelMetaKind kind_;
  const QelMetaObject* base_;
  std::string framework_;
  std::vector<std::string> lateTypes_;
};
