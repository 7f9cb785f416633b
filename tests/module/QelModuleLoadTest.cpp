// Loading the plug-in for real: dlopen runs its registration, in order, each entry pointing
// at the factory the library exports under the entry's name; dlclose runs the exit action
// and takes every entry back, so no notification reaches the unloaded code.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelFrmContext.h"
#include "QelFrmLayout.h"
#include "QelIHyxFacetCtrl.h"
#include "QelInterfaceDescription.h"
#include "QelModuleAbi.h"
#include "QelModuleLoader.h"
#include "QelRovFacetServices.h"
#include "QelSYPMetaClassBuilder.h"
#include "QelSettingRepository.h"

namespace {

constexpr const char* kFramework = "QelTPSBrowserUIBase";
using Kind = QelDictionary::Registration::Kind;

bool Mapped(const char* path) {
  void* handle = dlopen(path, RTLD_NOW | RTLD_NOLOAD);
  if (handle) dlclose(handle);
  return handle != nullptr;
}

TEST(QelModuleLoad, RegistrationsComeInOrderAndResolveToTheExportedFactories) {
  QelDictionary& dictionary = QelDictionary::Get();
  ASSERT_TRUE(dictionary.RegistrationsOf(kFramework).empty());
  std::string error;
  void* module = QelModuleLoader::Load(QEL_MODULE_PATH, error);
  ASSERT_NE(module, nullptr) << error;

  // Each entry's factory is the one exported under CreateTIE|CreateBOA<interface><class>.
  std::vector<std::string> order;
  for (const auto& r : dictionary.RegistrationsOf(kFramework)) {
    order.push_back(r.kind == Kind::ExitAction ? "exit" : r.key);
    if (r.kind != Kind::Factory) continue;
    const std::string suffix = QelInterfaceDescription::NameOf(r.iid) + r.key;
    const void* tie = dlsym(module, ("CreateTIE" + suffix).c_str());
    EXPECT_EQ(r.function, tie ? tie : dlsym(module, ("CreateBOA" + suffix).c_str())) << suffix;
  }
  const std::vector<std::string> expected = {
      "QelDbrBrowserContextLFT", "QelDbrBrowserContextLFT", "SorOccurrence", "PCCMemDMUValidationValidation",
      "QelERovBrowserContextFactory", "QelTPSLightView", "QelTPSLightCapture", "QelERovViewsBrowserViewBaseUI",
      "QelERovViewsBrowserViewBaseUI", "QelRovFacetAnnotation", "QelRovFacetAnnotationSet", "exit",
      "QelRovFacetController", "QelRovFacetController", "QelRovFacetGroup", "QelRovFacetGroup",
      "QelRovFacetPropertyGroup", "QelRovFacetView"};
  EXPECT_EQ(order, expected);
  EXPECT_NE(QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController"), nullptr);
  for (const char* builder : {"QelRovRefinementDlgSYPMetaClassBuilder", "QelRovRefinementFacetSYPMetaClassBuilder",
                              "QelRovRefinementPropertySYPMetaClassBuilder"})
    EXPECT_EQ(reinterpret_cast<void*>(QelSYPMetaClassBuilder::FindCreator(builder)),
              dlsym(module, (std::string("fctCreate") + builder).c_str()));
  EXPECT_EQ(QelInterfaceDescription::NameOf(QelIID::Parse("{27B4F7EE-22B2-4983-9C0E-E83B932B725B}")),
            "QelIRovFacetPropertyObserver");
  // The contract's C++ exports are there; the module's internals are not.
  EXPECT_NE(dlsym(module, "_ZN21QelRovFacetController22HideDataFilteringPanelEP12QelFrmEditor"), nullptr);
  EXPECT_NE(dlsym(module, "_ZN24QelRovBrowserViewToolbox23GetThumbnailDescriptionER6QelVarI14QelBaseUnknownE"),
            nullptr);
  EXPECT_EQ(dlsym(module, "_ZN16QelRovFacetGroup11CreatePanelEv"), nullptr);

  QelModuleLoader::Unload(module);
  EXPECT_FALSE(Mapped(QEL_MODULE_PATH)) << "the library is still mapped";
  EXPECT_TRUE(dictionary.RegistrationsOf(kFramework).empty());
  EXPECT_EQ(QelSYPMetaClassBuilder::FindCreator("QelRovRefinementDlgSYPMetaClassBuilder"), nullptr);
}

// The controller the host made by name answers IsA and IsAKindOf through its meta class;
// after unload none of its callbacks is left, so notifications sent then reach nothing
// of the module (a live one would jump into unmapped code).
TEST(QelModuleLoad, UnloadEndsTheControllerAndItsCallbacks) {
  setenv("QEL_SETTINGS_DIR", (std::filesystem::temp_directory_path() / "qel-module-unload").c_str(), 1);
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  QelApplicationFrame* frame = QelApplicationFrame::CreateFrame(QelString("LumReview"));
  QelRovFacetServices::SetRefinementDevActive(true);
  QelCallbackManager& callbacks = QelCallbackManager::Get();
  QelBaseUnknown* layout = QelFrmLayout::GetCurrentLayout();
  QelBaseUnknown* dispatcher = frame->GetDispatcher();
  const int layoutBefore = callbacks.CountCallbacks(layout);
  const int dispatcherBefore = callbacks.CountCallbacks(dispatcher);
  std::string error;
  void* module = QelModuleLoader::Load(QEL_MODULE_PATH, error);
  ASSERT_NE(module, nullptr) << error;
  {
    QelVar<QelIHyxFacetCtrl> controller = QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController");
    ASSERT_TRUE(controller);
    EXPECT_STREQ(controller->IsA(), "QelRovFacetController");
    EXPECT_TRUE(controller->IsAKindOf("QelRovFacetController"));
    EXPECT_TRUE(controller->IsAKindOf("QelIHyxFacetCtrl"));
    EXPECT_TRUE(controller->IsAKindOf("QelBaseUnknown"));
    EXPECT_FALSE(controller->IsAKindOf("QelRovFacetGroup"));
    EXPECT_GT(callbacks.CountCallbacks(layout), layoutBefore);
    EXPECT_GT(callbacks.CountCallbacks(dispatcher), dispatcherBefore);
  }
  QelModuleLoader::Unload(module);
  ASSERT_FALSE(Mapped(QEL_MODULE_PATH));
  EXPECT_EQ(callbacks.CountCallbacks(layout), layoutBefore);
  EXPECT_EQ(callbacks.CountCallbacks(dispatcher), dispatcherBefore);
  callbacks.Dispatch(layout, kQelUIActiveObjectChanged);
  callbacks.Dispatch(dispatcher, kQelAfrAccessChanged);
  QelFrmContext::GetContext()->SwitchWorkbench(QelString("TPSCfg"));
  QelApplicationFrame::DestroyFrame();
  QelSettingRepository::ForgetRepositories();
  QelDelayedDestruction::FlushIdle();
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}

// A missing file, a library that is no module and a module of another ABI are refused
// with their path and reason, and whatever was opened is closed again.
TEST(QelModuleLoad, RefusesMissingForeignAndOtherAbiLibraries) {
  std::string error;
  EXPECT_EQ(QelModuleLoader::Load("/nonexistent/libQelRovFacets.so", error), nullptr);
  EXPECT_NE(error.find("/nonexistent/libQelRovFacets.so"), std::string::npos) << error;

  Dl_info info{};  // libpng, which the host links: a real library, but no module
  ASSERT_TRUE(dladdr(dlsym(RTLD_DEFAULT, "png_access_version_number"), &info) && info.dli_fname);
  EXPECT_EQ(QelModuleLoader::Load(info.dli_fname, error), nullptr);
  EXPECT_NE(error.find("is not a plug-in module"), std::string::npos) << error;

  EXPECT_EQ(QelModuleLoader::Load(QEL_OTHER_ABI_MODULE_PATH, error), nullptr);
  EXPECT_NE(error.find("built for module ABI " + std::to_string(kQelModuleAbiVersion + 1)), std::string::npos)
      << error;
  EXPECT_FALSE(Mapped(QEL_OTHER_ABI_MODULE_PATH));
}

// A library found beside the program that fails to load is the one meant: its own reason
// is reported, not that the system search found nothing under that name.
TEST(QelModuleLoad, BrokenLibraryBesideTheProgramReportsItsOwnReason) {
  const std::string name = "libQelBrokenForTest.so";
  const std::string path = QelModuleLoader::ProgramFolder() + name;
  { std::ofstream(path) << "not a shared library"; }
  std::string error;
  void* module = QelModuleLoader::Load(name, error);
  std::remove(path.c_str());
  EXPECT_EQ(module, nullptr);
  EXPECT_NE(error.find(path), std::string::npos) << error;
  EXPECT_EQ(error.find("No such file"), std::string::npos) << error;
}

}  // namespace
