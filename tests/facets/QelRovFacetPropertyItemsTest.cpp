// The four property items over a model made in code: labels, icons, initial states read
// from the display, and the display requests of ApplyCheckState.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelModelBuilder.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetPropertyItemAnnotSet.h"
#include "QelRovFacetPropertyItemCustomAnnot.h"
#include "QelRovFacetPropertyItemTypeAnnot.h"
#include "QelRovFacetPropertyItemViewCapture.h"
#include "QelRovFacetServices.h"

namespace {

// A host object with a display name and nothing else (no icon, no display state).
class AliasOnly : public QelIAlias {
 public:
  explicit AliasOnly(const char* alias) : alias_(alias) {}
  HRESULT GetAlias(QelUnicodeString& alias) override {
    alias = alias_;
    return S_OK;
  }

 protected:
  ~AliasOnly() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<QelIAlias>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }

 private:
  QelUnicodeString alias_;
};

QelUnicodeString NameOf(QelRovFacetProperty* p) {
  QelUnicodeString name;
  p->GetName(name);
  return name;
}

QelUnicodeString IconOf(QelRovFacetProperty* p) {
  QelUnicodeString icon;
  p->GetIconName(icon);
  return icon;
}

bool Shown(QelBaseUnknown* object) { return QelRovFacetServices::IsDisplayEnabled(object) == S_OK; }

class QelRovFacetPropertyItems : public ::testing::Test {
 protected:
  void SetUp() override {
    QelModelProductDesc part;
    part.alias = "Part1";
    part.icon = "I_Part";
    owner = builder.AddProduct(builder.Root(), part);
    QelModelSetDesc setDesc;
    setDesc.alias = "Set.1";
    set = builder.AddSet(owner, setDesc);
    QelModelAnnotationDesc desc;
    desc.alias = "Datum.1";
    desc.navigationNames = {"A", "B"};
    desc.icon = "I_Datum";
    desc.typeName = "Datum";
    datum = builder.AddAnnotation(set, desc);
    desc.navigationNames.clear();
    desc.typeName = "Tol";
    desc.shown = false;
    for (const char* alias : {"T1", "T2", "T3"}) {
      desc.alias = alias;
      tols.push_back(builder.AddAnnotation(set, desc));
    }
    QelModelViewDesc viewDesc;
    viewDesc.alias = "View.1";
    viewDesc.icon = "I_View";
    viewDesc.shown = false;
    view = builder.AddView(set, viewDesc);
    root = builder.Finish();
  }
  QelModelBuilder builder;
  QelBaseUnknown_var root, owner, set, datum, view;
  std::vector<QelBaseUnknown_var> tols;
  QelVar<RecordingObserver> group = Make<RecordingObserver>();
  QelVar<QelRovFacetFilterData> filter = Make<QelRovFacetFilterData>();
};

