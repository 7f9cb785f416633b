// The context factory and the item adapter as the host's review browser meets them: when
// the browser is offered, which context it gets, and what one item answers, renders once,
// keeps, and does when activated.
#include <cstdlib>

#include "BrowserFixture.h"
#include "Qel2DLWindow.h"
#include "QelCommandHeader.h"
#include "QelDbrBrowserViewItemIntros.h"
#include "QelIDbrBrowserContext.h"
#include "QelIDbrBrowserContextFactory.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelIVIABaseUI.h"
#include "QelRecord.h"
#include "QelRovFacetServices.h"

namespace {
class ViewsBrowserTest : public BrowserFixture {
 protected:
  void TearDown() override {
    QelRecord::SetMain(nullptr);
    unsetenv("Qel_VB_LA");
    set_ = view_ = lone_ = capture_ = nullptr;
    BrowserFixture::TearDown();
  }
  // A light set on the root: view V with capture C (with a camera), and view Lone that no
  // capture uses.
  void BuildModel() {
    set_ = b_.AddSet(b_.Root(), {.alias = "S", .light = true, .rootScope = QelRootSetScope::Direct});
    auto a = b_.AddAnnotation(set_, {.alias = "A", .typeName = "Datum", .anchor = {0, 0, 0}});
    b_.AddAnnotation(set_, {.alias = "B", .typeName = "Datum", .anchor = {1, 0, 0}});
    view_ = b_.AddView(set_, {.alias = "V", .elements = {a.get()}});
    lone_ = b_.AddView(set_, {.alias = "Lone"});
    capture_ = b_.AddCapture(set_, {.alias = "C", .view = view_.get(),
                                    .camera = QelModelCameraDesc{.origin = {0, 0, 10}, .target = {0, 0, 0}, .zenith = {0, 1, 0}}});
  }
  QelVar<QelIDbrBrowserContextFactory> Factory() const { return QelVar<QelIDbrBrowserContextFactory>(root_.get()); }
  QelBaseUnknown_var AskContext(int type) {
    int asked = type;
    QelBaseUnknown_var self(static_cast<QelIDbrBrowser*>(browser_.get()));
    return Factory()->GetBrowserContext(asked, self);
  }
  bool Available(int type) {
    int asked = type;
    return Factory()->IsBrowserAvailable(asked);
  }

  QelBaseUnknown_var set_, view_, lone_, capture_;
};
}  // namespace

TEST_F(ViewsBrowserTest, FactoryOffersTheBrowserAndSharesOneContextWhileHeld) {
  BuildModel();
  ShowModel();
  browser_ = QelMakeVar<QelDbrBrowser>(1, RootPath().get(), nullptr);
  QelAssertionCapture reports;
  EXPECT_TRUE(Available(1));
  EXPECT_FALSE(Available(2));
  EXPECT_FALSE(AskContext(2));
  EXPECT_EQ(reports.Count(kQelAssertKindBool), 1) << "only the context request of type 2 is reported";

  // While a recorder captures or replays, the browser needs "Qel_VB_LA" (any value).
  QelRecord::SetMain(QelMakeVar<QelRecord>(QelRecord::Mode::Replay).get());
  EXPECT_FALSE(Available(1));
  setenv("Qel_VB_LA", "", 1);
  EXPECT_TRUE(Available(1));
  QelRecord::GetMain()->SetMode(QelRecord::Mode::Idle);
  unsetenv("Qel_VB_LA");
  EXPECT_TRUE(Available(1));

  // One context while it is held; the browser is registered on it each time.
  QelBaseUnknown_var first = AskContext(1);
  ASSERT_TRUE(first);
  EXPECT_STREQ(first->IsA(), "QelDbrBrowserContextLFT");
  EXPECT_TRUE(first->IsAKindOf("QelDbrBrowserContext"));
  auto other = QelMakeVar<QelDbrBrowser>(1, RootPath().get(), nullptr);
  int type = 1;
  QelBaseUnknown_var otherHandle(static_cast<QelIDbrBrowser*>(other.get()));
  QelBaseUnknown_var second = Factory()->GetBrowserContext(type, otherHandle);
  EXPECT_EQ(first.get(), second.get());
  EXPECT_TRUE(QelSysDynamicCast<QelDbrBrowserContext>(first.get())->GetBrowser(1)->IsEqual(other.get()));
  // Released by its holders, the context goes, and the next request makes a new one.
  QelBaseUnknown_WR old(first.get());
  first = nullptr;
  second = nullptr;
  EXPECT_FALSE(old.IsAlive());
  QelBaseUnknown_var fresh = AskContext(1);
  ASSERT_TRUE(fresh);
  EXPECT_TRUE(QelSysDynamicCast<QelDbrBrowserContext>(fresh.get())->GetBrowser(1)->IsEqual(browser_.get()));
  fresh = nullptr;

  // Not in a 2D layout window.
  window_->SetViewer(nullptr);
  auto layout = QelMakeVar<Qel2DLWindow>(editor_.get());
  frame_->GetLayout()->AddWindow(layout.get());
  frame_->GetLayout()->SetCurrentWindow(layout.get());
  EXPECT_FALSE(Available(1));
}

