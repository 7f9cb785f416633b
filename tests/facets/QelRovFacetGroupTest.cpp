// The facet group record: root and filter data lookup through a weak reference, the
// light-load-mode subscription, and the refresh of the facets that depend on a change.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelCSO.h"
#include "QelCallbackManager.h"
#include "QelFrmEditor.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelModelBuilder.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"

namespace {

QelVar<QelFrmEditor> EditorOn(QelBaseUnknown* root) { return Make<QelFrmEditor>(root); }

QelBaseUnknown_var AddPart(QelModelBuilder& builder) {
  QelModelProductDesc desc;
  desc.alias = "Part1";
  return builder.AddProduct(builder.Root(), desc);
}

void AddSet(QelModelBuilder& builder, QelBaseUnknown* owner, const char* alias, bool light) {
  QelModelSetDesc desc;
  desc.alias = alias;
  desc.light = light;
  builder.AddSet(QelBaseUnknown_var(owner), desc);
}

TEST(QelRovFacetGroupRecord, RootAndFilterDataComeFromTheLiveGroupOnly) {
  QelAssertionCapture capture;
  QelModelBuilder builder;
  QelBaseUnknown_var root = builder.Finish();
  auto editor = EditorOn(root.get());
  auto group = Make<TestFacetGroup>(editor.get());
  auto filter = Make<QelRovFacetFilterData>();
  group->SetFacets(nullptr, nullptr, nullptr, filter.get());

  QelBaseUnknown_var found;
  QelRovFacetFilterData* data = nullptr;
  EXPECT_EQ(QelRovFacetGroup::GetRootAndFilterData(QelBaseUnknown_WR(group.get()), found, data), S_OK);
  EXPECT_TRUE(found && found->IsEqual(root.get()));
  EXPECT_EQ(data, filter.get());

  auto notGroup = Make<RecordingObserver>();
  EXPECT_EQ(QelRovFacetGroup::GetRootAndFilterData(QelBaseUnknown_WR(notGroup.get()), found, data), E_UNEXPECTED);
  EXPECT_FALSE(found);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 1);

  QelBaseUnknown_WR gone(group.get());
  group = nullptr;
  found = root;
  EXPECT_EQ(QelRovFacetGroup::GetRootAndFilterData(gone, found, data), E_UNEXPECTED);
  EXPECT_FALSE(found);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

TEST(QelRovFacetGroupRecord, SubscribesOnceToEachLightSetOwner) {
  QelModelBuilder builder;
  QelBaseUnknown_var part = AddPart(builder);
  AddSet(builder, part.get(), "Light", true);
  AddSet(builder, part.get(), "Heavy", false);
  QelBaseUnknown_var root = builder.Finish();
  auto editor = EditorOn(root.get());
  auto group = Make<TestFacetGroup>(editor.get());
  const QelCallbackManager& callbacks = QelCallbackManager::Get();

  group->AddLightLoadModeObservers();
  group->AddLightLoadModeObservers();
  ASSERT_EQ(group->GetObservables().Size(), 1);
  EXPECT_EQ(callbacks.CountCallbacks(part.get(), {}, group.get()), 1);
  EXPECT_EQ(callbacks.CountCallbacks(root.get(), {}, group.get()), 0);  // no light set of its own

  group->RemoveLightLoadModeObservers();
  EXPECT_EQ(group->GetObservables().Size(), 0);
  EXPECT_EQ(callbacks.CountCallbacks(part.get(), {}, group.get()), 0);
}

// The group holds its editor weakly: it may outlive it, and its destructor then treats
// the editor as absent. With the editor alive, the destructor takes back its selection
// callbacks.
TEST(QelRovFacetGroupRecord, DestructorRemovesSelectionCallbacksAndSurvivesItsEditor) {
  QelAssertionCapture capture;
  auto editor = EditorOn(nullptr);
  QelCSO* selection = editor->GetCSO();
  auto group = Make<TestFacetGroup>(editor.get());
  const QelCallbackId id = QelCallbackManager::Get().AddCallback(selection, "QelCSOChangeNotification", group.get(),
                                                                [](QelBaseUnknown*, QelBaseUnknown*) {});
  group = nullptr;
  EXPECT_FALSE(QelCallbackManager::Get().RemoveCallback(id)) << "the dead group's callback is still registered";
  EXPECT_EQ(capture.Count(), 0);

  auto orphan = Make<TestFacetGroup>(editor.get());
  editor = nullptr;
  EXPECT_EQ(orphan->GetEditor(), nullptr);
  orphan = nullptr;
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, "QelFrmEditor"), 1);
}

class QelRovFacetGroupDependents : public ::testing::Test {
 protected:
  void SetUp() override {
    group->SetFacets(sets.get(), views.get(), types.get(), filter.get());
    filter->DefaultAnnot = filter->TolAnnot = true;
  }
  QelVar<QelFrmEditor> editor = EditorOn(nullptr);
  QelVar<TestFacetGroup> group = Make<TestFacetGroup>(editor.get());
  QelVar<TestFacet> sets = Make<TestFacet>(group.get());
  QelVar<TestFacet> views = Make<TestFacet>(group.get());
  QelVar<TestFacet> types = Make<TestFacet>(group.get());
  QelVar<QelRovFacetFilterData> filter = Make<QelRovFacetFilterData>();
};

TEST_F(QelRovFacetGroupDependents, ClickInTheSetFacetRefreshesViewsAndTypesThroughTheTie) {
  auto p = Make<TestProperty>("p", sets.get());
  sets->Add(p.get());
  EXPECT_EQ(p->SetCheck(true), S_OK);
  EXPECT_EQ(sets->refreshes, 0);
  EXPECT_EQ(views->refreshes, 1);
  EXPECT_EQ(types->refreshes, 1);
  EXPECT_TRUE(filter->DefaultAnnot);
}

