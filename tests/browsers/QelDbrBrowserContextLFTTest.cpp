// The light browser context through the host's review browser: node labels, the items of
// a node view by view, following the UI-active object, item paths, and staying sound when
// it is refilled or dropped while the owners of its sets still change mode.
#include "BrowserFixture.h"
#include "QelCallbackManager.h"
#include "QelDMUValidation.h"
#include "QelIAlias.h"
#include "QelIDbrBrowserContext.h"
#include "QelIDbrBrowserContextFactory.h"
#include "QelListValQelUnicodeString.h"

namespace {
class LightContextTest : public BrowserFixture {
 protected:
  QelVar<QelIDbrBrowserContext> Context() const { return QelVar<QelIDbrBrowserContext>(browser_->GetBrowserContext().get()); }
  std::vector<std::string> NodeNames() const {
    std::vector<std::string> names;
    for (const auto& node : browser_->GetNodes()) names.push_back(node.name.Str());
    return names;
  }
  std::vector<std::string> ItemsOf(const char* node) const {
    QelListValQelBaseUnknown_var items;
    Context()->ListNodeItems(node, items);
    return Aliases(items);
  }
};
}  // namespace

TEST_F(LightContextTest, NodesAreLabelledSetsAndItemsComeViewByView) {
  auto part = b_.AddProduct(b_.Root(), {.alias = "Part1"});
  b_.AddRepInstance(part, {.alias = "I1", .referenceAlias = "Ref1"});
  b_.AddRepInstance(part, {.alias = "I2", .referenceAlias = "Ref2"});
  auto set = b_.AddSet(part, {.alias = "Set.1", .light = true, .rootScope = QelRootSetScope::ARM});
  auto v3 = b_.AddView(set, {.alias = "V3"});
  auto v1 = b_.AddView(set, {.alias = "V1"});
  // V2 has no capture of its own; its related object lists V3 twice.
  b_.AddView(set, {.alias = "V2", .relatedViews = {v3.get(), v3.get()}});
  b_.AddCapture(set, {.alias = "C1", .view = v1.get()});
  b_.AddCapture(set, {.alias = "C3", .view = v3.get()});
  b_.AddCapture(set, {.alias = "C0"});
  // Same label twice: the node answers with the first set's items.
  auto dup = b_.AddSet(part, {.alias = "Dup", .light = true, .rootScope = QelRootSetScope::ARM});
  b_.AddCapture(dup, {.alias = "First", .view = b_.AddView(dup, {.alias = "W"}).get()});
  b_.AddCapture(b_.AddSet(part, {.alias = "Dup", .light = true, .rootScope = QelRootSetScope::ARM}), {.alias = "Second"});
  // An owner with an empty alias and no instances leaves the set's alias alone.
  b_.AddSet(b_.AddProduct(b_.Root(), {.alias = ""}), {.alias = "Bare", .light = true, .rootScope = QelRootSetScope::ARM});
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);

  EXPECT_EQ(NodeNames(), (std::vector<std::string>{"Ref1, Ref2/Part1/Set.1", "Ref1, Ref2/Part1/Dup",
                                                   "Ref1, Ref2/Part1/Dup", "Bare"}));
  // Views in order: V3 [C3], V1 [C1], V2 -> V3 twice [C3, C3]; then the second list (every
  // capture of the set) adds only the unlinked C0.
  EXPECT_EQ(ItemsOf("Ref1, Ref2/Part1/Set.1"), (std::vector<std::string>{"C3", "C1", "C3", "C3", "C0"}));
  EXPECT_EQ(ItemsOf("Ref1, Ref2/Part1/Dup"), (std::vector<std::string>{"First"}));
  QelListValQelBaseUnknown_var none;
  EXPECT_EQ(Context()->ListNodeItems("Nothing", none), S_FALSE);
  EXPECT_EQ(none.Size(), 0);

  // Only browser type 1 has nodes.
  QelAssertionCapture reports;
  std::vector<QelString> names{"kept"};
  EXPECT_EQ(Context()->ListNodeNames(2, names), static_cast<HRESULT>(E_UNEXPECTED));
  EXPECT_EQ(names.size(), 1u);
  EXPECT_EQ(reports.Count(kQelAssertKindBool), 1);

  // Columns and headers come from the browser's catalog.
  QelListValQelUnicodeString headers;
  auto columns = browser_->GetColumns(headers);
  ASSERT_EQ(columns.size(), 2u);
  EXPECT_EQ(columns[0], QelString("NAME"));
  EXPECT_EQ(columns[1], QelString("ASSOCIATED_FILTER"));
  EXPECT_EQ(headers[1].Utf8(), "Name");
  EXPECT_EQ(headers[2].Utf8(), "Associated View");
}

