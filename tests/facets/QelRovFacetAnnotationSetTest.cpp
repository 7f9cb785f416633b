// The annotation set facet: the confirmed and refused choice of every set, the root's
// sets, no set, the root choice's row, one row per set, and an editor without a root.
#include <gtest/gtest.h>

#include "FacetModel.h"
#include "QelAssert.h"
#include "QelDlgNotify.h"
#include "QelModelBuilder.h"
#include "QelRovFacetAnnotationSet.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetServices.h"

namespace {

enum { kAll = 1, kRoot, kCustom, kNone };

class SetFacet : public ::testing::Test {
 protected:
  void SetUp() override {
    QelModelProductDesc partDesc;
    partDesc.alias = "Part1";
    part = builder.AddProduct(builder.Root(), partDesc);
    s1 = AddSet(builder.Root(), "S1", QelRootSetScope::Direct, true);
    s2 = AddSet(part, "S2", QelRootSetScope::None, true);
    s3 = AddSet(part, "S3", QelRootSetScope::None, false);
    Start(builder.Finish());
  }
  QelBaseUnknown_var AddSet(const QelBaseUnknown_var& owner, const char* alias, QelRootSetScope scope, bool shown) {
    QelModelSetDesc desc;
    desc.alias = alias;
    desc.rootScope = scope;
    desc.shown = shown;
    return builder.AddSet(owner, desc);
  }
  void Start(const QelBaseUnknown_var& root) {
    model = std::make_unique<FacetModel>(root);
    facet = Make<QelRovFacetAnnotationSet>(model->group.get());
    model->group->SetFacets(facet.get(), model->other.get(), nullptr, model->filter.get());
    facet->Refresh();
    model->TakeChanges();
  }
  QelRovFacetProperty* At(int position) { return PropertyOf(facet.get(), position); }
  QelRovFacetPropertyGroup* Custom() { return QelSysDynamicCast<QelRovFacetPropertyGroup>(At(kCustom)); }
  std::vector<QelCheckState> Choices() {
    return {At(kAll)->GetCheckState(), At(kRoot)->GetCheckState(), At(kCustom)->GetCheckState(),
            At(kNone)->GetCheckState()};
  }

  QelModelBuilder builder;
  QelBaseUnknown_var part, s1, s2, s3;
  std::unique_ptr<FacetModel> model;
  QelVar<QelRovFacetAnnotationSet> facet;
};

const std::vector<QelCheckState> kCustomChosen = {Unchecked, Unchecked, Checked, Unchecked};

TEST_F(SetFacet, RefreshChoosesTheFreeChoiceWithOneRowPerSet) {
  EXPECT_EQ(Choices(), kCustomChosen);
  EXPECT_EQ(ChildLabels(Custom()), (std::vector<std::string>{"Root/S1", "Part1/S2", "Part1/S3"}));
  EXPECT_EQ(Custom()->GetSelectAllItem()->GetCheckState(), PartiallyChecked);
  EXPECT_TRUE(At(kRoot)->GetVisibleFlag());
}

TEST_F(SetFacet, AllIsRefusedThenConfirmed) {
  QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerNo);
  EXPECT_EQ(At(kAll)->SetCheck(true), E_FAIL);
  EXPECT_EQ(QelDlgNotify::PendingAnswers(), 0);
  EXPECT_EQ(Choices(), kCustomChosen);
  EXPECT_TRUE(model->TakeChanges().empty());
  EXPECT_EQ(model->other->refreshes, 0);

  QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
  EXPECT_EQ(At(kAll)->SetCheck(true), S_OK);
  EXPECT_EQ(Choices(), (std::vector<QelCheckState>{Checked, Unchecked, Unchecked, Unchecked}));
  EXPECT_EQ(model->TakeChanges(), (std::vector<std::string>{"+S3"}));
  EXPECT_EQ(model->other->refreshes, 1);
  EXPECT_EQ(Custom()->GetPropertyList().Size(), 3);
}

