// qelhost: the reference host program. It stands in for the design application: opens a
// product model, loads the QelRovFacets plug-in and shows what a reviewer would see.
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <iostream>
#include <string>
#include <vector>

#include "QelAssert.h"
#include "QelDictionary.h"
#include "QelHostDemo.h"
#include "QelHostModelFiles.h"
#include "QelHostOptions.h"
#include "QelHostPlugin.h"
#include "QelHostPictures.h"
#include "QelHostSession.h"
#include "QelHostWebServer.h"
#include "QelModelLoader.h"
#include "QelModelPrinter.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"
#include "QelSampleProduct.h"
#include "QelSettingRepository.h"
#include "QelSysHeap.h"
#include "QelWidgetsPreview.h"

namespace {
// Internal check reports go to a log file beside the settings (or QEL_LOG_FILE), so a
// person's terminal holds the review; at exit the person is told how many were written.
struct SysLogNotice {
  SysLogNotice() {
    const std::string file = QelGetEnv("QEL_LOG_FILE");
    QelSetSysLogFile(file.empty() ? QelSettingRepository::SettingsFolder() + "/qelhost.log" : file);
  }
  ~SysLogNotice() {
    std::cout.flush();  // after everything the session printed
    std::fflush(stdout);
    if (QelSysLogCount() > 0)
      std::fprintf(stderr, "qelhost: %d internal check report(s) written to %s\n", QelSysLogCount(),
                   QelSysLogFile().c_str());
  }
};

// Prints or writes the requested user settings; false when one could not be done. `alone`:
// nothing else was asked, so each value is printed by itself, for a script to read.
bool HandleSettings(const std::vector<QelHostOptions::SettingRequest>& requests, bool alone) {
  bool ok = true;
  for (const auto& request : requests) {
    QelSettingRepository* repository = QelSettingRepository::GetRepository(request.repository.c_str());
    if (!repository) {
      std::fprintf(stderr, "qelhost: no settings repository '%s'\n", request.repository.c_str());
      ok = false;
      continue;
    }
    const char* key = request.key.c_str();
    if (request.value) {
      char* end = nullptr;
      long asInt = std::strtol(request.value->c_str(), &end, 10);
      bool isInt = !request.value->empty() && *end == '\0' && asInt >= INT32_MIN && asInt <= INT32_MAX;
      HRESULT written = isInt ? repository->WriteSetting(key, static_cast<int>(asInt))
                              : repository->WriteSetting(key, request.value->c_str());
      if (written != S_OK || repository->SaveRepository() != S_OK) {
        std::fprintf(stderr, "qelhost: could not save %s/%s in %s\n", request.repository.c_str(), key,
                     repository->GetFilePath().c_str());
        ok = false;
        continue;
      }
    }
    if (repository->IsFileUnusable()) {
      std::fprintf(stderr, "qelhost: %s/%s cannot be read: the settings file %s is not usable (see above)\n",
                   request.repository.c_str(), key, repository->GetFilePath().c_str());
      ok = false;
      continue;
    }
    int number = 0;
    QelString text;
    if (repository->ReadSetting(key, number) == S_OK) {
      if (alone) std::printf("%d\n", number);
      else std::printf("setting %s/%s = %d\n", request.repository.c_str(), key, number);
    } else if (repository->ReadSetting(key, text) == S_OK) {
      if (alone) std::printf("%s\n", text.CastToCharPtr());
      else std::printf("setting %s/%s = \"%s\"\n", request.repository.c_str(), key, text.CastToCharPtr());
    } else if (alone) {
      std::fprintf(stderr, "qelhost: %s/%s is not set (%s)\n", request.repository.c_str(), key,
                   repository->GetFilePath().c_str());
      ok = false;
    } else {
      std::printf("setting %s/%s is not set (%s)\n", request.repository.c_str(), key, repository->GetFilePath().c_str());
    }
  }
  return ok;
}

bool ApplyDisplayChanges(QelBaseUnknown* root, const std::vector<QelHostOptions::DisplayChange>& changes) {
  for (const auto& change : changes) {
    QelListValQelBaseUnknown_var objects = QelModelPrinter::FindByAlias(root, change.name);
    if (objects.Size() == 0) {
      std::fprintf(stderr, "qelhost: --%s '%s': the model has no object of that name\n",
                   change.show ? "show" : "hide", change.name.c_str());
      return false;
    }
    QelRovFacetServices::EnableDisableDisplay(objects, change.show ? 1 : 0, nullptr);
  }
  return true;
}

// Re-applies the annotations of the visible sets through the filter data, as the type
// facet does when its default-annotation switch or tolerance range changes.
void ApplyFilter(QelBaseUnknown* root, const QelHostOptions& options) {
  auto filter = QelMakeVar<QelRovFacetFilterData>();
  filter->DefaultAnnot = options.defaultOnly;
  if (options.tolerance) {
    const QelToleranceRange& range = *options.tolerance;
    filter->TolAnnot = true;
    filter->SetToleranceValues(range.leftOp, range.left ? &*range.left : nullptr, range.rightOp,
                               range.right ? &*range.right : nullptr);
  }
  QelListValQelBaseUnknown_var annotations;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(root, annotations);
  QelRovFacetServices::EnableDisableDisplay(annotations, 1, filter.get());
}

// The review session on the open model: the script given, else a person at the
// terminal, else the commands on standard input.
int RunSession(const QelBaseUnknown_var& root, const QelHostOptions& options, void* module) {
  QelHostSession session(std::cout, std::cerr);
  session.SetModule(module);
  std::string error;
  const std::string name = options.modelPath.empty() ? kQelSampleProductName : options.modelPath;
  if (options.demo)
    // The panel is part of the show whatever this workbench's setting says; the value is
    // not saved.
    if (QelSettingRepository* repository = QelSettingRepository::GetRepository("QelRovDataFiltering"))
      repository->WriteSetting((std::string("DataFilteringPanel_") + kDefaultWorkbench).c_str(), 1, 1);
  if (!session.Attach(root, name, error)) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  if (options.demo) {
    std::istringstream script(kQelHostDemoScript);
    return session.RunScript(script, "demo");
  }
  if (!options.scriptPath.empty()) {
    std::ifstream script(options.scriptPath);
    if (!script) {
      std::fprintf(stderr, "qelhost: cannot read the script %s\n", options.scriptPath.c_str());
      return 1;
    }
    return session.RunScript(script, options.scriptPath);
  }
  // A terminal on both sides is a person; a terminal that nobody reads the answers of
  // (output captured by a test runner or a file) gets no session rather than a wait.
  if (isatty(STDIN_FILENO)) {
    if (!isatty(STDOUT_FILENO)) return 0;
    // A person starts with the panel in view.
    session.Execute("panel", error);
    return session.RunInteractive();
  }
  return session.RunScript(std::cin, "stdin");
}
}  // namespace