TEST_F(LightContextTest, FollowsTheUIActiveObject) {
  auto set = b_.AddSet(b_.Root(), {.alias = "S", .light = true, .rootScope = QelRootSetScope::Direct});
  auto annotation = b_.AddAnnotation(set, {.alias = "A", .typeName = "Datum"});
  b_.AddCapture(set, {.alias = "C", .view = b_.AddView(set, {.alias = "V"}).get()});
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);
  auto context = Context();

  // The current occurrence again: nothing happens.
  QelBaseUnknown_var same = root_;
  EXPECT_EQ(context->ChangeContextObject(same), S_OK);
  EXPECT_EQ(browser_->GetRebuildCount(), 0);
  EXPECT_EQ(browser_->GetNodes().size(), 1u);

  // Neither an occurrence nor a DMU validation: the context empties and says so.
  QelBaseUnknown_var other = annotation;
  EXPECT_EQ(context->ChangeContextObject(other), S_FALSE);
  EXPECT_EQ(browser_->GetEmptiedCount(), 1);
  EXPECT_TRUE(browser_->GetNodes().empty());
  std::vector<QelString> names;
  context->ListNodeNames(1, names);
  EXPECT_TRUE(names.empty());

  // A DMU validation made UI-active in the editor brings back the editor's root product.
  auto validation = QelMakeVar<QelDMUValidation>();
  auto path = QelMakeVar<QelPathElement>();
  path->AddChildElement(validation.get());
  editor_->SetUIActivePath(path.get());
  EXPECT_EQ(browser_->GetRebuildCount(), 1);
  ASSERT_EQ(browser_->GetNodes().size(), 1u);
  EXPECT_EQ(browser_->GetNodes()[0].items.Size(), 1);
  // Already on that root: nothing more.
  QelBaseUnknown_var again = validation;
  EXPECT_EQ(context->ChangeContextObject(again), S_FALSE);
  EXPECT_EQ(browser_->GetRebuildCount(), 1);
}

TEST_F(LightContextTest, ItemPathGoesThroughTheRepresentationHoldingTheSet) {
  auto part = b_.AddProduct(b_.Root(), {.alias = "Part"});
  auto rep = b_.AddRepInstance(part, {.alias = "Inst", .referenceAlias = "Ref"});
  auto set = b_.AddSet(part, {.alias = "S", .light = true, .rootScope = QelRootSetScope::ARM, .rep = rep.get()});
  QelBaseUnknown_var capture = b_.AddCapture(set, {.alias = "C"});
  // A set of kind 2 one level below the UI-active product is found among its children.
  auto child = b_.AddProduct(part, {.alias = "Child"});
  auto childRep = b_.AddRepInstance(child, {.alias = "CInst", .referenceAlias = "CRef"});
  auto deep = b_.AddSet(child, {.alias = "D", .kind = 2, .light = true, .rootScope = QelRootSetScope::ARM, .rep = childRep.get()});
  QelBaseUnknown_var deepView = b_.AddView(deep, {.alias = "DV"});
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);
  auto active = RootPath();
  active->AddChildElement(part.get());
  editor_->SetUIActivePath(active.get());

  auto path = QelVar<QelPathElement>::Adopt(Context()->GetItemPath(capture));
  ASSERT_TRUE(path);
  ASSERT_EQ(path->GetSize(), 4);
  EXPECT_TRUE((*path)[2]->IsEqual(rep.get()));
  EXPECT_TRUE(path->GetLeaf()->IsEqual(set.get()));
  auto deepPath = QelVar<QelPathElement>::Adopt(Context()->GetItemPath(deepView));
  ASSERT_TRUE(deepPath);
  EXPECT_TRUE((*deepPath)[2]->IsEqual(childRep.get()));
  EXPECT_TRUE(deepPath->GetLeaf()->IsEqual(deep.get()));
}

