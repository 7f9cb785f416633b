#pragma once
// A styled control for the toolkit's tests: one property of each kind, two handlers that
// record their origin, and a builder registered under "ProbeControlSYPMetaClassBuilder".
// StyleFolder writes sheets into a fresh resource folder that the toolkit reads from.
#include <string>
#include <vector>

#include "QelSYPEventArgs.h"
#include "QelVidCtl.h"

class ProbeControl : public QelVidCtl {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  ProbeControl() : QelVidCtl(nullptr, QelString("probe")) {}

  int GetFlag() const { return flag; }
  void SetFlag(int value) { flag = value; }
  QelUnicodeString GetTitle() const { return title; }
  QelBaseUnknown* GetShade() const;
  void OnPress(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnEnter(QelBaseUnknown* origin, QelSYPEventArgs* args);

  int flag = 0;
  QelUnicodeString title = QelUnicodeString("Probe");
  std::vector<QelBaseUnknown*> presses;
  int enters = 0;
  bool templateApplied = false;
  QelVidWidget* pressPartAtHook = nullptr;

 protected:
  ~ProbeControl() override = default;
  void OnTemplateApplied() override;
};

// Points QEL_RESOURCES_DIR at a new folder for the life of the object.
class StyleFolder {
 public:
  StyleFolder();
  ~StyleFolder();
  void Write(const std::string& file, const std::string& text) const;
  const std::string& Path() const { return path_; }

 private:
  std::string path_;
  std::string previous_;
  bool hadPrevious_ = false;
};
