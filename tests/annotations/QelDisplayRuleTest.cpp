// The rule by which EnableDisableDisplay applies filter data to annotations
// (docs/display-rule.md): the default switch, each operator pair of the range, no value.
#include <gtest/gtest.h>

#include <optional>

#include "QelModelBuilder.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"

namespace {
struct Model {
  QelModelBuilder builder;
  QelBaseUnknown_var set = builder.AddSet(builder.Root(), {.alias = "Set.1"});
  QelBaseUnknown_var Add(std::optional<double> tolerance, bool isDefault = false) {
    return builder.AddAnnotation(set, {.alias = "A", .typeName = "T", .subTypeName = "S", .typeCode = 5,
                                       .tolerance = tolerance, .isDefault = isDefault});
  }
};

QelVar<QelRovFacetFilterData> NewFilter() { return QelMakeVar<QelRovFacetFilterData>(); }

bool ShownAfterEnable(QelBaseUnknown* annotation, QelRovFacetFilterData* filter) {
  QelModelBuilder::SetShown(QelBaseUnknown_var(annotation), false);
  QelRovFacetServices::EnableDisableDisplay(annotation, 1, filter);
  return QelRovFacetServices::IsDisplayEnabled(annotation) == S_OK;
}
}  // namespace

TEST(QelRovFacetFilterDataTest, CopiesValuesAndSurvivesWritingBackItsOwnPointers) {
  auto filter = NewFilter();
  double low = 0.1, high = 0.5;
  filter->SetToleranceValues(QelPropertyOperatorGreater, &low, QelPropertyOperatorLess, &high);
  low = 99.0;  // the filter holds its own copy
  QelPropertyOperator left, right;
  double *leftValue = nullptr, *rightValue = nullptr;
  filter->GetToleranceValues(left, leftValue, right, rightValue);
  ASSERT_NE(leftValue, nullptr);
  EXPECT_EQ(*leftValue, 0.1);
  filter->SetToleranceValues(right, rightValue, left, leftValue);  // swapped, through its own storage
  filter->GetToleranceValues(left, leftValue, right, rightValue);
  EXPECT_EQ(*leftValue, 0.5);
  EXPECT_EQ(*rightValue, 0.1);
  EXPECT_EQ(left, QelPropertyOperatorLess);
}

TEST(QelDisplayRuleTest, WithoutFilterEnableShowsAndDisableHides) {
  Model m;
  QelBaseUnknown_var a = m.Add(std::nullopt);
  EXPECT_TRUE(ShownAfterEnable(a.get(), nullptr));
  QelRovFacetServices::EnableDisableDisplay(a.get(), 0, nullptr);
  EXPECT_EQ(QelRovFacetServices::IsDisplayEnabled(a.get()), S_FALSE);
}

TEST(QelDisplayRuleTest, DefaultSwitchKeepsOnlyDefaultAnnotations) {
  Model m;
  QelBaseUnknown_var plain = m.Add(0.1), byDefault = m.Add(0.1, true);
  auto filter = NewFilter();
  EXPECT_TRUE(ShownAfterEnable(plain.get(), filter.get()));  // switches off: no refinement
  filter->DefaultAnnot = true;
  EXPECT_FALSE(ShownAfterEnable(plain.get(), filter.get()));
  EXPECT_TRUE(ShownAfterEnable(byDefault.get(), filter.get()));
}

TEST(QelDisplayRuleTest, DisableHidesWhateverTheFilterSays) {
  Model m;
  QelBaseUnknown_var byDefault = m.Add(0.1, true);
  auto filter = NewFilter();
  filter->DefaultAnnot = true;
  QelRovFacetServices::EnableDisableDisplay(byDefault.get(), 0, filter.get());
  EXPECT_EQ(QelRovFacetServices::IsDisplayEnabled(byDefault.get()), S_FALSE);
}

