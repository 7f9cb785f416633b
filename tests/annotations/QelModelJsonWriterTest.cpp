// The JSON model writer: the sample (light and root sets, hidden objects, extraction and
// related views, a capture without camera, other elements) written and loaded back writes
// out the same; a written triangle list is read back exactly, and a bad one is refused.
#include <gtest/gtest.h>

#include <sstream>

#include <nlohmann/json.hpp>

#include "QelAnnotationLabel.h"
#include "QelModelBuilder.h"
#include "QelModelJsonWriter.h"
#include "QelModelLoader.h"

namespace {
std::string Written(QelBaseUnknown* root) {
  std::ostringstream out;
  EXPECT_TRUE(QelModelJsonWriter::Write(root, out));
  return out.str();
}

std::string Reloaded(const std::string& text) {
  QelBaseUnknown_var root;
  std::string error;
  EXPECT_EQ(QelModelLoader::LoadText(text, "written.json", root, error), S_OK) << error;
  return root ? Written(root.get()) : std::string();
}
}  // namespace

TEST(QelModelJsonWriterTest, SampleWritesOutTheSameAfterLoadingBack) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(std::string(QEL_SOURCE_DIR) + "/data/sample-product.json", root, error), S_OK);
  const std::string text = Written(root.get());
  EXPECT_EQ(Reloaded(text), text);
  for (const char* kept : {"\"rootSet\": \"arm\"", "\"extraction\": true", "\"references\"", "\"shown\": false",
                           "\"placement\"", "\"light\": true"}) {
    EXPECT_NE(text.find(kept), std::string::npos) << kept << " was not written";
  }
  // Only a model's root can be written.
  EXPECT_FALSE(QelModelJsonWriter::Write(nullptr, std::cout));
}

// What the sample lacks: a shape as triangles, related views and a set's own second list.
TEST(QelModelJsonWriterTest, BuiltModelRoundTripsAndBadTrianglesAreRefused) {
  QelModelBuilder builder({.alias = "R"});
  auto mesh = std::make_shared<QelMeshShape>(QelMeshShape::Box({0.1, 0.2, 0.3}, {1.7, 2.9, 3.3}));
  builder.SetShape(builder.Root(), mesh);
  QelBaseUnknown_var set = builder.AddSet(builder.Root(), {.alias = "S"});
  QelBaseUnknown_var a = builder.AddAnnotation(set, {.alias = "A", .typeName = "Datum", .subTypeName = "Datum A"});
  QelBaseUnknown_var v1 = builder.AddView(set, {.alias = "V1", .elements = {a.get()}});
  QelBaseUnknown_var v2 = builder.AddView(set, {.alias = "V2", .plane = std::nullopt, .relatedViews = {v1.get()}});
  builder.AddCapture(set, {.alias = "C", .view = v2.get()});
  builder.SetOtherElements(set, {v1.get()});
  QelBaseUnknown_var root = builder.Finish();
  const std::string text = Written(root.get());
  EXPECT_EQ(Reloaded(text), text) << "float vertices survive the decimal text exactly";
  const nlohmann::json written = nlohmann::json::parse(text);
  EXPECT_EQ(written["sets"][0]["otherElements"], nlohmann::json::array({"v1"}));
  EXPECT_EQ(written["sets"][0]["views"][1]["related"], nlohmann::json::array({"v1"}));
  EXPECT_TRUE(written["sets"][0]["views"][1]["plane"].is_null());

  QelBaseUnknown_var refused;
  std::string error;
  const std::string bad = R"({"format": "qel-product-model", "version": 1, "root": {"id": "r", "shape":
      {"triangles": {"vertices": [[0,0,0],[1,0,0],[0,1,0]], "faces": [[0,1,3]]}}}})";
  EXPECT_EQ(QelModelLoader::LoadText(bad, "bad.json", refused, error), E_FAIL);
  EXPECT_EQ(error, "bad.json: $.root.shape.triangles.faces[0][2]: expected the index of one of the 3 vertices");
}

