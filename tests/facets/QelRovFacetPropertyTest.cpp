// The road of one click from a property to its owner, and the tolerance range reached
// through the facet group's filter data.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelRovFacetFilterData.h"

namespace {

TEST(QelRovFacetPropertySetCheck, ChangeIsAskedStoredAppliedAndToldInThatOrder) {
  ApplyLog log;
  auto observer = Make<RecordingObserver>();
  auto p = Make<TestProperty>("p", observer.get(), &log);
  EXPECT_EQ(p->GetCheckState(), Unchecked);
  EXPECT_EQ(p->SetCheck(true), S_OK);
  EXPECT_EQ(observer->asked, std::vector<QelCheckState>{Checked});
  EXPECT_EQ(log, ApplyLog{"p+"});
  ASSERT_EQ(observer->changed.size(), 1u);
  EXPECT_TRUE(p->IsEqual(observer->changed[0]));
  EXPECT_EQ(p->SetCheck(true), S_FALSE);  // same state: nobody told
  EXPECT_EQ(observer->changed.size(), 1u);
}

TEST(QelRovFacetPropertySetCheck, VetoKeepsStateAndDisplayAndReturnsFail) {
  ApplyLog log;
  auto observer = Make<RecordingObserver>();
  observer->answer = S_FALSE;
  auto p = Make<TestProperty>("p", observer.get(), &log);
  EXPECT_EQ(p->SetCheck(true), E_FAIL);
  EXPECT_EQ(p->GetCheckState(), Unchecked);
  EXPECT_TRUE(log.empty());
  EXPECT_TRUE(observer->changed.empty());
}

// Clicks that change nothing: a radio choice is never unchecked by a click, and a
// property whose owner is gone refuses without touching its state.
TEST(QelRovFacetPropertySetCheck, RadioUncheckAndVanishedOwnerChangeNothing) {
  QelAssertionCapture capture;
  auto observer = Make<RecordingObserver>();
  auto radio = Make<TestProperty>("radio", observer.get());
  radio->SetFlags(QelRovFacetProperty::FlagsRadio);
  radio->SetCheckState(Checked);
  EXPECT_EQ(radio->SetCheck(false), S_FALSE);
  EXPECT_EQ(radio->GetCheckState(), Checked);
  EXPECT_TRUE(observer->asked.empty());

  auto orphan = Make<TestProperty>("orphan", observer.get());
  observer = nullptr;
  EXPECT_EQ(orphan->SetCheck(true), E_UNEXPECTED);
  EXPECT_EQ(orphan->GetCheckState(), Unchecked);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

// An owner may drop the property while it is asked (a modal question runs the host's loop,
// where a rebuild can happen): the property must still be alive to answer.
TEST(QelRovFacetPropertySetCheck, OwnerReleasingThePropertyWhileAskedIsSafe) {
  class DroppingObserver : public RecordingObserver {
   public:
    HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState state) override {
      held = nullptr;
      return RecordingObserver::CanChangeCheckState(property, state);
    }
    QelVar<TestProperty> held;

   protected:
    ~DroppingObserver() override = default;
  };
  auto observer = Make<DroppingObserver>();
  TestProperty* p = nullptr;
  {
    auto made = Make<TestProperty>("p", observer.get());
    p = made.get();
    observer->held = made;
  }
  EXPECT_EQ(p->SetCheck(true), S_OK);  // freed memory here without the early hold
  EXPECT_EQ(observer->changed.size(), 1u);
}

TEST(QelRovFacetPropertySetCheck, PartiallyCheckedChangesOnEitherClick) {
  auto observer = Make<RecordingObserver>();
  for (bool click : {true, false}) {
    auto p = Make<TestProperty>("p", observer.get());
    p->SetCheckState(PartiallyChecked);
    EXPECT_EQ(p->SetCheck(click), S_OK);
    EXPECT_EQ(p->GetCheckState(), click ? Checked : Unchecked);
  }
}

TEST(QelRovFacetPropertySetCheck, FailedApplyIsReportedAndOwnerStillTold) {
  QelAssertionCapture capture;
  auto observer = Make<RecordingObserver>();
  auto p = Make<TestProperty>("p", observer.get());
  p->applyAnswer = E_FAIL;
  EXPECT_EQ(p->SetCheck(true), S_OK);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);
  EXPECT_EQ(observer->changed.size(), 1u);
}

class QelRovFacetPropertyTolerance : public ::testing::Test {
 protected:
  void SetUp() override {
    group = Make<TestFacetGroup>(nullptr);
    facet = Make<TestFacet>(group.get());
    filter = Make<QelRovFacetFilterData>();
    group->SetFacets(facet.get(), facet.get(), nullptr, filter.get());
    range = Make<TestProperty>("range", facet.get());
    range->SetFlags(QelRovFacetProperty::FlagsCheckBoxRange);
    range->SetRangeMode(3);
  }
  QelAssertionCapture capture;  // the group's null editor is reported
  QelVar<TestFacetGroup> group;
  QelVar<TestFacet> facet;
  QelVar<QelRovFacetFilterData> filter;
  QelVar<TestProperty> range;
};

TEST_F(QelRovFacetPropertyTolerance, SetStoresInFilterDataAndTellsTheFacet) {
  const double low = 0.1, high = 0.5;
  EXPECT_EQ(range->SetToleranceValues(QelPropertyOperatorGreater, &low, QelPropertyOperatorLess, &high), S_OK);
  ASSERT_EQ(facet->applied.size(), 1u);
  QelPropertyOperator leftOp{}, rightOp{};
  double *left = nullptr, *right = nullptr;
  EXPECT_EQ(range->GetToleranceValues(leftOp, left, rightOp, right), S_OK);
  EXPECT_EQ(leftOp, QelPropertyOperatorGreater);
  EXPECT_EQ(rightOp, QelPropertyOperatorLess);
  ASSERT_TRUE(left && right);
  EXPECT_EQ(*left, 0.1);
  EXPECT_EQ(*right, 0.5);
}

TEST_F(QelRovFacetPropertyTolerance, WithoutRangeFlagOrModeIsRefusedAndFilterUntouched) {
  const double low = 2.0;
  range->SetFlags(QelRovFacetProperty::FlagsCheckBox);
  EXPECT_EQ(range->SetToleranceValues(QelPropertyOperatorEqual, &low, QelPropertyOperatorLess, nullptr),
            E_UNEXPECTED);
  range->SetFlags(QelRovFacetProperty::FlagsCheckBoxRange);
  range->SetRangeMode(4);
  EXPECT_EQ(range->SetToleranceValues(QelPropertyOperatorEqual, &low, QelPropertyOperatorLess, nullptr),
            E_UNEXPECTED);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 2);
  QelPropertyOperator leftOp{}, rightOp{};
  double *left = nullptr, *right = nullptr;
  filter->GetToleranceValues(leftOp, left, rightOp, right);
  EXPECT_EQ(left, nullptr);
  EXPECT_TRUE(facet->applied.empty());
}

}  // namespace
