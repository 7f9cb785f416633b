// Listing and display through the facet services, the numbered components, the light-load
// mode notification, and that a dropped model leaves nothing alive.
#include <gtest/gtest.h>

#include "QelAnnotationComponents.h"
#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelFrmEditor.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelIPLMNavRepInstance.h"
#include "QelITPSLight.h"
#include "QelITPSLightSet.h"
#include "QelModelBuilder.h"
#include "QelRovFacetServices.h"

namespace {
// Two parts, one light set per part (the first stored in its rep reference), one root set.
struct Assembly {
  QelModelBuilder b;
  QelBaseUnknown_var part1 = b.AddProduct(b.Root(), {.alias = "Part1", .lightLoadMode = true});
  QelBaseUnknown_var part2 = b.AddProduct(b.Root(), {.alias = "Part2"});
  QelBaseUnknown_var rep1 = b.AddRepInstance(part1, {.alias = "Inst1", .referenceAlias = "Ref1"});
  QelBaseUnknown_var set1 = b.AddSet(part1, {.alias = "Set.1", .light = true, .rep = rep1.get()});
  QelBaseUnknown_var set2 = b.AddSet(part2, {.alias = "Set.2", .rootScope = QelRootSetScope::ARM});
  QelBaseUnknown_var rootSet = b.AddSet(b.Root(), {.alias = "Set.R", .rootScope = QelRootSetScope::Direct});
  QelBaseUnknown_var a1 = b.AddAnnotation(set1, {.alias = "A1", .typeCode = 3});
  QelBaseUnknown_var a2 = b.AddAnnotation(set2, {.alias = "A2", .typeCode = 6});
  QelBaseUnknown_var a3 = b.AddAnnotation(rootSet, {.alias = "A3", .typeCode = 9});
  QelBaseUnknown_var v1 = b.AddView(set1, {.alias = "V1", .elements = {a1.get()}});
  QelBaseUnknown_var c1 = b.AddCapture(set1, {.alias = "C1", .view = v1.get()});
  QelBaseUnknown_var v2 = b.AddView(set2, {.alias = "V2"});
  QelBaseUnknown_var root = b.Root();
};

std::vector<std::string> Aliases(const QelListValQelBaseUnknown_var& list) {
  std::vector<std::string> out;
  for (const auto& o : list) {
    QelUnicodeString alias;
    if (QelVar<QelIAlias> named{o.get()}) named->GetAlias(alias);
    out.push_back(alias.Utf8());
  }
  return out;
}

using Names = std::vector<std::string>;

class CountingObserver : public QelILumLightLoadModeObserver {
 public:
  HRESULT OnLightLoadModeChanged() override {
    ++calls;
    if (removeFrom) removeFrom->RemoveObserver(this);
    return S_OK;
  }
  int calls = 0;
  QelILumLightLoadModeObservable* removeFrom = nullptr;

 protected:
  ~CountingObserver() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<QelILumLightLoadModeObserver>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }
};
}  // namespace

TEST(QelFacetServicesTest, ListingFlagsSelectTheDocumentedSets) {
  Assembly m;
  QelListValQelBaseUnknown_var list;
  QelRovFacetServices::ListAllSets(m.root.get(), list, true);
  EXPECT_EQ(Aliases(list), (Names{"Set.1", "Set.2", "Set.R"}));
  list.RemoveAll();
  QelRovFacetServices::ListARMOrDirectSets(m.root.get(), list, false);
  EXPECT_EQ(Aliases(list), (Names{"Set.2", "Set.R"}));
  list.RemoveAll();
  QelRovFacetServices::ListDirectSets(m.root.get(), list, true);
  EXPECT_EQ(Aliases(list), (Names{"Set.R"}));
  list.RemoveAll();
  QelRovFacetServices::ListDirectSets(m.part1.get(), list, false);
  EXPECT_TRUE(Aliases(list).empty());  // its set lives in the rep reference
  QelRovFacetServices::ListDirectSets(m.part1.get(), list, true);
  EXPECT_EQ(Aliases(list), (Names{"Set.1"}));
  list.RemoveAll();
  QelVar<QelIPLMNavRepInstance> rep(m.rep1.get());
  QelRovFacetServices::ListDirectSets(rep->GetReferencedObject().get(), list, true);
  EXPECT_EQ(Aliases(list), (Names{"Set.1"}));
}

