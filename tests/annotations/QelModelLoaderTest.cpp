// The model file loader: the shipped sample loads with the counts docs/model-format.md
// states, and each class of bad input is refused with one message naming where.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <map>

#include "QelAnnotationComponents.h"
#include "QelIAlias.h"
#include "QelILumCapture.h"
#include "QelILumSet.h"
#include "QelITPSDimVisu.h"
#include "QelITPSLightSet.h"
#include "QelITPSTextVisu.h"
#include "QelITPSType.h"
#include "QelITPSTypeClassifier.h"
#include "QelITPS.h"
#include "QelILumGeometry.h"
#include "QelModelLoader.h"
#include "QelRovFacetServices.h"

namespace {
const std::string kSample = std::string(QEL_SOURCE_DIR) + "/data/sample-product.json";

std::string Refusal(const std::string& text) {
  QelBaseUnknown_var root;
  std::string error;
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  EXPECT_EQ(QelModelLoader::LoadText(text, "bad.json", root, error), E_FAIL);
  EXPECT_FALSE(root);
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before) << "half-loaded objects left behind";
  return error;
}

// A valid model; each refusal test breaks one thing in it.
std::string Model(const std::string& annotations, const std::string& extraSet = "") {
  return R"({"format": "qel-product-model", "version": 1,
             "root": {"id": "root", "alias": "R", "children": [{"id": "p1", "alias": "P1"}]},
             "sets": [{"id": "s1", "owner": "p1", "annotations": [)" +
         annotations + R"(], "views": [{"id": "v1", "elements": ["a1"]}]})" + extraSet + "]}";
}
const std::string kGoodAnnotation = R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": 3})";

std::string Repeat(const std::string& piece, int times) {
  std::string out;
  for (int i = 0; i < times; ++i) out += piece;
  return out;
}

// A product tree `depth` levels below the root, one product per level.
std::string DeepProducts(int depth) {
  std::string text = R"({"format": "qel-product-model", "version": 1, "root": {"id": "p0")";
  for (int i = 1; i <= depth; ++i) text += R"(, "children": [{"id": "p)" + std::to_string(i) + "\"";
  return text + Repeat("}]", depth) + "}}";
}
}  // namespace

// The shipped sample must stay loadable; what it holds is documented, not re-counted here.
TEST(QelModelLoaderTest, ShippedSampleLoads) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(kSample, root, error), S_OK) << error;
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root.get(), sets, false);
  EXPECT_GT(sets.Size(), 0);
}

TEST(QelModelLoaderTest, RefusesSyntaxErrorsWithLineAndColumn) {
  std::string error = Refusal("{\n  \"format\": \"qel-product-model\",\n  \"version\": 1,,\n}");
  EXPECT_EQ(error.rfind("bad.json:3:", 0), 0u) << error;
  EXPECT_NE(error.find("syntax error"), std::string::npos) << error;
}

