// A facet as the observer of its top-level properties: radio exclusivity, the change
// applied as a whole, and the facet group told only when that took effect.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"

namespace {

class QelRovFacetChange : public ::testing::Test {
 protected:
  void SetUp() override {
    group = Make<RecordingObserver>();
    facet = Make<TestFacet>(group.get());
    for (const char* name : {"all", "none", "custom"}) {
      auto p = Make<TestProperty>(name, facet.get(), &log);
      p->SetFlags(QelRovFacetProperty::FlagsRadio);
      facet->Add(p.get());
      radios.push_back(p);
    }
    radios[0]->SetCheckState(Checked);
    checkbox = Make<TestProperty>("default", facet.get(), &log);
    checkbox->SetCheckState(Checked);
    facet->Add(checkbox.get());
  }
  ApplyLog log;
  QelVar<RecordingObserver> group;
  QelVar<TestFacet> facet;
  std::vector<QelVar<TestProperty>> radios;
  QelVar<TestProperty> checkbox;
};

TEST_F(QelRovFacetChange, ChoosingARadioUnchecksTheOthersWithoutApplyingThem) {
  EXPECT_EQ(radios[1]->SetCheck(true), S_OK);
  EXPECT_EQ(radios[0]->GetCheckState(), Unchecked);
  EXPECT_EQ(radios[1]->GetCheckState(), Checked);
  EXPECT_EQ(radios[2]->GetCheckState(), Unchecked);
  EXPECT_EQ(checkbox->GetCheckState(), Checked);  // not a radio choice
  EXPECT_EQ(log, ApplyLog{"none+"});
  ASSERT_EQ(facet->applied.size(), 1u);
  ASSERT_EQ(group->changed.size(), 1u);
  EXPECT_TRUE(facet->IsEqual(group->changed[0]));
}

TEST_F(QelRovFacetChange, ApplyPropertyChangeNotOkStopsAtTheFacet) {
  facet->applyAnswer = S_FALSE;
  EXPECT_EQ(checkbox->SetCheck(false), S_OK);
  EXPECT_EQ(facet->applied.size(), 1u);
  EXPECT_TRUE(group->changed.empty());
}

TEST_F(QelRovFacetChange, EntryThatIsNoPropertyIsReportedAndSkipped) {
  QelAssertionCapture capture;
  facet->Add(group.get());
  EXPECT_EQ(radios[2]->SetCheck(true), S_OK);
  EXPECT_EQ(radios[0]->GetCheckState(), Unchecked);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 1);
}

// A facet's veto holds whoever asks: the property reaches it through the observer tie,
// which only knows the facet base class.
TEST_F(QelRovFacetChange, FacetVetoReachesThroughTheBaseClass) {
  facet->veto = S_FALSE;
  EXPECT_EQ(radios[1]->SetCheck(true), E_FAIL);
  EXPECT_EQ(radios[1]->GetCheckState(), Unchecked);
  EXPECT_EQ(radios[0]->GetCheckState(), Checked);
  EXPECT_TRUE(log.empty());
  EXPECT_TRUE(facet->applied.empty());
}

TEST(QelRovFacetAccessors, FacetGroupResolvesOnlyToALiveFacetGroup) {
  QelAssertionCapture capture;
  auto observer = Make<RecordingObserver>();
  auto facet = Make<TestFacet>(observer.get());
  EXPECT_FALSE(facet->GetFacetGroup());  // an observer, but no facet group: no report
  EXPECT_EQ(capture.Count(), 0);
  observer = nullptr;
  EXPECT_FALSE(facet->GetFacetGroup());
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

}  // namespace
