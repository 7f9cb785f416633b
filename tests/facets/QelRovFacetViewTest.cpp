// The view facet: captures before views, the choice of all of them, what a later refresh
// leaves checked, an object whose set is lost, and an editor without a root.
#include <gtest/gtest.h>

#include "FacetModel.h"
#include "QelAssert.h"
#include "QelModelBuilder.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetView.h"

namespace {

enum { kAll = 1, kCustom };

class ViewFacet : public ::testing::Test {
 protected:
  void SetUp() override {
    QelModelSetDesc setDesc;
    setDesc.alias = "A";
    QelBaseUnknown_var a = builder.AddSet(builder.Root(), setDesc);
    setDesc.alias = "B";
    QelBaseUnknown_var b = builder.AddSet(builder.Root(), setDesc);
    QelModelViewDesc viewDesc;
    viewDesc.alias = "V1";
    v1 = builder.AddView(a, viewDesc);
    viewDesc.alias = "V2";
    viewDesc.shown = false;
    v2 = builder.AddView(b, viewDesc);
    QelModelCaptureDesc captureDesc;
    captureDesc.alias = "C1";
    captureDesc.shown = false;
    c1 = builder.AddCapture(a, captureDesc);
    Start(builder.Finish());
  }
  void Start(const QelBaseUnknown_var& root) {
    model = std::make_unique<FacetModel>(root);
    facet = Make<QelRovFacetView>(model->group.get());
    model->group->SetFacets(model->other.get(), facet.get(), nullptr, model->filter.get());
    facet->Refresh();
  }
  QelRovFacetProperty* At(int position) { return PropertyOf(facet.get(), position); }
  QelRovFacetPropertyGroup* Custom() { return QelSysDynamicCast<QelRovFacetPropertyGroup>(At(kCustom)); }

  QelModelBuilder builder;
  QelBaseUnknown_var v1, v2, c1;
  std::unique_ptr<FacetModel> model;
  QelVar<QelRovFacetView> facet;
};

TEST_F(ViewFacet, CapturesComeFirstThenViewsEachInTheHostsOrder) {
  // The host lists set A's view V1 and capture C1, then set B's view V2.
  EXPECT_EQ(ChildLabels(Custom()), (std::vector<std::string>{"C1/Root/A", "V1/Root/A", "V2/Root/B"}));
  EXPECT_EQ(At(kAll)->GetCheckState(), Unchecked);
  EXPECT_EQ(Custom()->GetCheckState(), Checked);
  EXPECT_EQ(Custom()->GetSelectAllItem()->GetCheckState(), PartiallyChecked);
}

TEST_F(ViewFacet, AllShowsEveryViewAndCaptureAndALaterRefreshChecksNeitherChoice) {
  EXPECT_EQ(At(kAll)->SetCheck(true), S_OK);
  EXPECT_EQ(model->TakeChanges(), (std::vector<std::string>{"+C1", "+V2"}));
  EXPECT_EQ(Custom()->GetCheckState(), Unchecked);
  // The rows keep the states they were built with.
  const auto& rows = Custom()->GetPropertyList();
  EXPECT_EQ(QelSysDynamicCast<QelRovFacetProperty>(rows[1].get())->GetCheckState(), Unchecked);
  EXPECT_EQ(model->other->refreshes, 0);  // the other facet is the set facet here: no refresh

  facet->Refresh();
  EXPECT_EQ(At(kAll)->GetCheckState(), Unchecked);
  EXPECT_EQ(Custom()->GetCheckState(), Unchecked);
  EXPECT_EQ(QelSysDynamicCast<QelRovFacetProperty>(Custom()->GetPropertyList()[1].get())->GetCheckState(), Checked);
}

TEST_F(ViewFacet, AnObjectWhoseSetCannotBeFoundGivesNoItemAndOneAssertion) {
  // C1 stays listed under set A but no longer leads back to it.
  ASSERT_TRUE(QelModelBuilder::DetachFromSet(c1));
  QelAssertionCapture capture;
  facet->Refresh();
  EXPECT_EQ(ChildLabels(Custom()), (std::vector<std::string>{"V1/Root/A", "V2/Root/B"}));
  EXPECT_EQ(capture.Count(), 1);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

TEST_F(ViewFacet, WithoutRootAllAnswersSOkAndChangesNothing) {
  QelAssertionCapture capture;
  Start(QelBaseUnknown_var());
  EXPECT_EQ(Custom()->GetPropertyList().Size(), 0);
  EXPECT_EQ(facet->ApplyPropertyChange(At(kAll)), S_OK);
  EXPECT_TRUE(model->TakeChanges().empty());
  EXPECT_FALSE(Shown(v2));
}

}  // namespace