TEST(QelFacetServicesTest, HidingSetsRemovesTheirContentsFromTheVisibleListings) {
  Assembly m;
  QelListValQelBaseUnknown_var list;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(m.root.get(), list);
  EXPECT_EQ(Aliases(list), (Names{"A1", "A2", "A3"}));
  QelRovFacetServices::EnableDisableDisplay(m.set1.get(), 0, nullptr);
  QelListValQelBaseUnknown_var sets;
  sets.Append(m.rootSet);
  QelRovFacetServices::EnableDisableDisplay(sets, 0, nullptr);
  list.RemoveAll();
  QelRovFacetServices::ListAnnotationsOfVisibleSets(m.root.get(), list);
  EXPECT_EQ(Aliases(list), (Names{"A2"}));
  list.RemoveAll();
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(m.root.get(), list);
  EXPECT_EQ(Aliases(list), (Names{"V2"}));
  QelRovFacetServices::EnableDisableDisplay(m.set1.get(), 1, nullptr);
  list.RemoveAll();
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(m.root.get(), list);
  EXPECT_EQ(Aliases(list), (Names{"V1", "C1", "V2"}));
}

TEST(QelFacetServicesTest, DisplayOfForeignObjectsIsRefused) {
  EXPECT_EQ(QelRovFacetServices::IsDisplayEnabled(nullptr), E_FAIL);
  EXPECT_EQ(QelRovFacetServices::EnableDisableDisplay(static_cast<QelBaseUnknown*>(nullptr), 1, nullptr), E_FAIL);
  QelListValQelBaseUnknown_var empty;
  EXPECT_EQ(QelRovFacetServices::ListAllSets(nullptr, empty, false), E_FAIL);
}

TEST(QelFacetServicesTest, RootComesFromTheEditor) {
  Assembly m;
  auto editor = QelMakeVar<QelFrmEditor>(m.root.get());
  QelBaseUnknown_var root;
  EXPECT_EQ(QelRovFacetServices::GetRootPLMObject(editor.get(), root), S_OK);
  EXPECT_TRUE(root->IsEqual(m.root.get()));
  EXPECT_EQ(QelRovFacetServices::GetRootPLMObject(nullptr, root), E_FAIL);
  EXPECT_FALSE(root);
}

TEST(QelFacetServicesTest, SetComponentGivesOwnersKindsRepInstancesAndModes) {
  Assembly m;
  QelBaseUnknown_var made;
  ASSERT_EQ(QelLumInstantiateComponentBase(62, made), S_OK);
  QelVar<QelILumSetComponent> sets(made.get());
  ASSERT_TRUE(sets);
  QelBaseUnknown_var owner;
  EXPECT_EQ(sets->GetSetOwner(m.set1.get(), owner), S_OK);
  EXPECT_TRUE(owner->IsEqual(m.part1.get()));
  QelListValQelBaseUnknown_var reps;
  sets->ListRepInstances(owner.get(), reps);
  EXPECT_EQ(Aliases(reps), (Names{"Inst1"}));
  bool on = true;
  sets->IsLightReviewMode(on);
  EXPECT_FALSE(on);
  QelRovFacetServices::SetLumSetModes(true, false, false);
  sets->IsLightReviewMode(on);
  EXPECT_TRUE(on);
  QelRovFacetServices::SetLumSetModes(false, false, false);
  EXPECT_EQ(QelLumInstantiateComponentBase(61, made), E_FAIL);
  EXPECT_FALSE(made);
}

