// Property groups: the aggregate state, a click pushed down, the select-all path, the
// radio group chosen by touching a child, and the climb to the facet.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"

namespace {

class QelRovFacetPropertyGroupTest : public ::testing::Test {
 protected:
  QelVar<QelRovFacetPropertyGroup> MakeGroup(QelBaseUnknown* owner, int32_t flags, bool selectAll,
                                             std::initializer_list<QelCheckState> states) {
    auto group = Make<QelRovFacetPropertyGroup>(QelUnicodeString("g"), QelUnicodeString(), owner, selectAll);
    group->SetFlags(flags);
    for (QelCheckState state : states) {
      auto child = Make<TestProperty>(std::to_string(children.size() + 1).c_str(), group.get(), &log);
      child->SetCheckState(state);
      child->display = state;
      group->AddProperty(child.get());
      children.push_back(child);
    }
    return group;
  }
  ApplyLog log;
  std::vector<QelVar<TestProperty>> children;
  QelVar<RecordingObserver> owner = Make<RecordingObserver>();
};

TEST_F(QelRovFacetPropertyGroupTest, MixedChildrenMakeAPartialGroupThatEitherClickResolves) {
  for (bool click : {true, false}) {
    children.clear();
    log.clear();
    auto group = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Checked, Unchecked});
    EXPECT_EQ(group->UpdateCheckStateFromChildren(), S_OK);
    EXPECT_EQ(group->GetCheckState(), PartiallyChecked);
    EXPECT_EQ(group->SetCheck(click), S_OK);
    const QelCheckState want = click ? Checked : Unchecked;
    EXPECT_EQ(group->GetCheckState(), want);
    EXPECT_EQ(children[0]->GetCheckState(), want);
    EXPECT_EQ(children[1]->GetCheckState(), want);
    const char* sign = click ? "+" : "-";
    EXPECT_EQ(log, (ApplyLog{std::string("2") + sign, std::string("1") + sign}));  // last to first
  }
}

TEST_F(QelRovFacetPropertyGroupTest, PartialGroupReappliesChildrensOwnStates) {
  auto group = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Checked, Unchecked});
  group->SetCheckState(PartiallyChecked);
  EXPECT_EQ(group->ApplyCheckState(), S_OK);
  EXPECT_EQ(log, (ApplyLog{"2-", "1+"}));
}

TEST_F(QelRovFacetPropertyGroupTest, ChildClickClimbsThroughNestedGroupsToTheOwner) {
  auto outer = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Unchecked});
  auto inner = Make<QelRovFacetPropertyGroup>(QelUnicodeString("inner"), QelUnicodeString(), outer.get(), false);
  auto leaf = Make<TestProperty>("leaf", inner.get(), &log);
  inner->AddProperty(leaf.get());
  outer->AddProperty(inner.get());
  EXPECT_EQ(leaf->SetCheck(true), S_OK);
  EXPECT_EQ(inner->GetCheckState(), Checked);
  EXPECT_EQ(outer->GetCheckState(), PartiallyChecked);
  ASSERT_EQ(owner->changed.size(), 1u);
  EXPECT_TRUE(outer->IsEqual(owner->changed[0]));
}

TEST_F(QelRovFacetPropertyGroupTest, SelectAllGivesEveryChildItsStateAndChoosesTheGroup) {
  auto group = MakeGroup(owner.get(), QelRovFacetProperty::FlagsRadio, true, {Checked, Unchecked, Unchecked});
  QelRovFacetPropertyItem* all = group->GetSelectAllItem();
  ASSERT_NE(all, nullptr);
  QelUnicodeString label;
  all->GetName(label);
  EXPECT_EQ(label, QelUnicodeString("Select all"));
  EXPECT_EQ(group->UpdateSelectAllState(), S_OK);
  EXPECT_EQ(all->GetCheckState(), PartiallyChecked);
  EXPECT_EQ(all->SetCheck(true), S_OK);
  EXPECT_EQ(group->GetCheckState(), Checked);
  EXPECT_EQ(all->GetCheckState(), Checked);
  EXPECT_EQ(log, (ApplyLog{"3+", "2+", "1+"}));
  ASSERT_EQ(owner->changed.size(), 1u);
  EXPECT_TRUE(group->IsEqual(owner->changed[0]));
}