TEST_F(QelRovFacetGroupDependents, ViewChangeClearsTheSwitchesAndRefreshesTypes) {
  EXPECT_EQ(group->OnPropertyChanged(views.get()), S_OK);
  EXPECT_FALSE(filter->DefaultAnnot);
  EXPECT_FALSE(filter->TolAnnot);
  EXPECT_EQ(types->refreshes, 1);
  EXPECT_EQ(group->OnPropertyChanged(types.get()), S_OK);
  EXPECT_EQ(views->refreshes, 1);
}

// A type facet that notes the filter switches it finds when it is refreshed.
class SwitchNotingFacet final : public TestFacet {
 public:
  SwitchNotingFacet(QelBaseUnknown* group, QelRovFacetFilterData* filter) : TestFacet(group), filter_(filter) {}
  void Refresh() override {
    TestFacet::Refresh();
    sawSwitchOn = filter_->DefaultAnnot || filter_->TolAnnot;
  }
  bool sawSwitchOn = true;

 private:
  ~SwitchNotingFacet() override = default;
  QelRovFacetFilterData* filter_;
};

TEST(QelRovFacetGroupDependentsOrder, SwitchesAreOffBeforeTypesRefreshAndForeignChangesAreRefused) {
  QelAssertionCapture capture;
  auto editor = EditorOn(nullptr);
  auto group = Make<TestFacetGroup>(editor.get());
  auto filter = Make<QelRovFacetFilterData>();
  auto sets = Make<TestFacet>(group.get());
  auto views = Make<TestFacet>(group.get());
  auto types = Make<SwitchNotingFacet>(group.get(), filter.get());
  group->SetFacets(sets.get(), views.get(), types.get(), filter.get());
  filter->DefaultAnnot = filter->TolAnnot = true;
  EXPECT_EQ(group->OnPropertyChanged(views.get()), S_OK);
  EXPECT_FALSE(types->sawSwitchOn);

  auto foreign = Make<TestFacet>(group.get());
  EXPECT_EQ(group->OnPropertyChanged(foreign.get()), E_UNEXPECTED);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);
  EXPECT_EQ(views->refreshes + sets->refreshes, 0);
  EXPECT_EQ(types->refreshes, 1);
}

TEST_F(QelRovFacetGroupDependents, LoadModeChangeRebuildsEveryFacetWithoutRefreshingIt) {
  EXPECT_EQ(group->OnLightLoadModeChanged(), S_OK);
  EXPECT_EQ(sets->rebuilds + views->rebuilds + types->rebuilds, 3);
  EXPECT_EQ(sets->refreshes + views->refreshes + types->refreshes, 0);
}

// The real facets over a model, made by the group: the panel order, the sets component's
// mode test leaving out the type facet, and no cycle once group and model are dropped.
TEST(QelRovFacetGroupFacets, InitFacetsMakesTheFacetsOnceAndTheModeTestMayLeaveOutTypes) {
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    QelModelBuilder builder;
    QelBaseUnknown_var part = AddPart(builder);
    AddSet(builder, part.get(), "Light", true);
    QelBaseUnknown_var root = builder.Finish();
    auto editor = EditorOn(root.get());
    auto group = Make<TestFacetGroup>(editor.get());
    QelListValQelBaseUnknown_var facets;
    EXPECT_EQ(group->ListFacets(facets), S_OK);
    ASSERT_EQ(facets.Size(), 3);
    EXPECT_STREQ(facets[1]->GetMetaObject()->Name(), "QelRovFacetAnnotationSet");
    EXPECT_STREQ(facets[2]->GetMetaObject()->Name(), "QelRovFacetView");
    EXPECT_STREQ(facets[3]->GetMetaObject()->Name(), "QelRovFacetAnnotation");
    group->GetFilterData()->DefaultAnnot = true;
    EXPECT_EQ(group->InitFacets(), S_OK);
    EXPECT_FALSE(group->GetFilterData()->DefaultAnnot);
    QelListValQelBaseUnknown_var again;
    group->ListFacets(again);
    EXPECT_TRUE(again[1]->IsEqual(facets[1].get()));
    group->AddLightLoadModeObservers();
    EXPECT_EQ(QelModelBuilder::SwitchLightLoadMode(part, true), S_OK);

    QelRovFacetServices::SetLumSetModes(true, false, false);
    auto reviewOnly = Make<TestFacetGroup>(editor.get());
    QelListValQelBaseUnknown_var two;
    reviewOnly->ListFacets(two);
    QelRovFacetServices::SetLumSetModes(false, false, false);
    EXPECT_EQ(two.Size(), 2);
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}

TEST(QelRovFacetGroupLifetime, GroupWithFacetsAndItemsDroppedLeavesNothingAlive) {
  auto editor = EditorOn(nullptr);
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    auto group = Make<TestFacetGroup>(editor.get());
    auto facet = Make<TestFacet>(group.get());
    auto filter = Make<QelRovFacetFilterData>();
    group->SetFacets(facet.get(), facet.get(), nullptr, filter.get());
    auto p = Make<TestProperty>("p", facet.get());
    facet->Add(p.get());
    p->SetCheck(true);
    QelVar<QelILumLightLoadModeObserver> observer(static_cast<QelBaseUnknown*>(group.get()));
    EXPECT_TRUE(observer);
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}

}  // namespace