int main(int argc, char** argv) {
  QelSysKeepFreedHeap();
  if (QelWidgetsPreviewWanted(argc, argv)) return QelWidgetsPreviewMain(argc, argv);
  const SysLogNotice logNotice;
  QelHostOptions options;
  std::string error;
  if (int code = 0; QelHostPictures::Run(std::vector<std::string>(argv + 1, argv + argc), options.modulePath,
                                         kQelSampleProductText, kQelSampleProductName, code)) {
    return code;
  }
  if (!QelHostOptions::Parse(std::vector<std::string>(argv + 1, argv + argc), options, error)) {
    std::fprintf(stderr, "qelhost: %s\n\n%s", error.c_str(), QelHostOptions::Usage());
    return 2;
  }
  if (options.action == QelHostOptions::Action::Help) {
    std::fputs(QelHostOptions::Usage(), stdout);
    return 0;
  }
  if (options.action == QelHostOptions::Action::Version) {
    std::printf("qelhost %s\n", QEL_VERSION);
    return 0;
  }

  // Only settings asked: no model, no plug-in, just the values.
  if (!options.settings.empty() && options.modelPath.empty() && options.scriptPath.empty() && !options.demo &&
      options.exportJsonPath.empty() && options.displayChanges.empty() && !options.defaultOnly &&
      !options.tolerance && !options.serve && !options.listModule)
    return HandleSettings(options.settings, true) ? 0 : 1;

  const int64_t objectsBefore = QelBaseUnknown::LiveObjectCount();
  QelBaseUnknown_var root;
  HRESULT loaded = options.modelPath.empty()
                       ? QelModelLoader::LoadText(kQelSampleProductText, kQelSampleProductName, root, error)
                       : QelHostModelFiles::Load(options.modelPath, root, error, std::cout);
  if (loaded != S_OK) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  if (!options.exportJsonPath.empty()) {
    if (!QelHostModelFiles::ExportJson(root.get(), options.exportJsonPath, error)) {
      std::fprintf(stderr, "qelhost: %s\n", error.c_str());
      return 1;
    }
    std::printf("model written to %s\n", options.exportJsonPath.c_str());
    return 0;
  }
  std::printf("model %s\n", options.modelPath.empty() ? kQelSampleProductName : options.modelPath.c_str());
  std::fflush(stdout);
  void* module = QelHostPlugin::Load(options.modulePath, options.listModule, std::cout);
  if (!module) return 1;
  if (!HandleSettings(options.settings, false)) return 1;
  if (!ApplyDisplayChanges(root.get(), options.displayChanges)) return 1;
  if (options.defaultOnly || options.tolerance) ApplyFilter(root.get(), options);
  if (options.serve) {
    // Serve takes the model and lets it go before it returns, so the plug-in can go after it.
    const int status = QelHostWebServer::Serve(
        std::move(root), options.modelPath.empty() ? kQelSampleProductName : options.modelPath, options.port, module);
    return QelHostPlugin::Unload(module, options.modulePath, objectsBefore, std::cout) ? status : 1;
  }
  std::cout << '\n';
  QelModelPrinter::Print(root.get(), std::cout);
  const int status = RunSession(root, options, module);
  // The model goes first: data extensions the plug-in attached to its objects run the
  // plug-in's code when they go.
  root = nullptr;
  return QelHostPlugin::Unload(module, options.modulePath, objectsBefore, std::cout) ? status : 1;
}
