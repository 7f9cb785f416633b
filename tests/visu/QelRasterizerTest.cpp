// The renderer is checked by what a person sees: a few small numbered reference pictures
// (tests/visu/golden/NNN-name.png) and a few properties. Regenerate the pictures after an
// intended change with QEL_REGENERATE_GOLDEN=1 and look at them before committing.
// Tolerance: a pixel differs when a channel is off by more than 8; at most 0.5% may differ.
#include <gtest/gtest.h>
#include <png.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>

#include "QelPngWriter.h"
#include "QelRasterizer.h"
#include "QelTextRenderer.h"

namespace {
const std::filesystem::path kGolden = std::filesystem::path(QEL_SOURCE_DIR) / "tests/visu/golden";

QelVar<QelPixelImage> ReadPng(const std::filesystem::path& file) {
  png_image image{};
  image.version = PNG_IMAGE_VERSION;
  if (!png_image_begin_read_from_file(&image, file.c_str())) return {};
  image.format = PNG_FORMAT_RGB;
  auto out = QelMakeVar<QelPixelImage>(static_cast<int>(image.width), static_cast<int>(image.height));
  if (!png_image_finish_read(&image, nullptr, out->GetPixels(), 0, nullptr)) return {};
  return out;
}

void ExpectLooksLike(const QelPixelImage& made, const char* name) {
  const std::filesystem::path file = kGolden / name;
  if (std::getenv("QEL_REGENERATE_GOLDEN")) {
    std::string error;
    ASSERT_TRUE(QelPngWriter::Write(made, file.string(), error)) << error;
    return;
  }
  QelVar<QelPixelImage> golden = ReadPng(file);
  ASSERT_TRUE(golden) << file << " is missing; run with QEL_REGENERATE_GOLDEN=1";
  ASSERT_EQ(golden->GetWidth(), made.GetWidth());
  ASSERT_EQ(golden->GetHeight(), made.GetHeight());
  int differing = 0;
  const int n = made.GetWidth() * made.GetHeight();
  for (int i = 0; i < n; ++i)
    for (int c = 0; c < 3; ++c)
      if (std::abs(made.GetPixels()[i * 3 + c] - golden->GetPixels()[i * 3 + c]) > 8) {
        ++differing;
        break;
      }
  EXPECT_LE(differing, n / 200) << name << ": " << differing << " pixels differ";
}

std::shared_ptr<const QelMeshShape> Shape(QelMeshShape m) { return std::make_shared<const QelMeshShape>(std::move(m)); }

std::shared_ptr<const QelMeshShape> Triangle(float z) {
  QelMeshShape m;
  m.vertices = {{-1, -1, z}, {1, -1, z}, {0, 1, z}};
  m.triangles = {{0, 1, 2}};
  return Shape(m);
}

QelRenderView LookDownZ(double distance) {
  QelRenderView view;
  view.eye = {0, 0, distance};
  view.sight = {0, 0, -1};
  view.up = {0, 1, 0};
  return view;
}

int CountColor(const QelPixelImage& image, uint8_t r, uint8_t g, uint8_t b) {
  int count = 0;
  for (int i = 0, n = image.GetWidth() * image.GetHeight(); i < n; ++i) {
    const uint8_t* p = image.GetPixels() + i * 3;
    count += p[0] == r && p[1] == g && p[2] == b;
  }
  return count;
}

bool HasColor(const QelPixelImage& image, uint8_t r, uint8_t g, uint8_t b) { return CountColor(image, r, g, b) > 0; }
}  // namespace

TEST(QelRasterizerTest, EmptySceneIsBackgroundOnly) {
  auto image = QelMakeVar<QelPixelImage>(32, 24);
  QelRenderView view = LookDownZ(10);
  view.background = {0.5f, 0.5f, 0.5f};
  QelRasterizer::Render(QelRenderScene{}, view, *image);
  for (int i = 0; i < 32 * 24 * 3; ++i) ASSERT_EQ(image->GetPixels()[i], 128);
}

TEST(QelRasterizerTest, NearerTriangleHidesFartherOneWhateverTheOrder) {
  for (bool nearFirst : {true, false}) {
    QelRenderScene scene;
    QelRenderMesh nearMesh{Triangle(1), {}, {1, 0, 0}}, farMesh{Triangle(-1), {}, {0, 0, 1}};
    scene.meshes = nearFirst ? std::vector{nearMesh, farMesh} : std::vector{farMesh, nearMesh};
    QelRenderView view = LookDownZ(10);
    view.shading = false;
    auto image = QelMakeVar<QelPixelImage>(64, 64);
    QelRasterizer::Render(scene, view, *image);
    uint8_t r, g, b;
    image->GetPixel(32, 34, r, g, b);
    EXPECT_EQ(r, 255);
    EXPECT_EQ(b, 0);
  }
}

