#pragma once
// QelSYPMetaClassBuilder: describes one class to the toolkit. A module registers a
// creation function per builder name; the toolkit creates the builder the first time it
// needs the class's table, calls Build, and keeps what CreateMetaClass made.
//
//   void Build() override {
//     SetProperties_int(kIntProperties, 2);
//     SetEventHandlers(kHandlers, 1);
//     CreateMetaClass(&CreateWidget, "QelVidCtl");
//   }
#include <string>
#include <vector>

#include "QelSYPMetaClass.h"
#include "QelVar.h"

class QelSYPMetaClassBuilder : public QelBaseUnknown {
 public:
  using Creator = QelBaseUnknown* (*)();

  static void Register(const char* builderName, Creator creator, const char* framework);
  static void RemoveFramework(const std::string& framework);
  static Creator FindCreator(const std::string& builderName);
  static std::string FrameworkOf(const std::string& builderName);

  virtual void Build() = 0;

  void SetProperties(const QelSYPPropertyRecord_Boxed* records, int count);
  void SetProperties_int(const QelSYPPropertyRecord_int* records, int count);
  void SetProperties_QelUnicodeString(const QelSYPPropertyRecord_QelUnicodeString* records, int count);
  void SetProperties_QelVidColor(const QelSYPPropertyRecord_QelVidColor* records, int count);
  void SetEventHandlers(const QelSYPEventHandlerRecord* records, int count);
  // Ends the description. An unknown base is reported and the class gets none.
  void CreateMetaClass(QelSYPCreateFunction create, const char* baseMetaClass);

  // What CreateMetaClass made; null before.
  const QelSYPMetaClass* GetMetaClass() const { return made_; }

 protected:
  QelSYPMetaClassBuilder(const char* className, const char* framework);
  ~QelSYPMetaClassBuilder() override = default;

 private:
  std::string className_;
  std::string framework_;
  std::vector<QelSYPMetaClass::Property> properties_;
  std::vector<QelSYPMetaClass::Handler> handlers_;
  const QelSYPMetaClass* made_ = nullptr;
};