TEST_F(SetFacet, NoAnswerRefusesAndIsReported) {
  const int refusedBefore = QelDlgNotify::RefusedCount();
  std::vector<std::string> reports;
  auto old = QelDlgNotify::SetRefusalReporter([&](const QelUnicodeString& text) { reports.push_back(text.Utf8()); });
  EXPECT_EQ(At(kAll)->SetCheck(true), E_FAIL);
  QelDlgNotify::SetRefusalReporter(old);
  EXPECT_EQ(QelDlgNotify::RefusedCount(), refusedBefore + 1);
  ASSERT_EQ(reports.size(), 1u);
  EXPECT_NE(reports[0].find("Show All Annotation Sets"), std::string::npos);
  EXPECT_EQ(Choices(), kCustomChosen);
  EXPECT_TRUE(model->TakeChanges().empty());
}

TEST_F(SetFacet, RootHidesEverySetThenShowsTheRootsOwn) {
  EXPECT_EQ(At(kRoot)->SetCheck(true), S_OK);
  EXPECT_TRUE(Shown(s1));  // in both lists: hidden, then shown again
  EXPECT_FALSE(Shown(s2));
  EXPECT_FALSE(Shown(s3));
  EXPECT_EQ(model->TakeChanges(), (std::vector<std::string>{"-S1", "-S2", "+S1"}));
  EXPECT_EQ(model->other->refreshes, 1);
}

TEST_F(SetFacet, NoneHidesEverySetAndLeavesTheRowsAlone) {
  EXPECT_EQ(At(kNone)->SetCheck(true), S_OK);
  EXPECT_FALSE(Shown(s1));
  EXPECT_FALSE(Shown(s2));
  const auto& rows = Custom()->GetPropertyList();
  EXPECT_EQ(QelSysDynamicCast<QelRovFacetProperty>(rows[1].get())->GetCheckState(), Checked);
  EXPECT_EQ(QelSysDynamicCast<QelRovFacetProperty>(rows[3].get())->GetCheckState(), Unchecked);
  EXPECT_EQ(Choices(), (std::vector<QelCheckState>{Unchecked, Unchecked, Unchecked, Checked}));
}

TEST_F(SetFacet, RootChoiceHasNoRowWhenTheUIActiveObjectIsNoOccurrence) {
  model->SetUIActive({model->root.get(), s2.get()});
  facet->Refresh();
  EXPECT_FALSE(At(kRoot)->GetVisibleFlag());
  model->SetUIActive({model->root.get()});
  facet->Refresh();
  EXPECT_TRUE(At(kRoot)->GetVisibleFlag());
}

TEST_F(SetFacet, RootChoiceHasNoRowWithoutRootSets) {
  QelModelBuilder other;
  QelModelSetDesc desc;
  desc.alias = "Lone";
  other.AddSet(other.Root(), desc);
  Start(other.Finish());
  EXPECT_FALSE(At(kRoot)->GetVisibleFlag());
  EXPECT_EQ(Custom()->GetPropertyList().Size(), 1);
}

TEST_F(SetFacet, EqualSetEntriesGiveOneRow) {
  Custom()->RemoveAllProperties();
  QelListValQelBaseUnknown_var sets;
  for (auto* set : {s2.get(), s2.get(), s1.get()}) sets.Append(set);
  EXPECT_EQ(facet->BuildSetItems(sets, Custom()), S_OK);
  EXPECT_EQ(ChildLabels(Custom()), (std::vector<std::string>{"Part1/S2", "Root/S1"}));
  EXPECT_EQ(facet->BuildSetItems(sets, Custom()), S_OK);  // rows already there
  EXPECT_EQ(Custom()->GetPropertyList().Size(), 2);
}

TEST_F(SetFacet, WithoutRootEveryChoiceAnswersSFalseButAllIsStillAsked) {
  QelAssertionCapture capture;
  Start(QelBaseUnknown_var());
  EXPECT_EQ(Custom()->GetPropertyList().Size(), 0);
  EXPECT_FALSE(At(kRoot)->GetVisibleFlag());
  QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
  At(kAll)->SetCheck(true);
  EXPECT_EQ(QelDlgNotify::PendingAnswers(), 0);
  for (int position = kAll; position <= kNone; ++position)
    EXPECT_EQ(facet->ApplyPropertyChange(At(position)), S_FALSE);
  EXPECT_EQ(model->other->refreshes, 0);
}

}  // namespace