TEST(QelModelLoaderTest, RefusesEachClassOfBadContentNamingTheJsonPath) {
  struct Case {
    std::string text;
    std::string expected;
  };
  const Case cases[] = {
      {Model(R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": "3"})"),
       "bad.json: $.sets[0].annotations[0].code: expected an integer, found string"},
      {Model(R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": 3, "tolerance": true})"),
       "bad.json: $.sets[0].annotations[0].tolerance: expected a number, found boolean"},
      {Model(R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": 14})"),
       "bad.json: $.sets[0].annotations[0].code: unknown type code 14 (known codes are 1 to 13)"},
      {Model(kGoodAnnotation + R"(, {"id": "a1", "type": "Datum", "subType": "Simple", "code": 3})"),
       "bad.json: $.sets[0].annotations[1].id: duplicate identifier 'a1'"},
      {Model(kGoodAnnotation, R"(, {"id": "s2", "owner": "p9"})"),
       "bad.json: $.sets[1].owner: unknown product 'p9'"},
      {Model(kGoodAnnotation, R"(, {"id": "s2", "owner": "p1", "captures": [{"id": "c1", "view": "v1"}]})"),
       "bad.json: $.sets[1].captures[0].view: the view belongs to another set"},
      {Model(R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": 3, "tolerence": 1})"),
       "bad.json: $.sets[0].annotations[0]: unknown key 'tolerence'"},
      {Model(R"({"id": "a1", "subType": "Simple", "code": 3})"),
       "bad.json: $.sets[0].annotations[0]: missing key 'type'"},
      {Model("5"), "bad.json: $.sets[0].annotations[0]: expected an object, found number"},
      {Model(kGoodAnnotation, R"(, {"id": "s2", "owner": "p1", "annotations": [{"id": "b1", "type": "T",
           "subType": "S", "code": 3}, {"id": "b2", "type": "T", "subType": "S", "code": 0}]})"),
       "bad.json: $.sets[1].annotations[1].code: unknown type code 0 (known codes are 1 to 13)"},
      {Model(R"({"id": "a1", "type": "T", "subType": "Position", "code": 5, "frame": {"zone": 1, "material": "X"}})"),
       "bad.json: $.sets[0].annotations[0].frame.material: expected \"M\" or \"L\""},
      {Model(R"({"id": "a1", "type": "T", "subType": "Position", "code": 5, "frame": {"datums": ["A"]}})"),
       "bad.json: $.sets[0].annotations[0].frame: missing key 'zone'"},
      {Model(R"({"id": "a1", "type": "T", "subType": "S", "code": 6, "dimension": {"nominal": 2, "upper": 1, "min": 1}})"),
       "bad.json: $.sets[0].annotations[0].dimension: give deviations (upper, lower) or limits (min, max), not both"},
      {Model(R"({"id": "a1", "type": "T", "subType": "S", "code": 6, "dimension": {"nominal": 2, "lower": [1]}})"),
       "bad.json: $.sets[0].annotations[0].dimension.lower: expected a number, found array"},
      {R"({"format": "qel-product-model", "version": 1, "unit": 25.4, "root": {"id": "r"}})",
       "bad.json: $.unit: expected a string, found number"},
  };
  for (const Case& c : cases) EXPECT_EQ(Refusal(c.text), c.expected);
}

TEST(QelModelLoaderTest, RefusesWhatIsNotAReadableModelFileNamingIt) {
  QelBaseUnknown_var root;
  std::string error;
  EXPECT_EQ(QelModelLoader::LoadFile("/nonexistent/model.json", root, error), E_FAIL);
  EXPECT_EQ(error, "/nonexistent/model.json: cannot open the file");
  const std::string folder = ::testing::TempDir();
  EXPECT_EQ(QelModelLoader::LoadFile(folder, root, error), E_FAIL);
  EXPECT_EQ(error, folder + ": is a folder, not a model file");
  EXPECT_FALSE(root);
}

TEST(QelModelLoaderTest, BinaryGarbageIsQuotedAsPrintableText) {
  std::string error = Refusal(std::string("\x01\xFF\xFE{", 4));
  EXPECT_EQ(error.rfind("bad.json:1:1: syntax error", 0), 0u) << error;
  for (unsigned char c : error) EXPECT_TRUE(c >= 0x20 && c < 0x7F) << "raw byte " << int(c) << " in: " << error;
}

TEST(QelModelLoaderTest, ModelFromTextKeepsSetStructure) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadText(Model(kGoodAnnotation), "good.json", root, error), S_OK) << error;
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root.get(), sets, false);
  ASSERT_EQ(sets.Size(), 1);
  QelVar<QelILumSet> set(sets[1].get());
  QelVar<QelILumCollection> views;
  set->GetViews(views);
  uint32_t count = 0;
  views->GetCount(count);
  EXPECT_EQ(count, 1u);
}

TEST(QelModelLoaderTest, ListsLoadWhateverTheOrderOfKeys) {
  // Sets before the root, a set's lists before its identifier and owner, views before
  // the annotations they name.
  const std::string text = R"({"sets": [{"captures": [{"view": "v1", "id": "c1"}],
      "views": [{"elements": ["a1", "a2"], "id": "v1"}],
      "annotations": [{"code": 3, "subType": "S", "type": "T", "id": "a1"},
                      {"id": "a2", "type": "T", "subType": "S", "code": 5}],
      "owner": "p1", "id": "s1"}],
    "root": {"children": [{"id": "p1"}], "id": "root"}, "version": 1, "format": "qel-product-model"})";
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadText(text, "any.json", root, error), S_OK) << error;
  QelListValQelBaseUnknown_var annotations, viewsAndCaptures;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(root.get(), annotations);
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root.get(), viewsAndCaptures);
  EXPECT_EQ(annotations.Size(), 2);
  EXPECT_EQ(viewsAndCaptures.Size(), 2);
}