TEST_F(ViewsBrowserTest, ItemAnswersItsColumnsAndKeepsThumbnailAndPath) {
  BuildModel();
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);
  QelVar<QelIVIABaseUI> capture{capture_.get()};
  QelVar<QelIVIABaseUI> lone{lone_.get()};
  ASSERT_TRUE(capture && lone);

  QelUnicodeString name, title, filter, icon;
  EXPECT_EQ(capture->GetPropertyValue("NAME", name), S_OK);
  EXPECT_EQ(capture->GetItemTitle(title), S_OK);
  EXPECT_EQ(name.Utf8(), "C");
  EXPECT_EQ(title, name);
  EXPECT_EQ(capture->GetPropertyValue("ASSOCIATED_FILTER", filter), S_OK);
  EXPECT_EQ(filter.Utf8(), "V");
  QelUnicodeString empty;
  EXPECT_EQ(lone->GetPropertyValue("ASSOCIATED_FILTER", empty), S_OK);
  EXPECT_TRUE(empty.IsEmpty());
  QelUnicodeString untouched("kept");
  EXPECT_EQ(capture->GetPropertyValue("OTHER", untouched), static_cast<HRESULT>(E_FAIL));
  EXPECT_EQ(untouched.Utf8(), "kept");
  EXPECT_EQ(capture->GetPropertyIcon("NAME", icon), S_OK);
  EXPECT_EQ(icon.Utf8(), "I_Capture");
  EXPECT_EQ(capture->GetPropertyIcon("OTHER", icon), static_cast<HRESULT>(E_FAIL));

  // Rendered once, then kept: the second request answers the same image with one more
  // reference and no second preview.
  QelPixelImage* first = nullptr;
  QelPixelImage* again = nullptr;
  ASSERT_EQ(capture->GetThumbnail(&first), S_OK);
  ASSERT_NE(first, nullptr);
  EXPECT_EQ(first->GetWidth(), 576);
  EXPECT_EQ(capture->GetThumbnail(&again), S_OK);
  EXPECT_EQ(again, first);
  EXPECT_EQ(browser_->GetPreviewCount(), 1);
  again->Release();
  first->Release();

  // The path: the root path extended by the item, built once.
  QelPathElement* path = capture->GetPathElement();
  QelPathElement* samePath = capture->GetPathElement();
  ASSERT_NE(path, nullptr);
  EXPECT_EQ(path, samePath);
  EXPECT_EQ(path->GetSize(), 2);
  EXPECT_TRUE(path->GetLeaf()->IsEqual(capture_.get()));
  path->Release();
  samePath->Release();

  // The list row: made once, redrawn by a refresh.
  QelVar<QelIDbrBrowserViewBaseUI> ui{capture_.get()};
  EXPECT_EQ(ui->RefreshItem(), S_OK);
  QelISYPIntrospectable* raw = nullptr;
  ASSERT_EQ(capture->GetIntrospectable(&raw), S_OK);
  auto row = QelVar<QelISYPIntrospectable>::Adopt(raw);
  auto* intros = QelSysDynamicCast<QelDbrBrowserViewItemIntros>(row.get());
  ASSERT_NE(intros, nullptr);
  EXPECT_EQ(intros->GetRedrawCount(), 1);
  EXPECT_EQ(intros->GetText("NAME").Utf8(), "C");
  QelBaseUnknown_var menu;
  EXPECT_EQ(capture->GetContextualMenu(menu), static_cast<HRESULT>(E_FAIL));
}

TEST_F(ViewsBrowserTest, ThumbnailWaitsForItsRootPathAndViewsAreNotActivated) {
  BuildModel();
  ShowModel();
  ASSERT_EQ(OpenBrowser(), S_OK);
  QelVar<QelIDbrBrowserViewBaseUI> ui{capture_.get()};
  QelVar<QelIVIABaseUI> capture{capture_.get()};
  ui->SetRootPath(nullptr);
  QelPixelImage* image = nullptr;
  EXPECT_EQ(capture->GetThumbnail(&image), S_OK);
  EXPECT_EQ(image, nullptr);
  {
    QelAssertionCapture reports;
    EXPECT_EQ(capture->GetPathElement(), nullptr);
    EXPECT_EQ(reports.Count(kQelAssertKindPointer), 1);
  }
  ui->SetRootPath(RootPath().get());
  EXPECT_EQ(capture->GetThumbnail(&image), S_OK);
  ASSERT_NE(image, nullptr) << "an absent thumbnail is tried again";
  image->Release();
  EXPECT_EQ(browser_->GetPreviewCount(), 2);

  // A view is not activated: reported, no command.
  QelCommandHeader* header = QelCommandHeader::GetHeaderFromList("QelTPSDisplayCaptureHdr", 0);
  ASSERT_NE(header, nullptr);
  const int runs = header->GetStartCount();
  QelVar<QelIVIABaseUI> view{view_.get()};
  QelAssertionCapture reports;
  EXPECT_EQ(view->ActivateItem(), S_OK);
  EXPECT_EQ(reports.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
  EXPECT_EQ(header->GetStartCount(), runs);

  // A capture runs the command: the viewer takes its viewpoint and only what its view
  // holds stays shown.
  QelModelBuilder::SetShown(set_, true);
  EXPECT_EQ(browser_->Activate(capture_.get()), S_OK);
  EXPECT_EQ(header->GetStartCount(), runs + 1);
  EXPECT_EQ(viewer_->GetMain3DViewpoint()->GetOrigin(), (QelMathPoint{0, 0, 10}));
  QelListValQelBaseUnknown_var shownAnnotations;
  QelRovFacetServices::ListAnnotationsOfVisibleSets(root_.get(), shownAnnotations);
  int shown = 0;
  for (const auto& annotation : shownAnnotations) shown += QelRovFacetServices::IsDisplayEnabled(annotation.get()) == S_OK;
  EXPECT_EQ(shown, 1);
}