TEST_F(QelRovFacetPropertyItems, SetItemLabelJoinsReferencesOwnerAndSet) {
  QelAssertionCapture capture;
  QelListValQelBaseUnknown_var none;
  auto plain = Make<QelRovFacetPropertyItemAnnotSet>(set.get(), owner.get(), none, group.get());
  EXPECT_EQ(NameOf(plain.get()), QelUnicodeString("Part1/Set.1"));
  EXPECT_EQ(IconOf(plain.get()), QelUnicodeString("normal\\I_Part"));
  EXPECT_EQ(plain->GetCheckState(), Checked);

  auto refA = Make<AliasOnly>("RefA");
  auto refB = Make<AliasOnly>("RefB");
  QelListValQelBaseUnknown_var refs;
  for (QelBaseUnknown* ref : {refA.get(), refB.get(), refA.get()}) refs.Append(ref);
  auto two = Make<QelRovFacetPropertyItemAnnotSet>(set.get(), owner.get(), refs, group.get());
  EXPECT_EQ(NameOf(two.get()), QelUnicodeString("RefA, RefB/Part1/Set.1"));  // duplicate dropped
  EXPECT_TRUE(IconOf(two.get()).IsEmpty());  // the first reference gives no icon
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

TEST_F(QelRovFacetPropertyItems, ViewItemLabelDropsAMissingOwnerWithItsSlash) {
  auto noAlias = Make<RecordingObserver>();
  auto item = Make<QelRovFacetPropertyItemViewCapture>(view.get(), noAlias.get(), set.get(), group.get());
  EXPECT_EQ(NameOf(item.get()), QelUnicodeString("View.1/Set.1"));
  EXPECT_EQ(IconOf(item.get()), QelUnicodeString("normal\\I_View"));
  EXPECT_EQ(item->GetCheckState(), Unchecked);
  item->SetCheckState(Checked);
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_TRUE(Shown(view.get()));
}

TEST_F(QelRovFacetPropertyItems, AnnotationItemPrefersItsFirstNavigationName) {
  auto item = Make<QelRovFacetPropertyItemCustomAnnot>(datum.get(), filter.get(), group.get());
  EXPECT_EQ(NameOf(item.get()), QelUnicodeString("A"));
  EXPECT_EQ(IconOf(item.get()), QelUnicodeString("normal\\I_Datum"));
  EXPECT_EQ(item->GetCheckState(), Checked);
  item->SetCheckState(Unchecked);
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_FALSE(Shown(datum.get()));
}

TEST_F(QelRovFacetPropertyItems, TypeItemStartsUncheckedHasNoIconAndAppliesLastToFirst) {
  QelModelBuilder::SetShown(tols[1], true);
  auto item = Make<QelRovFacetPropertyItemTypeAnnot>(QelUnicodeString("Tol"), filter.get(), group.get());
  EXPECT_EQ(item->GetCheckState(), Unchecked);  // whatever the display shows
  QelUnicodeString icon("x");
  EXPECT_EQ(item->GetIconName(icon), E_NOTIMPL);
  EXPECT_TRUE(icon.IsEmpty());
  for (auto& tol : tols) item->AddAnnotation(tol.get());
  EXPECT_EQ(item->CountItems(), 3);

  std::vector<std::string> changed;
  QelRovFacetServices::AddDisplayChangeCallback(root.get(), group.get(), [&](QelBaseUnknown*, QelBaseUnknown* object) {
    QelUnicodeString alias;
    QelVar<QelIAlias>(object)->GetAlias(alias);
    changed.push_back(alias.Utf8());
  });
  item->SetCheckState(Checked);
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_EQ(changed, (std::vector<std::string>{"T3", "T1"}));  // T2 was shown already
  changed.clear();
  item->SetCheckState(Unchecked);
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_EQ(changed, (std::vector<std::string>{"T3", "T2", "T1"}));
  QelModelBuilder::SetShown(tols[0], true);
  EXPECT_EQ(item->RefreshCheckState(), S_OK);  // no object: state stays
  EXPECT_EQ(item->GetCheckState(), Unchecked);
}

// The filter data reaches the display request: with the default-annotation switch on, a
// checked annotation that is not a default one stays hidden.
TEST_F(QelRovFacetPropertyItems, AnnotationItemAppliesThroughTheFilterData) {
  auto item = Make<QelRovFacetPropertyItemCustomAnnot>(tols[0].get(), filter.get(), group.get());
  filter->DefaultAnnot = true;
  item->SetCheckState(Checked);
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_FALSE(Shown(tols[0].get()));
  filter->DefaultAnnot = false;
  EXPECT_EQ(item->ApplyCheckState(), S_OK);
  EXPECT_TRUE(Shown(tols[0].get()));
}

// An object the display layer does not know (no model) answers E_FAIL; that is no check
// state, so the item keeps the one it had instead of storing a negative state.
TEST_F(QelRovFacetPropertyItems, ObjectOfNoModelLeavesTheStateAsItWas) {
  QelAssertionCapture capture;
  auto stranger = Make<AliasOnly>("Stranger");
  auto item = Make<QelRovFacetPropertyItemViewCapture>(stranger.get(), nullptr, nullptr, group.get());
  EXPECT_EQ(item->GetCheckState(), Unchecked);
  item->SetCheckState(Checked);
  EXPECT_EQ(item->RefreshCheckState(), S_OK);
  EXPECT_EQ(item->GetCheckState(), Checked);
  auto annotation = Make<QelRovFacetPropertyItemCustomAnnot>(stranger.get(), filter.get(), group.get());
  EXPECT_EQ(annotation->GetCheckState(), Unchecked);
}

TEST_F(QelRovFacetPropertyItems, ItemWhoseObjectIsGoneKeepsItsStateAndRefusesToApply) {
  QelAssertionCapture capture;
  QelListValQelBaseUnknown_var none;
  auto item = Make<QelRovFacetPropertyItemAnnotSet>(set.get(), owner.get(), none, group.get());
  capture.Clear();
  root = owner = set = datum = view = nullptr;
  tols.clear();
  EXPECT_FALSE(item->GetObject());
  EXPECT_EQ(item->RefreshCheckState(), S_OK);
  EXPECT_EQ(item->GetCheckState(), Checked);
  EXPECT_EQ(item->ApplyCheckState(), E_UNEXPECTED);
  EXPECT_EQ(capture.Count(), 1);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

}  // namespace