TEST(QelModelLoaderTest, RefusesNumbersBeyondTheirRangeNamingThePath) {
  const std::string code = R"({"id": "a1", "type": "Datum", "subType": "Simple", "code": )";
  std::string version = Model(kGoodAnnotation);
  version.replace(version.find("\"version\": 1"), 12, "\"version\": 4294967297");
  EXPECT_EQ(Refusal(version), "bad.json: $.version: unsupported version (this host reads version 1)");
  EXPECT_EQ(Refusal(Model(code + "4294967299}")),
            "bad.json: $.sets[0].annotations[0].code: unknown type code 4294967299 (known codes are 1 to 13)");
  EXPECT_EQ(Refusal(Model(code + "18446744073709551615}")),
            "bad.json: $.sets[0].annotations[0].code: integer out of range: 18446744073709551615");
  EXPECT_EQ(Refusal(Model(kGoodAnnotation, R"(, {"id": "s2", "owner": "p1", "kind": 4294967297})")),
            "bad.json: $.sets[1].kind: integer out of range: 4294967297");
  EXPECT_EQ(Refusal(Model(code + "3, \"tolerance\": 1e400}")),
            "bad.json: $.sets[0].annotations[0].tolerance: number out of range: 1e400");
  EXPECT_EQ(Refusal(R"({"root": {"id": "r", "children": [{"id": "p", "placement": {"x": [1, -1e999, 0]}}]}})"),
            "bad.json: $.root.children[0].placement.x[1]: number out of range: -1e999");
}

TEST(QelModelLoaderTest, RefusesDeepNestingByPathWithoutExhaustingTheStack) {
  QelBaseUnknown_var root;
  std::string error;
  EXPECT_EQ(QelModelLoader::LoadText(DeepProducts(200), "deep.json", root, error), S_OK) << error.substr(0, 200);
  root = nullptr;

  EXPECT_EQ(Refusal(DeepProducts(9000)),
            "bad.json: $.root" + Repeat(".children[0]", 201) + ": products nested more than 200 levels deep");
  // Arrays in arrays, in an element the loader reads on its own and at the top.
  const std::string deepAlias = Repeat("[", 100000) + Repeat("]", 100000);
  EXPECT_EQ(Refusal(Model(R"({"id": "a1", "type": "T", "subType": "S", "code": 3, "alias": )" + deepAlias + "}")),
            "bad.json: $.sets[0].annotations[0].alias" + Repeat("[0]", 507) + ": nested more than 512 levels deep");
  EXPECT_EQ(Refusal(deepAlias), "bad.json: $" + Repeat("[0]", 512) + ": nested more than 512 levels deep");
}

TEST(QelModelLoaderTest, RefusesFilesThatAreNotRegularOrTooLarge) {
  QelBaseUnknown_var root;
  std::string error;
  // A pipe without a writer would block a reader for ever; a device never ends.
  const std::string fifo = ::testing::TempDir() + "model-fifo.json";
  std::remove(fifo.c_str());
  ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
  EXPECT_EQ(QelModelLoader::LoadFile(fifo, root, error), E_FAIL);
  EXPECT_EQ(error, fifo + ": not a regular file (a model is read from a regular file)");
  std::remove(fifo.c_str());
  EXPECT_EQ(QelModelLoader::LoadFile("/dev/zero", root, error), E_FAIL);
  EXPECT_EQ(error, "/dev/zero: not a regular file (a model is read from a regular file)");

  // Sparse: no disk is used for the gigabyte.
  const std::string huge = ::testing::TempDir() + "model-huge.json";
  { std::ofstream(huge) << "{}"; }
  ASSERT_EQ(::truncate(huge.c_str(), (int64_t{1} << 30) + 1), 0);
  EXPECT_EQ(QelModelLoader::LoadFile(huge, root, error), E_FAIL);
  EXPECT_EQ(error, huge + ": the file is too large (1073741825 bytes; a model file may have at most 1073741824 bytes)");
  std::remove(huge.c_str());
  EXPECT_FALSE(root);
}
