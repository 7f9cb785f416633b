// What the module makes known to the host when it is loaded: the identifiers the host's
// own interfaces carry must be the host's, or queries made across modules find nothing.
#include <gtest/gtest.h>

#include "QelDictionary.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelInterfaceDescription.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetPropertyGroup.h"

namespace {

TEST(QelRovFacetsModule, DescribesItsInterfacesWithTheHostIdentifiers) {
  const std::pair<const char*, const char*> expected[] = {
      {"QelIRovFacetPropertyObserver", "{27B4F7EE-22B2-4983-9C0E-E83B932B725B}"},
      {"QelITPSView", "{83AC740F-1500-11D4-949B-0004AC96129F}"},
      {"QelITPS", "{F4A2D390-3DDC-11D3-A929-006094B99C4B}"},
      {"QelILumSet", "{4AAD053D-6478-4A49-B58C-D1CA77769EDB}"},
      {"QelILumCapture", "{FDD59F65-8985-4FFB-9123-8FED03F4EE4F}"},
      {"QelITPSExtractionView", "{0FB2C0F4-EF6D-4813-8950-6A61BC87F795}"},
      {"QelILumGeometry", "{E702236A-E8EE-426C-AB01-D2DCE4E93223}"},
      {"QelILumLightLoadModeObservable", "{AAA2AD96-CA06-4080-92B6-2A9A92E802FE}"},
      {"QelITPSLightSet", "{66664499-6EA0-41CF-9582-10E11DE95351}"},
      {"QelILumLightLoadModeObserver", "{03A57D44-9FB3-4386-A0B6-7C1245DD6B94}"},
      {"QelITPSLight", "{E0C56DEF-9204-4DD2-8E71-54FAB0EE91E3}"},
  };
  for (const auto& [name, text] : expected) {
    const QelInterfaceDescription* description = QelInterfaceDescription::Find(QelIID::Parse(text));
    ASSERT_NE(description, nullptr) << name;
    EXPECT_EQ(description->Name(), name);
    EXPECT_EQ(description->Framework(), "QelTPSBrowserUIBase");
  }
}

TEST(QelRovFacetsModule, RegistersTheObserverTiesOfItsClasses) {
  const QelDictionary& dictionary = QelDictionary::Get();
  EXPECT_NE(dictionary.FindFactory("QelRovFacetGroup", QelIRovFacetPropertyObserver::IID), nullptr);
  EXPECT_NE(dictionary.FindFactory("QelRovFacetGroup", QelILumLightLoadModeObserver::IID), nullptr);
  EXPECT_NE(dictionary.FindFactory("QelRovFacetPropertyGroup", QelIRovFacetPropertyObserver::IID), nullptr);
  const auto lines = dictionary.Describe("QelTPSBrowserUIBase");
  ASSERT_EQ(lines.size(), 3u);
  EXPECT_EQ(lines[0], "QelRovFacetGroup QelIRovFacetPropertyObserver QelTPSBrowserUIBase");
}

}  // namespace
