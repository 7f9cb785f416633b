// Part placements: where a point of a part lands in its context, read along a path, and
// how model files state placements (and which ones they may not state).
#include <gtest/gtest.h>

#include "QelIAlias.h"
#include "QelIPLMNavOccurrence.h"
#include "QelModelBuilder.h"
#include "QelModelLoader.h"
#include "QelPathElement.h"
#include "QelRovPathElementToolbox.h"
#include "QelUnicodeString.h"

namespace {
// A quarter turn about z: x goes to y, y goes to -x.
const QelMathTransformation kQuarterTurnAt10{{0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 0, 0}};

void ExpectNear(const QelMathVector& actual, const QelMathVector& expected) {
  EXPECT_NEAR(actual.x, expected.x, 1e-12);
  EXPECT_NEAR(actual.y, expected.y, 1e-12);
  EXPECT_NEAR(actual.z, expected.z, 1e-12);
}

QelVar<QelPathElement> PathOf(std::initializer_list<QelBaseUnknown*> elements) {
  auto path = QelMakeVar<QelPathElement>();
  for (QelBaseUnknown* e : elements) path->AddChildElement(e);
  return path;
}

// root -> sub (quarter turn, moved to x=10) -> leaf (moved by x=1), with a rep instance,
// a set and a capture under the leaf.
struct TwoLevelModel {
  QelModelBuilder builder;
  QelBaseUnknown_var root = builder.Root();
  QelBaseUnknown_var sub = builder.AddProduct(root, {.alias = "Sub", .placement = kQuarterTurnAt10});
  QelBaseUnknown_var leaf =
      builder.AddProduct(sub, {.alias = "Leaf", .placement = QelMathTransformation::Translation({1, 0, 0})});
  QelBaseUnknown_var rep = builder.AddRepInstance(leaf, {.alias = "Leaf.1"});
  QelBaseUnknown_var set = builder.AddSet(leaf, {.alias = "Set.1", .rep = rep.get()});
  QelBaseUnknown_var capture = builder.AddCapture(set, {.alias = "Capture.1"});
};

QelMathTransformation PartToContext(QelPathElement* path, HRESULT expected) {
  QelMathTransformation t = QelMathTransformation::Translation({7, 7, 7});  // must be reset
  EXPECT_EQ(QelRovPathElementToolbox::GetMechPartToContextTransfo(path, t), expected);
  return t;
}

// `rootBody` follows the root's identifier inside the root object.
std::string Refusal(const std::string& rootBody) {
  const std::string text =
      R"({"format": "qel-product-model", "version": 1, "root": {"id": "root")" + rootBody + "}}";
  QelBaseUnknown_var root;
  std::string error;
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  EXPECT_EQ(QelModelLoader::LoadText(text, "bad.json", root, error), E_FAIL) << rootBody;
  EXPECT_FALSE(root);
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
  return error;
}

QelMathTransformation PlacementOf(QelBaseUnknown* product) {
  QelMathTransformation placement = QelMathTransformation::Translation({7, 7, 7});
  QelVar<QelIPLMNavOccurrence> occurrence(product);
  EXPECT_TRUE(occurrence);
  if (occurrence) {
    EXPECT_EQ(occurrence->GetPlacement(placement), S_OK);
  }
  return placement;
}
}  // namespace

TEST(QelPartPlacementTest, LeafPointLandsInRootThroughLeafPlacementFirst) {
  TwoLevelModel m;
  auto path = PathOf({m.root.get(), m.sub.get(), m.leaf.get()});
  QelMathTransformation t = PartToContext(path.get(), S_OK);
  // Leaf first: (0,0,0) -> (1,0,0), then the turn and move: (10,1,0). The other order gives (11,0,0).
  ExpectNear(t.Apply({0, 0, 0}), {10, 1, 0});
  ExpectNear(t.ApplyToVector({1, 0, 0}), {0, 1, 0});

  // A context below the root ignores the placements above it, its own included.
  ExpectNear(PartToContext(PathOf({m.sub.get(), m.leaf.get()}).get(), S_OK).Apply({0, 0, 0}), {1, 0, 0});
  EXPECT_TRUE(PartToContext(PathOf({m.sub.get()}).get(), S_OK).IsIdentity());
  EXPECT_TRUE(PartToContext(PathOf({m.root.get()}).get(), S_OK).IsIdentity());
}