// What an annotation says survives a file: the unit, a tolerance frame, a dimension's
// deviations or limits, a leader; and each reads as the drawing does.
TEST(QelModelJsonWriterTest, UnitFramesDimensionsAndLeadersRoundTripAndReadAsDrawn) {
  QelModelBuilder builder({.alias = "R"});
  builder.SetLengthUnit("in");
  QelBaseUnknown_var set = builder.AddSet(builder.Root(), {.alias = "S"});
  QelBaseUnknown_var position = builder.AddAnnotation(
      set, {.alias = "Position.1", .typeName = "Geometrical Tolerance", .subTypeName = "Position", .typeCode = 5,
            .leader = QelMathPoint{1, 2, 3},
            .frame = QelModelToleranceFrame{.zone = 0.75, .zoneShape = "diameter", .material = "M",
                                            .datums = {"A", "B-C"}}});
  QelBaseUnknown_var flatness = builder.AddAnnotation(
      set, {.alias = "Flatness.1", .typeName = "Geometrical Tolerance", .subTypeName = "Flatness", .typeCode = 5,
            .frame = QelModelToleranceFrame{.zone = 0.2}});
  QelBaseUnknown_var diameter = builder.AddAnnotation(
      set, {.alias = "diameter 35", .typeName = "Dimension", .subTypeName = "Diameter", .typeCode = 6,
            .dimension = QelModelDimensionValue{.nominal = 35, .upper = 0.0, .lower = -0.2}});
  QelBaseUnknown_var angle = builder.AddAnnotation(
      set, {.alias = "angle 60", .typeName = "Dimension", .subTypeName = "Angle", .typeCode = 6,
            .dimension = QelModelDimensionValue{.nominal = 60, .upper = 0.5, .lower = -0.5}});
  QelBaseUnknown_var limits = builder.AddAnnotation(
      set, {.alias = "width", .typeName = "Dimension", .subTypeName = "Linear Distance", .typeCode = 6,
            .dimension = QelModelDimensionValue{.nominal = 25, .upper = 25.1, .lower = 24.9, .limits = true}});
  QelBaseUnknown_var datum =
      builder.AddAnnotation(set, {.alias = "Datum A", .navigationNames = {"A"}, .typeName = "Datum", .typeCode = 3});
  QelBaseUnknown_var root = builder.Finish();

  EXPECT_EQ(QelAnnotationLabel::Text(position.get()), "\u2316 | \u23000.75 \u24C2 | A | B-C");
  EXPECT_EQ(QelAnnotationLabel::Text(flatness.get()), "\u23E5 | 0.2");
  EXPECT_EQ(QelAnnotationLabel::Text(diameter.get()), "\u230035 +0 -0.2");
  EXPECT_EQ(QelAnnotationLabel::Text(angle.get()), "60\u00B0 \u00B10.5\u00B0");
  EXPECT_EQ(QelAnnotationLabel::Text(limits.get()), "25.1 / 24.9");
  EXPECT_EQ(QelAnnotationLabel::Text(datum.get()), "") << "a datum says its letter, its name already";
  EXPECT_EQ(QelAnnotationLabel::LengthUnit(datum.get()), "in");
  EXPECT_EQ(QelAnnotationLabel::Text(root.get()), "") << "the root is no annotation";

  const std::string text = Written(root.get());
  EXPECT_EQ(Reloaded(text), text);
  const nlohmann::json written = nlohmann::json::parse(text);
  EXPECT_EQ(written["unit"], "in");
  const nlohmann::json& a = written["sets"][0]["annotations"];
  EXPECT_EQ(a[0]["frame"]["datums"], nlohmann::json::array({"A", "B-C"}));
  EXPECT_EQ(a[0]["leader"], nlohmann::json::array({1, 2, 3}));
  EXPECT_EQ(a[4]["dimension"]["max"], 25.1);
  EXPECT_FALSE(a[4]["dimension"].contains("upper"));
}
