#include "QelHostPlugin.h"

#include <dlfcn.h>

#include <cstdio>

#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelInterfaceDescription.h"
#include "QelMetaObject.h"
#include "QelModuleLoader.h"
#include "QelSettingRepository.h"

namespace {
constexpr const char* kModuleFramework = "QelTPSBrowserUIBase";

// The exported name of a function of the plug-in; dladdr gives the nearest exported
// symbol, which names this function only when it starts exactly there.
std::string ExportedName(const void* function) {
  Dl_info info{};
  if (function && dladdr(function, &info) && info.dli_sname && info.dli_saddr == function) return info.dli_sname;
  return "(not exported)";
}
}  // namespace

void QelHostPlugin::List(std::ostream& out) {
  using Kind = QelDictionary::Registration::Kind;
  for (const auto& r : QelDictionary::Get().RegistrationsOf(kModuleFramework)) {
    switch (r.kind) {
      case Kind::Factory:
        out << "  " << r.key << ' ' << QelInterfaceDescription::NameOf(r.iid) << ' ' << ExportedName(r.function)
            << '\n';
        break;
      case Kind::Extension:
        out << "  " << r.key << " extension " << r.extension->Name() << '\n';
        break;
      case Kind::Component:
        out << "  component " << r.key << '\n';
        break;
      case Kind::ExitAction:
        out << "  exit action\n";
        break;
    }
  }
}

void* QelHostPlugin::Load(const std::string& path, bool list, std::ostream& out) {
  std::string error;
  void* module = QelModuleLoader::Load(path, error);
  if (!module) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return nullptr;
  }
  out << "plug-in " << path << " loaded: " << QelDictionary::Get().RegistrationsOf(kModuleFramework).size()
      << " registrations\n";
  if (list) List(out);
  return module;
}

bool QelHostPlugin::Unload(void* module, const std::string& path, int64_t objectsBefore, std::ostream& out) {
  out.flush();
  QelModuleLoader::Unload(module);
  const std::string absolute = QelModuleLoader::AbsolutePath(path);
  bool ok = true;
  if (void* still = dlopen(absolute.c_str(), RTLD_NOW | RTLD_NOLOAD)) {
    dlclose(still);
    std::fprintf(stderr, "qelhost: the plug-in %s is still mapped after unloading\n", absolute.c_str());
    ok = false;
  }
  const size_t left = QelDictionary::Get().RegistrationsOf(kModuleFramework).size();
  if (left) {
    std::fprintf(stderr, "qelhost: the plug-in left %zu registration(s) behind\n", left);
    ok = false;
  }
  // The frame and the settings were the session's; what is alive after them was leaked.
  QelApplicationFrame::DestroyFrame();
  QelSettingRepository::ForgetRepositories();
  QelDelayedDestruction::FlushIdle();
  const int64_t alive = QelBaseUnknown::LiveObjectCount() - objectsBefore;
  if (alive != 0) {
    std::fprintf(stderr, "qelhost: %lld object(s) of the session still alive after unloading the plug-in\n",
                 static_cast<long long>(alive));
    ok = false;
  }
  out << "plug-in " << path << " unloaded: " << left << " registrations and " << alive << " objects left\n";
  return ok;
}
