#include "ProbeControl.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <unistd.h>

#include "QelBoxingOfQelVidColor.h"
#include "QelSYPMetaClassBuilder.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelVidStyleSheet.h"

const QelMetaObject& ProbeControl::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("ProbeControl", QelMetaKind::Implementation, &QelVidCtl::MetaObject(), "tests");
  return meta;
}

QelBaseUnknown* ProbeControl::GetShade() const { return QelBoxingOfQelVidColor::Box(QelVidColor(1, 2, 3, 4)); }

void ProbeControl::OnPress(QelBaseUnknown* origin, QelSYPEventArgs*) { presses.push_back(origin); }
void ProbeControl::OnEnter(QelBaseUnknown*, QelSYPEventArgs*) { ++enters; }

void ProbeControl::OnTemplateApplied() {
  templateApplied = true;
  pressPartAtHook = RetrieveSypNamedObject(QelString("Press"));
}

namespace {
int GetFlag(QelBaseUnknown* o) { return QelSysDynamicCast<ProbeControl>(o)->GetFlag(); }
void SetFlag(QelBaseUnknown* o, int v) { QelSysDynamicCast<ProbeControl>(o)->SetFlag(v); }
QelUnicodeString GetTitle(QelBaseUnknown* o) { return QelSysDynamicCast<ProbeControl>(o)->GetTitle(); }
QelBaseUnknown* GetShade(QelBaseUnknown* o) { return QelSysDynamicCast<ProbeControl>(o)->GetShade(); }

template <void (ProbeControl::*M)(QelBaseUnknown*, QelSYPEventArgs*)>
QelSYPEventHandler* MakeHandler(QelBaseUnknown* i_pObj) {
  if (!QelTkCheckPointer(i_pObj, "i_pObj")) return nullptr;
  ProbeControl* pObj = QelSysDynamicCast<ProbeControl>(i_pObj);
  if (!QelTkCheckPointer(pObj, "pObj")) return nullptr;
  return new QelSYPWRefMethEventHandler<ProbeControl>(pObj, M);
}
QelBaseUnknown* CreateProbe() { return new ProbeControl(); }

class ProbeBuilder final : public QelSYPMetaClassBuilder {
 public:
  ProbeBuilder() : QelSYPMetaClassBuilder("ProbeControl", "tests") {}
  void Build() override {
    static const QelSYPPropertyRecord_Boxed boxed[] = {{"Shade", "", "QelVidColor", 1, "", 1, &GetShade, nullptr, 0}};
    static const QelSYPPropertyRecord_int ints[] = {{"Flag", "", "int", 0, "", 1, &GetFlag, &SetFlag, 0}};
    static const QelSYPPropertyRecord_QelUnicodeString texts[] = {
        {"Title", "", "QelUnicodeString", 1, "", 1, &GetTitle, nullptr, 0}};
    static const QelSYPEventHandlerRecord handlers[] = {
        {"OnPress", "QelSYPEventArgs", &MakeHandler<&ProbeControl::OnPress>},
        {"OnEnter", "QelSYPEventArgs", &MakeHandler<&ProbeControl::OnEnter>}};
    SetProperties(boxed, 1);
    SetProperties_int(ints, 1);
    SetProperties_QelUnicodeString(texts, 1);
    SetEventHandlers(handlers, 2);
    CreateMetaClass(&CreateProbe, "QelVidCtl");
  }

 private:
  ~ProbeBuilder() override = default;
};

QelBaseUnknown* CreateProbeBuilder() { return new ProbeBuilder(); }
const bool registered = [] {
  QelSYPMetaClassBuilder::Register("ProbeControlSYPMetaClassBuilder", &CreateProbeBuilder, "tests");
  return true;
}();
}  // namespace

StyleFolder::StyleFolder() {
  static int counter = 0;
  path_ = (std::filesystem::temp_directory_path() /
           ("qel-styles-" + std::to_string(::getpid()) + "-" + std::to_string(++counter)))
              .string();
  std::filesystem::create_directories(path_ + "/styles");
  if (const char* old = std::getenv("QEL_RESOURCES_DIR")) {
    previous_ = old;
    hadPrevious_ = true;
  }
  ::setenv("QEL_RESOURCES_DIR", path_.c_str(), 1);
  QelVidStyleSheet::ClearCache();
  QelVidStyleSheet::TakeDiagnostics();
}

StyleFolder::~StyleFolder() {
  if (hadPrevious_) ::setenv("QEL_RESOURCES_DIR", previous_.c_str(), 1);
  else ::unsetenv("QEL_RESOURCES_DIR");
  QelVidStyleSheet::ClearCache();
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

void StyleFolder::Write(const std::string& file, const std::string& text) const {
  std::ofstream(path_ + "/styles/" + file) << text;
}
