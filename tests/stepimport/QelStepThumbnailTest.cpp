// The captures of the NIST models' saved views, rendered as the views browser renders
// thumbnails: the part must be in the picture, whole: a saved view that asks for no
// clipping draws exactly what the same capture draws with every view plane taken away.
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelFrmLayout.h"
#include "QelILumCapture.h"
#include "QelModelLoader.h"
#include "QelModelScene.h"
#include "QelPathElement.h"
#include "QelPixelImage.h"
#include "QelReviewFramework.h"
#include "QelRovBrowserViewToolbox.h"
#include "QelRovFacetServices.h"
#include "QelStepImportSupport.h"

namespace {
// The thumbnails of every capture of a model, in the order the facet services list them.
std::vector<QelVar<QelPixelImage>> Thumbnails(const QelBaseUnknown_var& root) {
  std::vector<QelVar<QelPixelImage>> out;
  auto editor = QelMakeVar<QelFrmEditor>(root.get());
  auto window = QelMakeVar<Qel3DWindow>(editor.get());
  auto current = QelMakeVar<Qel3DViewer>();
  window->SetViewer(current.get());
  QelApplicationFrame::GetFrame()->GetLayout()->AddWindow(window.get());
  QelApplicationFrame::GetFrame()->GetLayout()->SetCurrentWindow(window.get());
  QelListValQelBaseUnknown_var items;
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root.get(), items);
  auto viewer = QelMakeVar<Qel3DViewer>(288, 216);
  viewer->SetSceneSource(QelMakeVar<QelModelScene>(root.get()).get());
  auto rootPath = QelMakeVar<QelPathElement>();
  rootPath->AddChildElement(root.get());
  for (int i = 1; i <= items.Size(); ++i) {
    QelBaseUnknown_var item = items[i];
    if (!QelVar<QelILumCapture>(item.get())) continue;
    out.push_back(QelVar<QelPixelImage>::Adopt(QelRovBrowserViewToolbox::GetThumbnailPreview(item, viewer.get(), rootPath.get())));
  }
  window->SetViewer(nullptr);
  return out;
}

// Pixels that differ from the background (the top-left corner's colour).
int Drawn(QelPixelImage& image, int* left = nullptr, int* right = nullptr) {
  uint8_t br, bg, bb;
  image.GetPixel(0, 0, br, bg, bb);
  int drawn = 0, l = image.GetWidth(), r = -1;
  for (int y = 0; y < image.GetHeight(); ++y)
    for (int x = 0; x < image.GetWidth(); ++x) {
      uint8_t cr, cg, cb;
      image.GetPixel(x, y, cr, cg, cb);
      if (std::abs(cr - br) + std::abs(cg - bg) + std::abs(cb - bb) < 24) continue;
      ++drawn;
      l = std::min(l, x);
      r = std::max(r, x);
    }
  if (left) *left = l;
  if (right) *right = r;
  return drawn;
}

int Differing(QelPixelImage& a, QelPixelImage& b) {
  int count = 0;
  for (int y = 0; y < a.GetHeight(); ++y)
    for (int x = 0; x < a.GetWidth(); ++x) {
      uint8_t ar, ag, ab, br, bg, bb;
      a.GetPixel(x, y, ar, ag, ab);
      b.GetPixel(x, y, br, bg, bb);
      count += (ar != br || ag != bg || ab != bb) ? 1 : 0;
    }
  return count;
}

class QelStepThumbnailTest : public ::testing::Test {
 protected:
  void SetUp() override {
    QelReviewFramework::Register();
    QelApplicationFrame::CreateFrame("LumReview");
  }
  void TearDown() override {
    QelApplicationFrame::DestroyFrame();
    QelDelayedDestruction::FlushIdle();
  }
};
}  // namespace

TEST_F(QelStepThumbnailTest, SavedViewsShowTheWholePartUnclipped) {
  QEL_REQUIRE_NIST_MODELS();
  for (const std::string& file : {QelStepTest::kCtc01, QelStepTest::kFtc06}) {
    QelBaseUnknown_var root = QelStepTest::Import(file);
    ASSERT_TRUE(root);
    // The same model with every view's plane taken away: nothing in it can clip.
    nlohmann::json model = QelStepTest::Dump(root.get());
    for (nlohmann::json& set : model["sets"])
      for (nlohmann::json& view : set["views"]) view["plane"] = nullptr;
    QelBaseUnknown_var unclipped;
    std::string error;
    ASSERT_EQ(QelModelLoader::LoadText(model.dump(), "unclipped.json", unclipped, error), S_OK) << error;

    std::vector<QelVar<QelPixelImage>> thumbnails = Thumbnails(root), plain = Thumbnails(unclipped);
    ASSERT_EQ(thumbnails.size(), file == QelStepTest::kCtc01 ? 1u : 3u);
    ASSERT_EQ(plain.size(), thumbnails.size());
    for (size_t i = 0; i < thumbnails.size(); ++i) {
      ASSERT_TRUE(thumbnails[i] && plain[i]);
      QelPixelImage& image = *thumbnails[i];
      int left = 0, right = 0;
      // The part is shaded grey over a good part of the picture, around its middle.
      EXPECT_GT(Drawn(image, &left, &right), image.GetWidth() * image.GetHeight() / 50) << file << " #" << i;
      EXPECT_LT(left, image.GetWidth() / 2);
      EXPECT_GT(right, image.GetWidth() / 2);
      EXPECT_EQ(Differing(image, *plain[i]), 0) << file << " capture #" << i << " is clipped";
    }
  }
}
