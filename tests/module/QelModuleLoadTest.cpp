// Loading the plug-in for real: dlopen runs its registration, dlclose takes every entry
// back, so that nothing in the dictionary points into an unloaded library.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>

#include "QelDictionary.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelModuleLoader.h"

namespace {

constexpr const char* kFramework = "QelTPSBrowserUIBase";

TEST(QelModuleLoad, LoadRegistersAndUnloadTakesEveryEntryBack) {
  QelDictionary& dictionary = QelDictionary::Get();
  ASSERT_TRUE(dictionary.Describe(kFramework).empty());
  std::string error;
  void* module = QelModuleLoader::Load(QEL_MODULE_PATH, error);
  ASSERT_NE(module, nullptr) << error;
  EXPECT_NE(dictionary.FindFactory("QelRovFacetGroup", QelIRovFacetPropertyObserver::IID), nullptr);
  EXPECT_NE(dictionary.FindFactory("QelRovFacetPropertyGroup", QelIRovFacetPropertyObserver::IID), nullptr);

  QelModuleLoader::Unload(module);
  EXPECT_EQ(dlopen(QEL_MODULE_PATH, RTLD_NOW | RTLD_NOLOAD), nullptr) << "the library is still mapped";
  EXPECT_TRUE(dictionary.Describe(kFramework).empty());
  EXPECT_EQ(dictionary.FindFactory("QelRovFacetGroup", QelIRovFacetPropertyObserver::IID), nullptr);
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