TEST(QelFacetServicesTest, LightSetsAndTheirViewsAndCapturesAnswerAsLight) {
  Assembly m;
  EXPECT_TRUE(QelVar<QelITPSLightSet>(m.set1.get()));
  EXPECT_FALSE(QelVar<QelITPSLightSet>(m.set2.get()));
  EXPECT_STREQ(m.v1->GetLateType(), "QelTPSLightView");
  EXPECT_STREQ(m.c1->GetLateType(), "QelTPSLightCapture");
  EXPECT_STREQ(m.root->GetLateType(), "SorOccurrence");
  EXPECT_TRUE(QelVar<QelITPSLight>(m.c1.get()));
  EXPECT_FALSE(QelVar<QelITPSLight>(m.v2.get()));
}

TEST(QelLightLoadModeTest, ObserverIsToldUntilRemoved) {
  Assembly m;
  QelVar<QelILumLightLoadModeObservable> owner(m.part1.get());
  ASSERT_TRUE(owner);
  auto observer = QelMakeVar<CountingObserver>();
  owner->AddObserver(observer.get());
  owner->AddObserver(observer.get());  // once only
  EXPECT_EQ(QelModelBuilder::SwitchLightLoadMode(m.part1, false), S_OK);
  EXPECT_EQ(observer->calls, 1);
  EXPECT_EQ(QelModelBuilder::SwitchLightLoadMode(m.part1, false), S_FALSE);  // no change, no call
  EXPECT_EQ(observer->calls, 1);
  owner->RemoveObserver(observer.get());
  QelModelBuilder::SwitchLightLoadMode(m.part1, true);
  EXPECT_EQ(observer->calls, 1);
}

TEST(QelLightLoadModeTest, ObserverRemovingItselfDuringNotificationIsNotCalledAgain) {
  Assembly m;
  QelVar<QelILumLightLoadModeObservable> owner(m.part1.get());
  auto first = QelMakeVar<CountingObserver>();
  auto second = QelMakeVar<CountingObserver>();
  first->removeFrom = owner.get();
  owner->AddObserver(first.get());
  owner->AddObserver(second.get());
  QelModelBuilder::SwitchLightLoadMode(m.part1, false);
  QelModelBuilder::SwitchLightLoadMode(m.part1, true);
  EXPECT_EQ(first->calls, 1);
  EXPECT_EQ(second->calls, 2);
}

TEST(QelLightLoadModeTest, ObserverGoneWithoutRemovalIsSkippedAndNotKeptAlive) {
  Assembly m;
  QelVar<QelILumLightLoadModeObservable> owner(m.part1.get());
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    auto observer = QelMakeVar<CountingObserver>();
    owner->AddObserver(observer.get());
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
  EXPECT_EQ(QelModelBuilder::SwitchLightLoadMode(m.part1, false), S_OK);
}

TEST(QelModelLifetimeTest, DroppedModelLeavesNoObjectAlive) {
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    Assembly m;
    QelListValQelBaseUnknown_var list;
    QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(m.root.get(), list);
    QelBaseUnknown_var component;
    QelLumInstantiateComponentBase(59, component);
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}

TEST(QelModelLifetimeTest, HandleOutlivingItsModelAnswersDetached) {
  QelBaseUnknown_var annotation;
  {
    Assembly m;
    annotation = m.a1;
  }
  QelListValQelBaseUnknown_var list;
  EXPECT_EQ(QelRovFacetServices::ListAllSets(annotation.get(), list, false), E_FAIL);
  EXPECT_EQ(QelRovFacetServices::IsDisplayEnabled(annotation.get()), S_OK);
}

TEST(QelModelBuilderTest, RefusesObjectsOfAnotherModelOrKind) {
  Assembly m;
  QelModelBuilder other;
  QelAssertionCapture capture;
  EXPECT_FALSE(other.AddAnnotation(m.set1, {.alias = "X"}));
  EXPECT_FALSE(m.b.AddSet(m.set1, {.alias = "X"}));
  EXPECT_FALSE(m.b.AddCapture(m.set2, {.alias = "X", .view = m.v1.get()}));
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 3);
}
