// The model file loader: the shipped sample loads with the counts docs/model-format.md
// states, and each class of bad input is refused with one message naming where.
#include <gtest/gtest.h>

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

int TypeCode(QelBaseUnknown* annotation) {
  QelBaseUnknown_var owner;
  if (QelVar<QelITPS> tps{annotation}) tps->GetTypeServices(owner);
  else if (QelVar<QelILumGeometry> geometry{annotation}) geometry->GetTypeServices(owner);
  QelVar<QelITPSTypeClassifier> classifier(owner.get());
  QelBaseUnknown_var type;
  if (classifier) classifier->GetType(annotation, type);
  int code = 0;
  if (QelVar<QelITPSType> t{type.get()}) t->GetTypeCode(code);
  return code;
}

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
}  // namespace

TEST(QelModelLoaderTest, SampleLoadsWithTheStatedCounts) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(kSample, root, error), S_OK) << error;
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root.get(), sets, false);
  EXPECT_EQ(sets.Size(), 4);
  int light = 0;
  for (const auto& s : sets) light += QelVar<QelITPSLightSet>(s.get()) ? 1 : 0;
  EXPECT_EQ(light, 2);
  QelListValQelBaseUnknown_var rootSets;
  QelRovFacetServices::ListARMOrDirectSets(root.get(), rootSets, false);
  EXPECT_EQ(rootSets.Size(), 2);

  QelListValQelBaseUnknown_var annotations;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(root.get(), annotations);
  EXPECT_EQ(annotations.Size(), 17);
  std::map<int, int> perCode;
  int text = 0, dimension = 0, hidden = 0;
  for (const auto& a : annotations) {
    if (QelVar<QelITPSTextVisu>(a.get())) ++text;
    else if (QelVar<QelITPSDimVisu>(a.get())) ++dimension;
    else ++perCode[TypeCode(a.get())];
    hidden += QelRovFacetServices::IsDisplayEnabled(a.get()) == S_FALSE ? 1 : 0;
  }
  EXPECT_EQ(perCode, (std::map<int, int>{{3, 3}, {4, 1}, {5, 2}, {6, 2}, {7, 2}, {8, 1}, {9, 2}, {11, 1}, {13, 1}}));
  EXPECT_EQ(text, 1);
  EXPECT_EQ(dimension, 1);
  EXPECT_EQ(hidden, 1);

  QelListValQelBaseUnknown_var viewsAndCaptures;
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root.get(), viewsAndCaptures);
  int views = 0, captures = 0, withoutCamera = 0;
  std::map<std::string, int> usesPerView;
  for (const auto& o : viewsAndCaptures) {
    if (QelVar<QelILumCapture> c{o.get()}) {
      ++captures;
      QelVar<QelICamera> camera;
      if (c->GetCamera(camera) != S_OK) ++withoutCamera;
      QelBaseUnknown_var view;
      c->GetLinkedView(view);
      QelUnicodeString alias;
      QelVar<QelIAlias>(view.get())->GetAlias(alias);
      ++usesPerView[alias.Utf8()];
    } else {
      ++views;
    }
  }
  EXPECT_EQ(views, 6);
  EXPECT_EQ(captures, 6);
  EXPECT_EQ(withoutCamera, 1);
  EXPECT_EQ(usesPerView["Top View"], 2);
  EXPECT_EQ(usesPerView.count("Weld Detail View"), 0u);
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