TEST_F(QelRovFacetPropertyGroupTest, TouchingAChildOfAnUnchosenRadioGroupChoosesIt) {
  auto facetGroup = Make<RecordingObserver>();
  auto facet = Make<TestFacet>(facetGroup.get());
  auto other = Make<TestProperty>("other", facet.get());
  other->SetFlags(QelRovFacetProperty::FlagsRadio);
  other->SetCheckState(Checked);
  facet->Add(other.get());
  auto group = MakeGroup(facet.get(), QelRovFacetProperty::FlagsRadio, false, {Checked, Unchecked});
  facet->Add(group.get());

  EXPECT_EQ(children[1]->SetCheck(true), S_OK);
  // The group's own apply re-applies each child's state before the group is chosen.
  EXPECT_EQ(log, (ApplyLog{"2+", "2+", "1+"}));
  EXPECT_EQ(group->GetCheckState(), Checked);
  EXPECT_EQ(other->GetCheckState(), Unchecked);
  ASSERT_EQ(facet->applied.size(), 1u);
  EXPECT_TRUE(group->IsEqual(facet->applied[0]));
  EXPECT_EQ(facetGroup->changed.size(), 1u);
}

TEST_F(QelRovFacetPropertyGroupTest, ChildrenListSelectAllFirstOnlyWithSeveralAndSkipEmptyOnes) {
  auto two = MakeGroup(owner.get(), QelRovFacetProperty::FlagsRadio, true, {Checked, Checked, Checked});
  children[2]->items = 0;
  QelListValQelBaseUnknown_var list;
  EXPECT_EQ(two->GetChildren(list), S_OK);
  ASSERT_EQ(list.Size(), 3);
  EXPECT_TRUE(list[1]->IsEqual(two->GetSelectAllItem()));
  EXPECT_TRUE(list[3]->IsEqual(children[1].get()));
  EXPECT_EQ(two->CountItems(), 2);

  auto one = MakeGroup(owner.get(), QelRovFacetProperty::FlagsRadio, true, {Checked});
  QelListValQelBaseUnknown_var single;
  EXPECT_EQ(one->GetChildren(single), S_OK);
  ASSERT_EQ(single.Size(), 1);
  EXPECT_TRUE(single[1]->IsEqual(children.back().get()));
}

TEST_F(QelRovFacetPropertyGroupTest, EmptyGroupIsLeftOutOfItsParentsAggregate) {
  auto parent = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Checked});
  auto empty = Make<QelRovFacetPropertyGroup>(QelUnicodeString("e"), QelUnicodeString(), parent.get(), false);
  empty->SetCheckState(Unchecked);
  parent->AddProperty(empty.get());
  EXPECT_EQ(empty->RefreshCheckState(), S_FALSE);
  EXPECT_EQ(parent->RefreshCheckState(), S_OK);
  EXPECT_EQ(parent->GetCheckState(), Checked);
}

TEST_F(QelRovFacetPropertyGroupTest, RefreshReadsEveryChildEvenPastTheFirstDifference) {
  auto group = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Checked, Checked, Checked});
  children[1]->display = Unchecked;
  children[2]->display = Unchecked;
  EXPECT_EQ(group->RefreshCheckState(), S_OK);
  EXPECT_EQ(group->GetCheckState(), PartiallyChecked);
  EXPECT_EQ(children[2]->GetCheckState(), Unchecked);
}

TEST_F(QelRovFacetPropertyGroupTest, AllChildrenLeftOutIsReportedAndKeepsTheState) {
  QelAssertionCapture capture;
  auto group = MakeGroup(owner.get(), QelRovFacetProperty::FlagsCheckBox, false, {Unchecked, Unchecked});
  group->SetCheckState(Checked);
  for (auto& child : children) child->refreshAnswer = S_FALSE;
  EXPECT_EQ(group->RefreshCheckState(), E_UNEXPECTED);
  EXPECT_EQ(group->GetCheckState(), Checked);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);
}

TEST_F(QelRovFacetPropertyGroupTest, RadioGroupRefusesToApplyAPartialState) {
  QelAssertionCapture capture;
  auto radio = MakeGroup(owner.get(), QelRovFacetProperty::FlagsRadio, false, {Checked});
  radio->SetCheckState(PartiallyChecked);
  EXPECT_EQ(radio->ApplyCheckState(), E_UNEXPECTED);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);
  EXPECT_TRUE(log.empty());
  EXPECT_EQ(radio->UpdateSelectAllState(), S_FALSE);  // no select-all item
}

TEST_F(QelRovFacetPropertyGroupTest, TreeBuiltAndDroppedLeavesNoObjectBehind) {
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    auto facet = Make<TestFacet>(owner.get());
    auto top = MakeGroup(facet.get(), QelRovFacetProperty::FlagsRadio, true, {Checked, Unchecked});
    auto nested = Make<QelRovFacetPropertyGroup>(QelUnicodeString("n"), QelUnicodeString(), top.get(), false);
    nested->AddProperty(Make<QelRovFacetPropertyItem>(QelUnicodeString("i"), nested.get()).get());
    top->AddProperty(nested.get());
    facet->Add(top.get());
    top->GetSelectAllItem()->SetCheck(true);  // ties made on the way are gone too
    children.clear();
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}

}  // namespace