TEST(QelRasterizerTest, BackFacesAreCulledUnlessClippingOpensTheShape) {
  QelRenderScene scene;
  QelMeshShape m;
  m.vertices = {{-1, -1, 0}, {0, 1, 0}, {1, -1, 0}};  // clockwise seen from +z
  m.triangles = {{0, 1, 2}};
  scene.meshes.push_back({Shape(m), {}, {1, 1, 1}});
  QelRenderView view = LookDownZ(10);
  view.background = {0, 0, 0};
  auto image = QelMakeVar<QelPixelImage>(16, 16);
  QelRasterizer::Render(scene, view, *image);
  EXPECT_FALSE(HasColor(*image, 255, 255, 255));
  uint8_t r, g, b;
  image->GetPixel(8, 8, r, g, b);
  EXPECT_EQ(r, 0);
  view.clipping.push_back(QelMathPlane({0, 0, 5}, {0, 0, 1}, {1, 0, 0}, {0, 1, 0}));
  QelRasterizer::Render(scene, view, *image);
  image->GetPixel(8, 8, r, g, b);
  EXPECT_GT(r, 0) << "an opened shape shows its inside";
}

TEST(QelRasterizerTest, GoldenPictures) {
  QelRenderScene scene;
  scene.meshes.push_back({Shape(QelMeshShape::Box({-2, -1, -1}, {2, 1, 1})), {}, {0.62f, 0.66f, 0.72f}});
  scene.meshes.push_back(
      {Shape(QelMeshShape::Cylinder({0, 0, 1}, {0, 0, 2}, 0.6, 24)), {}, {0.80f, 0.72f, 0.55f}});
  QelRenderView view;
  view.eye = {6, -8, 6};
  view.sight = QelMathPoint{0, 0, 0} - view.eye;
  view.up = {0, 0, 1};
  auto image = QelMakeVar<QelPixelImage>(96, 72);
  QelRasterizer::Render(scene, view, *image);
  ExpectLooksLike(*image, "001-box-and-cylinder.png");

  view.clipping.push_back(QelMathPlane({0, 0, 0}, {0, -1, 0}, {1, 0, 0}, {0, 0, 1}));
  QelRasterizer::Render(scene, view, *image);
  ExpectLooksLike(*image, "002-clipped.png");

  QelTextRenderer text;
  if (!text.IsReady()) GTEST_SKIP() << text.Error();
  QelRenderScene marks;
  marks.annotations.push_back({{0, 0, 0}, {{-2, -1, 0}, {2, -1, 0}}, {0.85f, 0.1f, 0.1f}, "Flatness"});
  view.clipping.clear();
  view.text = &text;
  auto large = QelMakeVar<QelPixelImage>(160, 90);
  QelRasterizer::Render(marks, view, *large);
  ExpectLooksLike(*large, "003-annotation.png");
}

// A tolerance frame reads as the drawing's: a square box with its characteristic symbol
// drawn in lines (the font lacks most), then one box per compartment; the material
// condition, a circled letter the font lacks, reads "(M)".
TEST(QelRasterizerTest, ToleranceFramesDrawTheirSymbolsAndCompartments) {
  QelTextRenderer text;
  if (!text.IsReady()) GTEST_SKIP() << text.Error();
  QelRenderScene scene;
  const char* symbols[] = {"\u2316", "\u27C2", "\u2313", "\u232D", "\u2330", "\u232F", "\u23E5", "\u2225"};
  for (int i = 0; i < 8; ++i) {
    QelRenderAnnotation a{{(i % 2) * 4.4 - 4.4, 1.8 - (i / 2) * 1.5, 0}, {}, {0.85f, 0.1f, 0.1f}, "frame"};
    a.compartments = {symbols[i], i == 0 ? "\u23000.75 \u24C2" : "0.2", "A", "B-C"};
    scene.annotations.push_back(a);
  }
  QelRenderView view = LookDownZ(10);
  view.text = &text;
  auto image = QelMakeVar<QelPixelImage>(300, 170);
  QelRasterizer::Render(scene, view, *image);
  ExpectLooksLike(*image, "004-tolerance-frames.png");
}