// Followed to the letter, a refill leaves the context observing the owners it listed
// before, and a context dropped without ResetContents stays registered with them.
TEST_F(LightContextTest, ContextStaysSoundAcrossRefillsAndAnUnresetRelease) {
  auto part = b_.AddProduct(b_.Root(), {.alias = "Part"});
  b_.AddSet(part, {.alias = "S", .light = true, .rootScope = QelRootSetScope::ARM});
  ShowModel();
  QelModelBuilder second({.alias = "Other"});
  auto otherPart = second.AddProduct(second.Root(), {.alias = "OtherPart"});
  second.AddSet(otherPart, {.alias = "T", .light = true, .rootScope = QelRootSetScope::ARM});
  const size_t entriesBefore = QelCallbackManager::Get().StoredEntries();

  ASSERT_EQ(OpenBrowser(), S_OK);
  auto context = Context();
  context->InitContents(nullptr);
  context->InitContents(nullptr);
  EXPECT_EQ(QelModelBuilder::SwitchLightLoadMode(part, true), S_OK);
  EXPECT_EQ(browser_->GetRebuildCount(), 1) << "observing twice rebuilds twice";

  // Another product: the owners of the first one are no longer followed.
  QelBaseUnknown_var otherRoot = second.Root();
  EXPECT_EQ(context->ChangeContextObject(otherRoot), S_OK);
  EXPECT_EQ(browser_->GetRebuildCount(), 2);
  QelModelBuilder::SwitchLightLoadMode(part, false);
  EXPECT_EQ(browser_->GetRebuildCount(), 2) << "a stale owner still reaches the context";
  QelModelBuilder::SwitchLightLoadMode(otherPart, true);
  EXPECT_EQ(browser_->GetRebuildCount(), 3);

  // Dropped without ResetContents (the old browser drops its context that way too): the
  // context withdraws as it goes, leaving no registration behind.
  context = nullptr;
  browser_ = QelMakeVar<QelDbrBrowser>(1, RootPath().get(), nullptr);
  {
    QelVar<QelIDbrBrowserContextFactory> factory{root_.get()};
    int type = 1;
    QelBaseUnknown_var self(static_cast<QelIDbrBrowser*>(browser_.get()));
    QelVar<QelIDbrBrowserContext> dropped{factory->GetBrowserContext(type, self).get()};
    ASSERT_TRUE(dropped);
    dropped->InitContents(nullptr);
  }
  EXPECT_EQ(QelCallbackManager::Get().StoredEntries(), entriesBefore);
  QelModelBuilder::SwitchLightLoadMode(part, true);
  EXPECT_EQ(browser_->GetRebuildCount(), 0);
  root_ = nullptr;
}

// A product made UI-active before the browser opens: the browser lists that product's own
// sets at once, not the root's.
TEST_F(LightContextTest, ABrowserOpenedWhileAProductIsUIActiveListsThatProductsSets) {
  auto part = b_.AddProduct(b_.Root(), {.alias = "Part"});
  b_.AddCapture(b_.AddSet(part, {.alias = "Own", .light = true}), {.alias = "C"});
  b_.AddSet(b_.Root(), {.alias = "RootSet", .light = true, .rootScope = QelRootSetScope::Direct});
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);
  EXPECT_EQ(NodeNames(), (std::vector<std::string>{"Root/RootSet"}));
  browser_->Close();
  auto path = RootPath();
  path->AddChildElement(part.get());
  editor_->SetUIActivePath(path.get());
  ASSERT_EQ(OpenBrowser(), S_OK);
  EXPECT_EQ(NodeNames(), (std::vector<std::string>{"Part/Own"}));
  EXPECT_EQ(ItemsOf("Part/Own"), (std::vector<std::string>{"C"}));
}
