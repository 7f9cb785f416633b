// Mesh files through the model loader: what a model author sees, counts and refusals.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "QelMeshFileReader.h"
#include "QelModelLoader.h"
#include "QelPLMProductOccurrence.h"

namespace {
class QelMeshFileTest : public ::testing::Test {
 protected:
  void SetUp() override {
    dir_ = std::filesystem::temp_directory_path() /
           ("qel-mesh-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
    std::filesystem::create_directories(dir_);
  }
  void TearDown() override { std::filesystem::remove_all(dir_); }
  std::string Write(const std::string& name, const std::string& text) {
    std::ofstream(dir_ / name, std::ios::binary) << text;
    return (dir_ / name).string();
  }
  std::string Model(const std::string& shape) {
    return Write("model.json", R"({"format": "qel-product-model", "version": 1,
      "root": {"id": "r", "alias": "R", "shape": )" + shape + "}}");
  }
  std::filesystem::path dir_;
};

std::string BinaryStl(int triangles) {
  std::string s(80, ' ');
  s.append(reinterpret_cast<const char*>(&triangles), 4);
  for (int t = 0; t < triangles; ++t) {
    float data[12] = {0, 0, 1, 0, 0, 0, 1, 0, 0, 0, 1, 0};
    data[3] = static_cast<float>(t);
    s.append(reinterpret_cast<const char*>(data), sizeof data);
    s.append(2, '\0');
  }
  return s;
}
}  // namespace

TEST_F(QelMeshFileTest, StlAndObjLoadWithTheirTriangles) {
  Write("part.stl", BinaryStl(5));
  Write("part.obj", "v 0 0 0\nv 1 0 0\nv 1 1 0\nv 0 1 0\nf 1 2 3 4\nf 1 3 4\n");
  Write("part.ply",
        "ply\nformat ascii 1.0\nelement vertex 3\nproperty float x\nproperty float y\nproperty float z\n"
        "element face 1\nproperty list uchar int vertex_indices\nend_header\n0 0 0\n1 0 0\n0 1 0\n3 0 1 2\n");
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(Model(R"([{"mesh": {"file": "part.stl"}}, {"mesh": {"file": "part.obj"}}, {"mesh": {"file": "part.ply"}},
                                               {"box": {"min": [0,0,0], "max": [1,1,1]}}])"),
                                     root, error),
            S_OK)
      << error;
  auto* product = QelSysDynamicCast<QelPLMProductOccurrence>(root.get());
  ASSERT_TRUE(product && product->Shape());
  EXPECT_EQ(product->Shape()->TriangleCount(), 5u + 3u + 1u + 12u);  // the quad is split in two
}

TEST_F(QelMeshFileTest, BadMeshFilesAreRefusedNamingTheFile) {
  std::string truncated = BinaryStl(40);
  truncated.resize(truncated.size() / 2);
  Write("cut.stl", truncated);
  Write("notes.txt", "hello");
  for (const char* file : {"cut.stl", "missing.obj", "notes.txt"}) {
    QelBaseUnknown_var root;
    std::string error;
    EXPECT_EQ(QelModelLoader::LoadFile(Model(std::string(R"({"mesh": {"file": ")") + file + "\"}}"), root, error),
              E_FAIL);
    EXPECT_FALSE(root);
    EXPECT_NE(error.find(file), std::string::npos) << error;
    EXPECT_NE(error.find("$.root.shape.mesh.file"), std::string::npos) << error;
  }
}

TEST_F(QelMeshFileTest, PrimitivesAreCheckedWhereTheyAreWritten) {
  QelBaseUnknown_var root;
  std::string error;
  EXPECT_EQ(QelModelLoader::LoadFile(Model(R"([{"cylinder": {"base": [0,0,0], "axis": [0,0,0], "radius": 1}}])"),
                                     root, error),
            E_FAIL);
  EXPECT_NE(error.find("$.root.shape[0].cylinder.axis: the axis has no length"), std::string::npos) << error;
}

TEST(QelSampleShapesTest, EveryPartOfTheSampleHasAShape) {
  QelBaseUnknown_var root;
  std::string error;
  ASSERT_EQ(QelModelLoader::LoadFile(std::string(QEL_SOURCE_DIR) + "/data/sample-product.json", root, error), S_OK)
      << error;
  auto* product = QelSysDynamicCast<QelPLMProductOccurrence>(root.get());
  ASSERT_EQ(product->Children().size(), 3u);
  for (const auto& part : product->Children()) {
    ASSERT_TRUE(part->Shape()) << part->Alias();
    EXPECT_GE(part->Shape()->TriangleCount(), 12u) << part->Alias();
  }
}