// Annotations without a drawing of their own often share an anchor; each label must stay
// readable, and a crowd of them must not make the picture slow to place.
TEST(QelRasterizerTest, LabelsSharingAnAnchorMoveAsideInsteadOfCovering) {
  QelTextRenderer text;
  if (!text.IsReady()) GTEST_SKIP() << text.Error();
  QelRenderScene scene;
  scene.annotations.push_back({{0, 0, 0}, {}, {1, 0, 0}, "Datum A"});
  scene.annotations.push_back({{0, 0, 0}, {}, {0, 0, 1}, "Datum B"});
  QelRenderView view = LookDownZ(10);
  view.background = {0, 0, 0};
  view.text = &text;
  auto image = QelMakeVar<QelPixelImage>(200, 120);
  QelRasterizer::Render(scene, view, *image);
  // A whole frame border is about 2 * (width + height) * 2 pixels: far more than the anchor's dot.
  EXPECT_GT(CountColor(*image, 255, 0, 0), 150) << "the first label is covered by the second";
  EXPECT_GT(CountColor(*image, 0, 0, 255), 150);

  // A crowd fills the free places and leaves the rest at their anchor's mark, so the labels
  // shown stay whole: the first one's frame is not covered by the last.
  scene.annotations.assign(5000, {{0, 0, 0}, {}, {0, 1, 0}, "crowded"});
  scene.annotations.front().color = {1, 0, 0};
  std::vector<std::string> unplaced;
  QelRasterizer::Render(scene, view, *image, &unplaced);
  EXPECT_GT(CountColor(*image, 255, 0, 0), 150);
  EXPECT_TRUE(HasColor(*image, 0, 255, 0));
  // None goes without a word: every label left at its mark is named.
  EXPECT_GT(unplaced.size(), 4000u);
  EXPECT_LT(unplaced.size(), 5000u);
  EXPECT_EQ(unplaced.front(), "crowded");
}

// A label whose place up and right of its anchor would leave the picture is moved inside
// it whole, and counts as placed.
TEST(QelRasterizerTest, LabelsNearTheBorderStayWholeInsideThePicture) {
  QelRenderView view = LookDownZ(10);
  view.background = {0, 0, 0};
  auto image = QelMakeVar<QelPixelImage>(64, 48);
  // Anchors at the right and the top edges of the picture.
  for (const QelMathPoint anchor : {QelMathPoint{2.6, 0, 0}, QelMathPoint{0, 2.0, 0}}) {
    QelRenderScene scene;
    scene.annotations.push_back({anchor, {}, {1, 0, 0}, "edge"});
    std::vector<std::string> unplaced;
    QelRasterizer::Render(scene, view, *image, &unplaced);
    EXPECT_TRUE(unplaced.empty());
    // Without texts a frame is 30 x 16 with a border of 2: its paper is 26 x 12, all inside.
    EXPECT_EQ(CountColor(*image, 250, 250, 245), 26 * 12) << anchor.x << ", " << anchor.y;
  }
}

TEST(QelPngWriterTest, PicturesReadBackExactlyWhateverTheirSizeAndContent) {
  // Noise that deflate cannot shrink, flat colour that it can, and the smallest picture.
  for (const auto& [width, height] : {std::pair{576, 432}, std::pair{1, 1}, std::pair{3, 700}}) {
    auto image = QelMakeVar<QelPixelImage>(width, height);
    uint32_t noise = 12345;
    for (int i = 0; i < width * height * 3; ++i) {
      noise = noise * 1103515245u + 12345u;
      image->GetPixels()[i] = i < width * height * 3 / 2 ? uint8_t(noise >> 24) : uint8_t(200);
    }
    const auto file = std::filesystem::path(::testing::TempDir()) / "qel-png-round-trip.png";
    std::string error;
    ASSERT_TRUE(QelPngWriter::Write(*image, file.string(), error)) << error;
    QelVar<QelPixelImage> back = ReadPng(file);
    ASSERT_TRUE(back) << width << " x " << height << " does not decode";
    ASSERT_EQ(back->GetWidth(), width);
    ASSERT_EQ(back->GetHeight(), height);
    EXPECT_EQ(std::memcmp(back->GetPixels(), image->GetPixels(), size_t(width) * height * 3), 0) << width << " x " << height;
    std::filesystem::remove(file);
  }
}

TEST(QelPngWriterTest, RefusesAnUnwritablePathNamingIt) {
  auto image = QelMakeVar<QelPixelImage>(4, 4);
  std::string error;
  EXPECT_FALSE(QelPngWriter::Write(*image, "/nonexistent-folder/x.png", error));
  EXPECT_NE(error.find("/nonexistent-folder/x.png"), std::string::npos) << error;
  std::string bytes;
  ASSERT_TRUE(QelPngWriter::Encode(*image, bytes));
  EXPECT_EQ(bytes.substr(1, 3), "PNG");
}
