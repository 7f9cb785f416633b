// The capture of CTC-01's saved view, rendered as the views browser renders thumbnails:
// the part must be in the picture, not only the background.
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelFrmLayout.h"
#include "QelILumCapture.h"
#include "QelModelScene.h"
#include "QelPathElement.h"
#include "QelPixelImage.h"
#include "QelReviewFramework.h"
#include "QelRovBrowserViewToolbox.h"
#include "QelRovFacetServices.h"
#include "QelStepImportSupport.h"

TEST(QelStepThumbnailTest, Ctc01CaptureShowsThePart) {
  QEL_REQUIRE_NIST_MODELS();
  QelReviewFramework::Register();
  QelApplicationFrame* frame = QelApplicationFrame::CreateFrame("LumReview");
  {
    QelBaseUnknown_var root = QelStepTest::Import(QelStepTest::kCtc01);
    ASSERT_TRUE(root);
    auto editor = QelMakeVar<QelFrmEditor>(root.get());
    auto window = QelMakeVar<Qel3DWindow>(editor.get());
    auto current = QelMakeVar<Qel3DViewer>();
    window->SetViewer(current.get());
    frame->GetLayout()->AddWindow(window.get());
    frame->GetLayout()->SetCurrentWindow(window.get());

    QelListValQelBaseUnknown_var items;
    QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root.get(), items);
    QelBaseUnknown_var capture;
    for (int i = 1; i <= items.Size() && !capture; ++i)
      if (QelVar<QelILumCapture>(items[i].get())) capture = items[i];
    ASSERT_TRUE(capture);
    auto viewer = QelMakeVar<Qel3DViewer>(576, 432);
    viewer->SetSceneSource(QelMakeVar<QelModelScene>(root.get()).get());
    auto rootPath = QelMakeVar<QelPathElement>();
    rootPath->AddChildElement(root.get());
    auto image = QelVar<QelPixelImage>::Adopt(QelRovBrowserViewToolbox::GetThumbnailPreview(capture, viewer.get(), rootPath.get()));
    ASSERT_TRUE(image);

    // The part is shaded grey, darker or lighter than the background, over a good part of
    // the picture and around its middle (the capture looks at the part's centre).
    uint8_t br, bg, bb;
    image->GetPixel(0, 0, br, bg, bb);
    int drawn = 0, left = image->GetWidth(), right = -1;
    for (int y = 0; y < image->GetHeight(); ++y) {
      for (int x = 0; x < image->GetWidth(); ++x) {
        uint8_t r, g, b;
        image->GetPixel(x, y, r, g, b);
        if (std::abs(r - br) + std::abs(g - bg) + std::abs(b - bb) < 24) continue;
        ++drawn;
        left = std::min(left, x);
        right = std::max(right, x);
      }
    }
    EXPECT_GT(drawn, image->GetWidth() * image->GetHeight() / 50) << "hardly anything but background";
    EXPECT_LT(left, image->GetWidth() / 2);
    EXPECT_GT(right, image->GetWidth() / 2);
    window->SetViewer(nullptr);
  }
  QelApplicationFrame::DestroyFrame();
  QelDelayedDestruction::FlushIdle();
}
