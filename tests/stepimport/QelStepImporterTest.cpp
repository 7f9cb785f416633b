// The importer on the three NIST annotation test models: what a reviewer must find in each
// (datums, tolerance values, views and their cameras, shapes), and that the JSON model file
// written from an import loads back to the same model.
#include <cmath>
#include <cstdio>
#include <map>
#include <set>

#include "QelModelBuilder.h"
#include "QelModelLoader.h"
#include "QelRovFacetServices.h"
#include "QelStepImportSupport.h"

using namespace QelStepTest;
using Json = nlohmann::json;

namespace {
std::vector<Json> WithCode(const Json& set, int code) {
  std::vector<Json> out;
  for (const Json& a : set["annotations"])
    if (a["code"] == code) out.push_back(a);
  return out;
}

const Json* ByAlias(const Json& list, const std::string& alias) {
  for (const Json& item : list)
    if (item["alias"] == alias) return &item;
  return nullptr;
}

QelMathVector Vec(const Json& j) { return {j[0].get<double>(), j[1].get<double>(), j[2].get<double>()}; }

QelMathVector Unit(const QelMathVector& v) { return v * (1.0 / v.Norm()); }

void ExpectDirection(const QelMathVector& actual, const QelMathVector& expected, const std::string& what) {
  EXPECT_LT((Unit(actual) - Unit(expected)).Norm(), 1e-5) << what;
}

size_t Triangles(const Json& product) {
  size_t count = product.contains("shape") ? product["shape"]["triangles"]["faces"].size() : 0;
  if (product.contains("children"))
    for (const Json& child : product["children"]) count += Triangles(child);
  return count;
}
}  // namespace