TEST(QelDisplayRuleTest, ToleranceSwitchWithNoValuesKeepsAnnotationsThatHaveATolerance) {
  Model m;
  QelBaseUnknown_var with = m.Add(0.3), without = m.Add(std::nullopt);
  auto filter = NewFilter();
  filter->TolAnnot = true;
  EXPECT_TRUE(ShownAfterEnable(with.get(), filter.get()));
  EXPECT_FALSE(ShownAfterEnable(without.get(), filter.get()));
}

TEST(QelDisplayRuleTest, EveryOperatorPairBoundsTheRange) {
  struct Case {
    QelPropertyOperator left;
    QelPropertyOperator right;
    double value;
    bool shown;
  };
  // Range bounds 0.1 and 0.5; the value's relation to each bound is tested on and off it.
  const Case cases[] = {
      {QelPropertyOperatorGreater, QelPropertyOperatorLess, 0.3, true},
      {QelPropertyOperatorGreater, QelPropertyOperatorLess, 0.1, false},
      {QelPropertyOperatorGreater, QelPropertyOperatorLess, 0.5, false},
      {QelPropertyOperatorGreater, QelPropertyOperatorLessOrEqual, 0.5, true},
      {QelPropertyOperatorGreater, QelPropertyOperatorLessOrEqual, 0.6, false},
      {QelPropertyOperatorGreaterOrEqual, QelPropertyOperatorLess, 0.1, true},
      {QelPropertyOperatorGreaterOrEqual, QelPropertyOperatorLess, 0.09, false},
      {QelPropertyOperatorGreaterOrEqual, QelPropertyOperatorLessOrEqual, 0.5, true},
      {QelPropertyOperatorGreaterOrEqual, QelPropertyOperatorLessOrEqual, 0.1, true},
      // Equal on the left ignores the right bound.
      {QelPropertyOperatorEqual, QelPropertyOperatorLess, 0.1, true},
      {QelPropertyOperatorEqual, QelPropertyOperatorLess, 0.3, false},
  };
  double low = 0.1, high = 0.5;
  for (const Case& c : cases) {
    Model m;
    QelBaseUnknown_var a = m.Add(c.value);
    auto filter = NewFilter();
    filter->TolAnnot = true;
    filter->SetToleranceValues(c.left, &low, c.right, &high);
    EXPECT_EQ(ShownAfterEnable(a.get(), filter.get()), c.shown)
        << "operators " << c.left << "/" << c.right << " value " << c.value;
  }
}

TEST(QelDisplayRuleTest, AMissingBoundDoesNotConstrain) {
  Model m;
  QelBaseUnknown_var small = m.Add(0.01), large = m.Add(100.0);
  auto filter = NewFilter();
  filter->TolAnnot = true;
  double high = 0.5;
  filter->SetToleranceValues(QelPropertyOperatorGreater, nullptr, QelPropertyOperatorLess, &high);
  EXPECT_TRUE(ShownAfterEnable(small.get(), filter.get()));
  EXPECT_FALSE(ShownAfterEnable(large.get(), filter.get()));
  double low = 1.0;
  filter->SetToleranceValues(QelPropertyOperatorGreaterOrEqual, &low, QelPropertyOperatorLess, nullptr);
  EXPECT_FALSE(ShownAfterEnable(small.get(), filter.get()));
  EXPECT_TRUE(ShownAfterEnable(large.get(), filter.get()));
}

TEST(QelDisplayRuleTest, BothSwitchesMustHoldAndFilterLeavesSetsAlone) {
  Model m;
  QelBaseUnknown_var defaultInRange = m.Add(0.2, true), defaultNoTolerance = m.Add(std::nullopt, true);
  auto filter = NewFilter();
  filter->DefaultAnnot = true;
  filter->TolAnnot = true;
  EXPECT_TRUE(ShownAfterEnable(defaultInRange.get(), filter.get()));
  EXPECT_FALSE(ShownAfterEnable(defaultNoTolerance.get(), filter.get()));
  QelModelBuilder::SetShown(m.set, false);
  QelRovFacetServices::EnableDisableDisplay(m.set.get(), 1, filter.get());
  EXPECT_EQ(QelRovFacetServices::IsDisplayEnabled(m.set.get()), S_OK);
}