TEST(QelPartPlacementTest, ElementsBelowThePartArePassedOver) {
  TwoLevelModel m;
  ASSERT_TRUE(m.capture);
  auto toLeaf = PathOf({m.root.get(), m.sub.get(), m.leaf.get()});
  auto toCapture = PathOf({m.root.get(), m.sub.get(), m.leaf.get(), m.rep.get(), m.set.get(), m.capture.get()});
  EXPECT_EQ(PartToContext(toCapture.get(), S_OK), PartToContext(toLeaf.get(), S_OK));
}

TEST(QelPartPlacementTest, PathWithoutProductFailsAndLeavesIdentity) {
  TwoLevelModel m;
  EXPECT_TRUE(PartToContext(nullptr, E_FAIL).IsIdentity());
  EXPECT_TRUE(PartToContext(PathOf({}).get(), E_FAIL).IsIdentity());
  EXPECT_TRUE(PartToContext(PathOf({m.set.get(), m.capture.get()}).get(), E_FAIL).IsIdentity());
}

TEST(QelPartPlacementTest, ScaledPlacementScalesVectorsAndMovesPoints) {
  QelModelBuilder builder;
  QelBaseUnknown_var root = builder.Root();
  QelBaseUnknown_var part =
      builder.AddProduct(root, {.alias = "Scaled", .placement = {{2, 0, 0}, {0, 2, 0}, {0, 0, 2}, {0, 0, 5}}});
  QelMathTransformation t = PartToContext(PathOf({root.get(), part.get()}).get(), S_OK);
  // A sight vector stays unnormalised here: making it a unit again is the camera's business.
  ExpectNear(t.ApplyToVector({0, 0, 1}), {0, 0, 2});
  ExpectNear(t.Apply({0, 0, 1}), {0, 0, 7});
  ExpectNear(t.Apply({1, 1, 0}), {2, 2, 5});
}

TEST(QelPartPlacementTest, LoadedPlacementsDefaultPerKeyNestAndMayBeSmall) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadText(R"({"format": "qel-product-model", "version": 1, "root": {"id": "r",
      "children": [{"id": "a", "placement": {"origin": [1, 2, 3], "x": [0, 0, 1], "z": [-1, 0, 0]},
                    "children": [{"id": "b", "placement": {"y": [0, 3, 0]}},
                                   {"id": "c", "placement": {"x": [1e-6, 0, 0], "y": [0, 1e-6, 0], "z": [0, 0, 1e-6]}}]}]}})",
                                     "good.json", root, error),
            S_OK)
      << error;
  QelVar<QelIPLMNavOccurrence> r(root.get());
  QelListValQelBaseUnknown_var level1, level2;
  r->ListChildren(level1);
  ASSERT_EQ(level1.Size(), 1);
  QelVar<QelIPLMNavOccurrence>(level1[1].get())->ListChildren(level2);
  ASSERT_EQ(level2.Size(), 2);

  EXPECT_EQ(PlacementOf(level1[1].get()), QelMathTransformation({0, 0, 1}, {0, 1, 0}, {-1, 0, 0}, {1, 2, 3}));
  EXPECT_EQ(PlacementOf(level2[1].get()), QelMathTransformation({1, 0, 0}, {0, 3, 0}, {0, 0, 1}, {}));
  // A small but sound scale is no degenerate placement.
  EXPECT_EQ(PlacementOf(level2[2].get()).GetZAxis(), QelMathVector({0, 0, 1e-6}));
  EXPECT_TRUE(PlacementOf(root.get()).IsIdentity());

  auto path = PathOf({root.get(), level1[1].get(), level2[1].get()});
  ExpectNear(PartToContext(path.get(), S_OK).Apply({1, 1, 0}), {1, 5, 4});
}