TEST(QelStepImporterTest, Ctc01GivesDatumsTolerancesDimensionsAndItsView) {
  QEL_REQUIRE_NIST_MODELS();
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    std::vector<std::string> notes;
    QelBaseUnknown_var root = Import(kCtc01, &notes);
    ASSERT_TRUE(root);
    EXPECT_TRUE(notes.empty()) << notes.front();
    const Json model = Dump(root.get());
    EXPECT_EQ(model["root"]["alias"], "NIST Complex Test Case 1");
    EXPECT_GT(Triangles(model["root"]), 1000u) << "the part is tessellated";

    EXPECT_EQ(model["unit"], "mm");
    // One PRODUCT whose shape is a solid and a wire body: one product, one set.
    EXPECT_FALSE(model["root"].contains("children")) << "the pieces of its shape are no products";
    ASSERT_EQ(model["sets"].size(), 1u) << "one product owns every annotation";
    const Json& set = model["sets"][0];
    EXPECT_TRUE(set["light"]) << "the views browser lists only light sets";
    EXPECT_EQ(set["rootSet"], "direct");
    EXPECT_EQ(set["owner"], model["root"]["id"]);

    // Each annotation stands at its own place, most with a leader to what they annotate.
    std::set<std::vector<double>> anchors;
    std::set<std::string> aliases;
    size_t leaders = 0, drawn = 0;
    for (const Json& a : set["annotations"]) {
      anchors.insert(a["anchor"].get<std::vector<double>>());
      EXPECT_TRUE(aliases.insert(a["alias"].get<std::string>()).second) << a["alias"] << " is not unique";
      leaders += a.contains("leader") ? 1 : 0;
      drawn += a.contains("segments") ? 1 : 0;
    }
    EXPECT_GE(anchors.size(), 15u) << "labels heaped at a few points";
    EXPECT_GE(leaders, 15u);
    EXPECT_EQ(drawn, 21u) << "the file draws every annotation (tessellated, repositioned)";
    EXPECT_TRUE(aliases.count("diameter 35 (4)")) << "repeated names are counted";

    // Each datum letter once, though every tolerance citing it repeats it in the file.
    std::multiset<std::string> datums;
    for (const Json& d : WithCode(set, 3)) {
      datums.insert(d["names"][0].get<std::string>());
      EXPECT_EQ(d["subType"], "Datum " + d["names"][0].get<std::string>());
    }
    EXPECT_EQ(datums, (std::multiset<std::string>{"A", "B", "C"}));

    EXPECT_EQ(WithCode(set, 5).size(), 6u);
    // The file writes this magnitude as a complex measure instance, which the translator drops.
    const Json* position = ByAlias(set["annotations"], "Position.1");
    ASSERT_TRUE(position);
    EXPECT_EQ((*position)["type"], "Geometrical Tolerance");
    EXPECT_EQ((*position)["subType"], "Position");
    EXPECT_DOUBLE_EQ((*position)["tolerance"].get<double>(), 0.75);
    EXPECT_EQ((*position)["frame"]["datums"], Json::array({"A", "B", "C"})) << "the frame cites its datums";
    EXPECT_DOUBLE_EQ((*position)["frame"]["zone"].get<double>(), 0.75);
    for (const Json& t : WithCode(set, 5))
      if (t["subType"] != "Flatness") {
        EXPECT_FALSE(t["frame"]["datums"].empty()) << t["alias"];
      }
    const Json* flatness = ByAlias(set["annotations"], "Flatness.1");
    ASSERT_TRUE(flatness);
    EXPECT_DOUBLE_EQ((*flatness)["tolerance"].get<double>(), 0.2);

    EXPECT_EQ(WithCode(set, 6).size(), 12u);
    // 60 degrees +0.5/-0.5: the zone is 1; diameter 35 +0/-0.2: the zone is 0.2.
    const Json* angle = ByAlias(set["annotations"], "angle 60");
    ASSERT_TRUE(angle);
    EXPECT_EQ((*angle)["subType"], "Angle");
    EXPECT_NEAR((*angle)["tolerance"].get<double>(), 1.0, 1e-9);
    EXPECT_EQ((*angle)["dimension"], (Json{{"nominal", 60.0}, {"upper", 0.5}, {"lower", -0.5}}));
    const Json* diameter = ByAlias(set["annotations"], "diameter 25");
    ASSERT_TRUE(diameter);
    EXPECT_NEAR((*diameter)["tolerance"].get<double>(), 0.3, 1e-9);
    const Json* distance = ByAlias(set["annotations"], "linear distance");
    ASSERT_TRUE(distance);
    EXPECT_EQ((*distance)["subType"], "Linear Distance");
    EXPECT_TRUE((*distance)["tolerance"].is_null()) << "the file gives this dimension no tolerance";
    EXPECT_FALSE(distance->contains("dimension")) << "nor a value";

    ASSERT_EQ(set["views"].size(), 1u);
    const Json& view = set["views"][0];
    EXPECT_EQ(view["alias"], "MBD_0");
    EXPECT_EQ(view["elements"].size(), 21u) << "the saved view lists all 21 annotations";
    EXPECT_TRUE(view["plane"].is_null()) << "the file asks this view for no clipping";
    ASSERT_EQ(set["captures"].size(), 1u);
    const Json& capture = set["captures"][0];
    EXPECT_EQ(capture["view"], view["id"]);
    const QelMathVector sight = Vec(capture["camera"]["target"]) - Vec(capture["camera"]["origin"]);
    ExpectDirection(sight, {-0.588013, 0.566487, -0.57735}, "the capture looks along the file's view direction");
    ExpectDirection(Vec(capture["camera"]["zenith"]), {-0.415788, 0.400567, 0.816497}, "the file's up direction");
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before) << "the imported model leaked or left a cycle";
}

TEST(QelStepImporterTest, Ftc06HasThreeViewsEachCapturedWithTheFilesCamera) {
  QEL_REQUIRE_NIST_MODELS();
  QelBaseUnknown_var root = Import(kFtc06);
  ASSERT_TRUE(root);
  const Json model = Dump(root.get());
  // One PRODUCT (a solid and a compound of datum targets): one product, one set.
  EXPECT_FALSE(model["root"].contains("children"));
  ASSERT_EQ(model["sets"].size(), 1u);
  const Json& set = model["sets"][0];
  EXPECT_GT(WithCode(set, 5).size(), 10u);
  const std::map<std::string, QelMathVector> directions = {{"MBD_A", {-0.57735, -0.57735, 0.57735}},
                                                           {"MBD_B", {0.57735, -0.57735, -0.57735}},
                                                           {"MBD_C", {0, -0.69797, 0.716127}}};
  ASSERT_EQ(set["views"].size(), 3u);
  ASSERT_EQ(set["captures"].size(), 3u);
  for (const Json& capture : set["captures"]) {
    const std::string name = capture["alias"].get<std::string>().substr(0, 5);
    ASSERT_TRUE(directions.count(name)) << capture["alias"];
    const Json* view = ByAlias(set["views"], name);
    ASSERT_TRUE(view);
    EXPECT_EQ(capture["view"], (*view)["id"]);
    ExpectDirection(Vec(capture["camera"]["target"]) - Vec(capture["camera"]["origin"]), directions.at(name), name);
  }
  // An inch file: nominals and deviations alike in millimetres, the model's unit
  // (the file says R 0.5 +/- 0.02 in).
  EXPECT_EQ(model["unit"], "mm");
  const Json* radius = ByAlias(set["annotations"], "radius 12.7");
  ASSERT_TRUE(radius) << "the nominal is named in millimetres";
  EXPECT_NEAR((*radius)["dimension"]["nominal"].get<double>(), 12.7, 1e-6);
  EXPECT_NEAR((*radius)["dimension"]["upper"].get<double>(), 0.508, 1e-6);
  // The translator gives these views no annotations: the file's views list them: each
  // callout's annotation, both rows of a composite frame (one name, "Position.1" and
  // "Position.1 (2)"), less one tolerance of MBD_A the translator does not give by its
  // file name.
  const std::map<std::string, size_t> shows = {{"MBD_A", 26}, {"MBD_B", 13}, {"MBD_C", 20}};
  for (const auto& [name, count] : shows) {
    const Json* view = ByAlias(set["views"], name);
    ASSERT_TRUE(view);
    EXPECT_EQ((*view)["elements"].size(), count) << name;
    EXPECT_TRUE((*view)["plane"].is_null()) << name << " clips nothing";
  }
}

