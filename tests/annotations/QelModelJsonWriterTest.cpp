// The JSON model writer: the sample (light and root sets, hidden objects, extraction and
// related views, a capture without camera, other elements) written and loaded back writes
// out the same; a written triangle list is read back exactly, and a bad one is refused.
#include <gtest/gtest.h>

#include <sstream>

#include <nlohmann/json.hpp>

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