TEST(QelPartPlacementTest, BadPlacementsAreRefusedNamingTheJsonPath) {
  auto second = [](const std::string& placement) {
    return R"(, "children": [{"id": "p0"}, {"id": "p1", "placement": )" + placement + "}]";
  };
  const std::string degenerate = ": degenerate placement: the x, y and z axes do not span space (determinant 0)";
  struct Case {
    std::string rootBody;
    std::string expected;
  };
  const Case cases[] = {
      {second(R"({"x": [1, 0]})"), "bad.json: $.root.children[1].placement.x: expected an array of 3 numbers"},
      {second(R"({"origin": [0, "1", 0]})"),
       "bad.json: $.root.children[1].placement.origin[1]: expected a number, found string"},
      {second("[1, 0, 0]"), "bad.json: $.root.children[1].placement: expected an object, found array"},
      {second(R"({"translation": [1, 0, 0]})"), "bad.json: $.root.children[1].placement: unknown key 'translation'"},
      {second(R"({"z": [0, 0, 0]})"), "bad.json: $.root.children[1].placement" + degenerate},
      {R"(, "children": [{"id": "p0", "children": [{"id": "p1", "placement": {"x": [1, 1, 0], "y": [2, 2, 0]}}]}])",
       "bad.json: $.root.children[0].children[0].placement" + degenerate},
      {R"(, "placement": {})", "bad.json: $.root.placement: the root product has no father to be placed in"},
  };
  for (const Case& c : cases) EXPECT_EQ(Refusal(c.rootBody), c.expected);
}

TEST(QelPartPlacementTest, SamplePartsCarryTheirPlacements) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(std::string(QEL_SOURCE_DIR) + "/data/sample-product.json", root, error), S_OK)
      << error;
  QelListValQelBaseUnknown_var parts;
  QelVar<QelIPLMNavOccurrence>(root.get())->ListChildren(parts);
  ASSERT_EQ(parts.Size(), 3);
  const char* aliases[] = {"Base Plate", "Bracket", "Shaft"};
  const QelMathPoint partOrigins[] = {{0, 0, -10}, {60, 0, 10}, {100, 40, 30}};
  const QelMathPoint xUnitInRoot[] = {{1, 0, -10}, {60, 1, 10}, {101, 40, 30}};
  for (int i = 0; i < 3; ++i) {
    QelBaseUnknown* part = parts[i + 1].get();
    QelUnicodeString alias;
    QelVar<QelIAlias>(part)->GetAlias(alias);
    EXPECT_EQ(alias.Utf8(), aliases[i]);
    QelMathTransformation t = PartToContext(PathOf({root.get(), part}).get(), S_OK);
    ExpectNear(t.Apply({0, 0, 0}), partOrigins[i]);
    ExpectNear(t.Apply({1, 0, 0}), xUnitInRoot[i]);
  }
}

namespace {
TEST(QelProductTreeTest, AProductChainFarDeeperThanFilesAllowIsReleasedWithoutRecursion) {
  // Each level used to release the next from its destructor: 100,000 levels ran out of stack.
  const int64_t liveBefore = QelBaseUnknown::LiveObjectCount();
  {
    QelModelBuilder builder;
    QelBaseUnknown_var product = builder.Root();
    for (int level = 0; level < 100000; ++level) product = builder.AddProduct(product, {.alias = "P"});
    // A handle held on a deep product keeps that product, and only its subtree, alive.
    QelBaseUnknown_var kept = product;
    product = nullptr;
    builder.Finish() = nullptr;
    QelVar<QelIPLMNavOccurrence> deep{kept.get()};
    ASSERT_TRUE(deep);
    QelBaseUnknown_var father;
    EXPECT_EQ(deep->GetFather(father), S_FALSE) << "its father went with the rest of the chain";
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), liveBefore);
}
}  // namespace