TEST(QelStepImporterTest, Stc06OpensWithItsAnnotationsAndTheFilesOwnViews) {
  QEL_REQUIRE_NIST_MODELS();
  QelBaseUnknown_var root = Import(kStc06);
  ASSERT_TRUE(root);
  const Json model = Dump(root.get());
  ASSERT_EQ(model["sets"].size(), 1u);
  const Json& set = model["sets"][0];
  EXPECT_EQ(set["rootSet"], "direct") << "the file's single part is the root, whose set is its own";
  // The translator reads none of this file's twelve saved views: the file's cameras and
  // draughting models give them, each with what it shows.
  ASSERT_EQ(set["views"].size(), 12u);
  ASSERT_EQ(set["captures"].size(), 12u);
  const std::map<std::string, size_t> shows = {{"MBD_A", 21}, {"MBD_B", 13}, {"MBD_C", 10}, {"Front", 0}};
  for (const auto& [name, count] : shows) {
    const Json* view = ByAlias(set["views"], name);
    ASSERT_TRUE(view) << name;
    EXPECT_EQ((*view)["elements"].size(), count) << name;
    EXPECT_TRUE((*view)["plane"].is_null()) << name;
  }
  const Json* front = ByAlias(set["captures"], "Front Capture");
  ASSERT_TRUE(front);
  ExpectDirection(Vec((*front)["camera"]["target"]) - Vec((*front)["camera"]["origin"]), {0, 1, 0}, "front looks along +y");
  EXPECT_EQ(WithCode(set, 3).size(), 6u) << "datums A to F";
  EXPECT_GT(WithCode(set, 5).size(), 20u);
  EXPECT_GT(Triangles(model["root"]), 1000u);
  // This file draws its annotations: their frames and leaders become drawing segments.
  size_t drawn = 0;
  for (const Json& a : set["annotations"]) drawn += a.contains("segments") ? 1 : 0;
  EXPECT_GT(drawn, set["annotations"].size() / 2);
}

// The JSON model file of an import loads back to a model that writes out the same, so
// every object, name, value, link, shape and shown state survived; a hidden annotation too.
TEST(QelStepImporterTest, JsonExportOfCtc01LoadsBackToTheSameModel) {
  QEL_REQUIRE_NIST_MODELS();
  QelBaseUnknown_var root = Import(kCtc01);
  ASSERT_TRUE(root);
  QelListValQelBaseUnknown_var annotations;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(root.get(), annotations);
  ASSERT_GT(annotations.Size(), 1);
  ASSERT_TRUE(QelModelBuilder::SetShown(annotations[2], false));
  Json model = Dump(root.get());
  EXPECT_FALSE(model["sets"][0]["annotations"][1]["shown"]);
  const std::string file = ::testing::TempDir() + "ctc01-export.json";
  std::string error;
  ASSERT_TRUE(QelModelJsonWriter::WriteFile(root.get(), file, error)) << error;
  QelBaseUnknown_var reloaded;
  ASSERT_EQ(QelModelLoader::LoadFile(file, reloaded, error), S_OK) << error;
  EXPECT_EQ(Dump(reloaded.get()), model);
  std::remove(file.c_str());
}
