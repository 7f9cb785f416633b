// The browser view toolbox against a small model: cameras from views, capture viewpoints,
// the choice of filter and clipping of a thumbnail, and descriptions.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelAssert.h"
#include "QelDelayedDestruction.h"
#include "QelFrm3DCamera.h"
#include "QelFrmLayout.h"
#include "QelIDriClippingFactory.h"
#include "QelIDriFilterFactory.h"
#include "QelModelBuilder.h"
#include "QelModelScene.h"
#include "QelReviewFramework.h"
#include "QelRovBrowserViewToolbox.h"

class QelRovBrowserViewToolboxProbe {
 public:
  static HRESULT Camera(QelVar<QelITPSView>& v, QelVar<QelI3DCamera>& c) {
    return QelRovBrowserViewToolbox::ComputeCameraFromView(v, c);
  }
  static HRESULT Capture(QelPathElement* p, Qel3DViewer* v, QelPathElement* r) {
    return QelRovBrowserViewToolbox::ApplyCaptureViewpoint(p, v, r);
  }
  static HRESULT Modes(Qel3DViewer* v) { return QelRovBrowserViewToolbox::InitializeViewModesFomCurrentViewer(v); }
  static QelVar<QelPathElement> Path(QelBaseUnknown_var& o, QelPathElement* r) {
    return QelVar<QelPathElement>::Adopt(QelRovBrowserViewToolbox::CreateObjectPath(o, r));
  }
};
using Probe = QelRovBrowserViewToolboxProbe;

namespace {
QelMathPlane Plane(QelMathVector normal, QelMathPoint origin = {}) {
  return QelMathPlane(origin, normal, {1, 0, 0}, {0, 1, 0});
}

bool Near(const QelMathVector& a, const QelMathVector& b, double eps = 1e-5) { return (a - b).Norm() < eps; }

class ToolboxTest : public ::testing::Test {
 protected:
  void SetUp() override {
    QelReviewFramework::Register();
    frame_ = QelApplicationFrame::CreateFrame("LumReview");
    editor_ = QelMakeVar<QelFrmEditor>();
    window_ = QelMakeVar<Qel3DWindow>(editor_.get());
    current_ = QelMakeVar<Qel3DViewer>();
    window_->SetViewer(current_.get());
    frame_->GetLayout()->AddWindow(window_.get());
    frame_->GetLayout()->SetCurrentWindow(window_.get());
  }
  void TearDown() override {
    window_->SetViewer(nullptr);
    window_ = nullptr;
    editor_ = nullptr;
    current_ = nullptr;
    set_ = nullptr;
    annotations_.clear();
    owned_.reset();
    QelApplicationFrame::DestroyFrame();
    QelDelayedDestruction::FlushIdle();
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), liveBefore_) << "the scenario leaked or left a cycle";
  }

  // A set on the root with three annotations; view 1 holds the first two.
  void BuildSet(bool light = true) {
    set_ = b_.AddSet(b_.Root(), {.alias = "Set", .light = light});
    for (const char* name : {"A1", "A2", "A3"})
      annotations_.push_back(b_.AddAnnotation(set_, {.alias = name, .typeName = "Datum", .anchor = {0, 0, 0}}));
  }
  QelBaseUnknown_var View(const char* alias, std::vector<QelBaseUnknown*> elements, QelMathPlane plane = Plane({0, 0, 1}),
                          bool section = false) {
    return b_.AddView(set_, {.alias = alias, .plane = plane, .elements = elements, .extraction = section});
  }
  QelVar<Qel3DViewer> Viewer() {
    auto viewer = QelMakeVar<Qel3DViewer>(300, 100);
    viewer->SetSceneSource(QelMakeVar<QelModelScene>(b_.Root().get()).get());
    return viewer;
  }
  QelVar<QelPathElement> RootPath() {
    auto path = QelMakeVar<QelPathElement>();
    path->AddChildElement(b_.Root().get());
    return path;
  }

  // Counted before any member makes an object.
  int64_t liveBefore_ = QelBaseUnknown::LiveObjectCount();
  QelApplicationFrame* frame_ = nullptr;
  QelVar<QelFrmEditor> editor_;
  QelVar<Qel3DWindow> window_;
  QelVar<Qel3DViewer> current_;
  std::unique_ptr<QelModelBuilder> owned_ = std::make_unique<QelModelBuilder>();
  QelModelBuilder& b_ = *owned_;
  QelBaseUnknown_var set_;
  std::vector<QelBaseUnknown_var> annotations_;
};
}  // namespace

TEST_F(ToolboxTest, CameraFromViewCases) {
  BuildSet();
  auto camera = QelVar<QelI3DCamera>(QelMakeVar<QelFrm3DCamera>("c").get());
  auto place = [&](QelMathPoint origin, QelMathPoint target) {
    camera->SetOrigin(origin);
    camera->SetTarget(target);
  };
  // A zero normal leaves the camera as it was.
  QelVar<QelITPSView> flat{View("Flat", {}, Plane({0, 0, 0})).get()};
  place({1, 2, 3}, {4, 5, 6});
  EXPECT_EQ(Probe::Camera(flat, camera), S_FALSE);
  QelMathPoint o;
  camera->GetOrigin(o);
  EXPECT_EQ(o, (QelMathPoint{1, 2, 3}));
  // Normal (0, 0, 2) gives sight (0, 0, -1); the distance to the target is kept.
  QelVar<QelITPSView> scaled{View("Scaled", {}, Plane({0, 0, 2}, {0, 0, 1})).get()};
  place({3, 4, 11}, {3, 4, 5});
  ASSERT_EQ(Probe::Camera(scaled, camera), S_OK);
  QelMathVector sight, up;
  QelMathPoint t;
  camera->GetDirection(sight);
  camera->GetZenith(up);
  camera->GetOrigin(o);
  camera->GetTarget(t);
  EXPECT_EQ(sight, (QelMathVector{0, 0, -1}));
  EXPECT_EQ(up, (QelMathVector{0, 1, 0}));
  EXPECT_EQ(t, (QelMathPoint{3, 4, 1}));
  EXPECT_EQ(o, (QelMathPoint{3, 4, 7}));
  // Origin equal to target: both become the target's projection.
  place({2, 2, 9}, {2, 2, 9});
  ASSERT_EQ(Probe::Camera(scaled, camera), S_OK);
  camera->GetOrigin(o);
  camera->GetTarget(t);
  EXPECT_EQ(o, (QelMathPoint{2, 2, 1}));
  EXPECT_EQ(t, (QelMathPoint{2, 2, 1}));
  // An extraction view without reference views uses its own plane.
  QelVar<QelITPSView> extraction{
      b_.AddView(set_, {.alias = "Ext", .plane = Plane({1, 0, 0}), .extraction = true}).get()};
  ASSERT_EQ(Probe::Camera(extraction, camera), S_OK);
  camera->GetDirection(sight);
  EXPECT_EQ(sight, (QelMathVector{-1, 0, 0}));
  // Null handles are broken contracts.
  QelAssertionCapture capture;
  QelVar<QelITPSView> none;
  EXPECT_EQ(Probe::Camera(none, camera), E_UNEXPECTED);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
}

TEST_F(ToolboxTest, ScaledPartGivesUnitDirectionsAndUnnormalisedPoints) {
  QelBaseUnknown_var part = b_.AddProduct(b_.Root(), {.alias = "Part", .placement = QelMathTransformation::Scale(2)});
  QelBaseUnknown_var set = b_.AddSet(part, {.alias = "S", .light = true});
  QelBaseUnknown_var capture = b_.AddCapture(
      set, {.alias = "C", .camera = QelModelCameraDesc{.origin = {0, 0, 10}, .target = {0, 0, 0}, .zenith = {0, 3, 0}}});
  auto path = RootPath();
  path->AddChildElement(part.get());
  path->AddChildElement(capture.get());
  auto viewer = Viewer();
  ASSERT_EQ(Probe::Capture(path.get(), viewer.get(), RootPath().get()), S_OK);
  Qel3DViewpoint* vp = viewer->GetMain3DViewpoint();
  EXPECT_EQ(vp->GetOrigin(), (QelMathPoint{0, 0, 20}));
  EXPECT_TRUE(Near(vp->GetSightDirection().ToDouble(), {0, 0, -1}));
  EXPECT_TRUE(Near(vp->GetUpDirection().ToDouble(), {0, 1, 0}));
  EXPECT_EQ(vp->GetTarget(), (QelMathPointf{0, 0, 0}));
}

TEST_F(ToolboxTest, CaptureWithoutCameraOrViewIsNotReframed) {
  BuildSet();
  QelBaseUnknown_var capture = b_.AddCapture(set_, {.alias = "Bare"});
  auto path = RootPath();
  path->AddChildElement(capture.get());
  auto viewer = Viewer();
  Qel3DViewpoint* vp = viewer->GetMain3DViewpoint();
  vp->SetOrigin({7, 7, 7});
  EXPECT_EQ(Probe::Capture(path.get(), viewer.get(), RootPath().get()), S_FALSE);
  EXPECT_EQ(vp->GetOrigin(), (QelMathPoint{7, 7, 7}));
  EXPECT_FLOAT_EQ(vp->GetAspectRatio(), 3.0f) << "brought up to date with the 300 x 100 support";
}

TEST_F(ToolboxTest, ViewUsedByTwoCapturesTakesTheFirst) {
  BuildSet();
  QelBaseUnknown_var view = View("V", {annotations_[0].get()});
  b_.AddCapture(set_, {.alias = "First", .view = view.get(),
                       .camera = QelModelCameraDesc{.origin = {0, 0, 50}, .target = {0, 0, 0}, .zenith = {0, 1, 0}}});
  b_.AddCapture(set_, {.alias = "Second", .view = view.get(),
                       .camera = QelModelCameraDesc{.origin = {0, 0, 90}, .target = {0, 0, 0}, .zenith = {0, 1, 0}}});
  auto viewer = Viewer();
  QelPixelImage* image = QelRovBrowserViewToolbox::GetThumbnailPreview(view, viewer.get(), RootPath().get());
  ASSERT_TRUE(image);
  EXPECT_EQ(image->GetWidth(), 576);
  EXPECT_EQ(image->GetHeight(), 432);
  image->Release();
  EXPECT_EQ(viewer->GetMain3DViewpoint()->GetOrigin(), (QelMathPoint{0, 0, 50}));
  EXPECT_EQ(QelRovBrowserViewToolbox::GetThumbnailDescription(view).Utf8(), "First");
}

TEST_F(ToolboxTest, ViewWithoutCaptureShowsOnlyItsElements) {
  BuildSet();
  QelBaseUnknown_var view = View("V", {annotations_[0].get(), annotations_[1].get()});
  // A filter left on the viewpoint would show in the scene the viewer draws afterwards.
  auto viewer = Viewer();
  QelVar<QelPixelImage> image =
      QelVar<QelPixelImage>::Adopt(QelRovBrowserViewToolbox::GetThumbnailPreview(view, viewer.get(), RootPath().get()));
  ASSERT_TRUE(image);
  EXPECT_TRUE(QelRovBrowserViewToolbox::GetThumbnailDescription(view).Utf8().empty());
  EXPECT_EQ(viewer->GetMain3DViewpoint()->GetFilter(), nullptr);
  // The filter itself, as the toolbox applies it, leaves out exactly the third annotation.
  struct Spy : QelIVisuSceneSource {
    void CollectScene(QelRenderScene&, QelIVisuObjectFilter* filter) override {
      if (!filter) return;
      for (auto& a : *annotations) out.push_back(filter->IsFilteredOut(a.get()));
    }
    std::vector<QelBaseUnknown_var>* annotations = nullptr;
    std::vector<bool> out;

   protected:
    ~Spy() override = default;
  };
  auto spy = QelMakeVar<Spy>();
  spy->annotations = &annotations_;
  viewer->SetSceneSource(spy.get());
  image = QelVar<QelPixelImage>::Adopt(QelRovBrowserViewToolbox::GetThumbnailPreview(view, viewer.get(), RootPath().get()));
  ASSERT_GE(spy->out.size(), 3u);
  EXPECT_EQ(std::vector<bool>(spy->out.end() - 3, spy->out.end()), (std::vector<bool>{false, false, true}));
}

TEST_F(ToolboxTest, LinkedCaptureUsesItsFilterAndTheViewsClipping) {
  BuildSet();
  QelBaseUnknown_var view = View("V", {annotations_[0].get()}, Plane({0, 0, 1}, {0, 0, 5}), true);
  QelBaseUnknown_var capture = b_.AddCapture(set_, {.alias = "C", .view = view.get()});
  struct Spy : QelIVisuSceneSource {
    void CollectScene(QelRenderScene&, QelIVisuObjectFilter* filter) override {
      planes = viewpoint->GetClippingPlanes().size();
      filtered = filter && filter->IsFilteredOut(hidden);
    }
    Qel3DViewpoint* viewpoint = nullptr;
    QelBaseUnknown* hidden = nullptr;
    size_t planes = 0;
    bool filtered = false;

   protected:
    ~Spy() override = default;
  };
  auto viewer = Viewer();
  auto spy = QelMakeVar<Spy>();
  spy->viewpoint = viewer->GetMain3DViewpoint();
  spy->hidden = annotations_[2].get();
  viewer->SetSceneSource(spy.get());
  QelVar<QelPixelImage> image = QelVar<QelPixelImage>::Adopt(
      QelRovBrowserViewToolbox::GetThumbnailPreview(capture, viewer.get(), RootPath().get()));
  ASSERT_TRUE(image);
  EXPECT_EQ(spy->planes, 1u);
  EXPECT_TRUE(spy->filtered);
  EXPECT_TRUE(viewer->GetMain3DViewpoint()->GetClippingPlanes().empty());
  EXPECT_EQ(QelRovBrowserViewToolbox::GetThumbnailDescription(capture).Utf8(), "V");
}

TEST_F(ToolboxTest, NoFilterNorClippingStillRemovesTheClippingPlane) {
  BuildSet(false);
  QelBaseUnknown_var capture = b_.AddCapture(set_, {.alias = "C"});
  auto viewer = Viewer();
  viewer->GetMain3DViewpoint()->AddClippingPlane(Plane({1, 0, 0}));
  QelVar<QelPixelImage> image = QelVar<QelPixelImage>::Adopt(
      QelRovBrowserViewToolbox::GetThumbnailPreview(capture, viewer.get(), RootPath().get()));
  ASSERT_TRUE(image);
  EXPECT_TRUE(viewer->GetMain3DViewpoint()->GetClippingPlanes().empty());
}

TEST_F(ToolboxTest, ExactlyTwentyOneViewModeBitsAreCopied) {
  auto viewer = Viewer();
  for (uint32_t bit = 1; bit; bit <<= 1) {
    current_->SetViewMode(bit, bit % 3 == 0 || bit == 0x100000 || bit == 0x2);
    viewer->SetViewMode(bit, 1);
  }
  const int before = viewer->GetUpdateCount();
  ASSERT_EQ(Probe::Modes(viewer.get()), S_OK);
  EXPECT_EQ(viewer->GetUpdateCount(), before + 1);
  for (uint32_t bit = 1; bit; bit <<= 1)
    EXPECT_EQ(viewer->ViewMode(bit), bit <= 0x100000 ? current_->ViewMode(bit) : 1) << std::hex << bit;
}

TEST_F(ToolboxTest, FailureAfterTheFilterLeavesNoFilter) {
  BuildSet();
  QelBaseUnknown_var view = View("V", {annotations_[0].get()});
  auto viewer = Viewer();
  viewer->GetSupport()->SetSize(0, 0);  // no surface: no off-screen support can be made of it
  QelAssertionCapture capture;
  EXPECT_EQ(QelRovBrowserViewToolbox::GetThumbnailPreview(view, viewer.get(), RootPath().get()), nullptr);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, ""), 1);
  EXPECT_EQ(viewer->GetMain3DViewpoint()->GetFilter(), nullptr);
  EXPECT_TRUE(viewer->GetMain3DViewpoint()->GetClippingPlanes().empty());
}

TEST_F(ToolboxTest, BrokenContractsAnswerAsDocumented) {
  BuildSet();
  QelAssertionCapture capture;
  QelBaseUnknown_var none, notAnItem = annotations_[0];
  auto viewer = Viewer();
  EXPECT_EQ(QelRovBrowserViewToolbox::GetThumbnailPreview(none, viewer.get(), RootPath().get()), nullptr);
  EXPECT_EQ(QelRovBrowserViewToolbox::GetThumbnailPreview(notAnItem, nullptr, RootPath().get()), nullptr);
  EXPECT_TRUE(QelRovBrowserViewToolbox::GetThumbnailDescription(notAnItem).Utf8().empty());
  EXPECT_EQ(Probe::Capture(nullptr, viewer.get(), nullptr), E_UNEXPECTED);
  window_->SetViewer(nullptr);
  EXPECT_EQ(Probe::Modes(viewer.get()), E_UNEXPECTED);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 2);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 5);
}

TEST_F(ToolboxTest, HiddenAnnotationLeavesNoPixelOfItsColour) {
  BuildSet();
  QelBaseUnknown_var view = View("V", {annotations_[0].get(), annotations_[1].get(), annotations_[2].get()});
  auto viewer = Viewer();
  const QelRenderColor c = QelModelScene::KindColor("Datum");
  const uint8_t rgb[3] = {static_cast<uint8_t>(c.r * 255 + 0.5f), static_cast<uint8_t>(c.g * 255 + 0.5f),
                          static_cast<uint8_t>(c.b * 255 + 0.5f)};
  auto count = [&] {
    QelVar<QelPixelImage> image = QelVar<QelPixelImage>::Adopt(
        QelRovBrowserViewToolbox::GetThumbnailPreview(view, viewer.get(), RootPath().get()));
    int n = 0;
    for (int i = 0; i < 576 * 432; ++i) n += std::equal(rgb, rgb + 3, image->GetPixels() + i * 3);
    return n;
  };
  EXPECT_GT(count(), 0);
  for (auto& a : annotations_) QelModelBuilder::SetShown(a, false);
  EXPECT_EQ(count(), 0);
}

TEST_F(ToolboxTest, ObjectPathsHangBelowTheRoot) {
  QelBaseUnknown_var part = b_.AddProduct(b_.Root(), {.alias = "Part"});
  QelBaseUnknown_var sub = b_.AddProduct(part, {.alias = "Sub"});
  set_ = b_.AddSet(sub, {.alias = "S", .light = true});
  QelBaseUnknown_var view = View("V", {});
  auto root = RootPath();
  // A light item becomes the leaf of a copy of the root path.
  QelVar<QelPathElement> path = Probe::Path(view, root.get());
  ASSERT_TRUE(path);
  ASSERT_EQ(path->GetSize(), 2);
  EXPECT_TRUE(path->GetLeaf()->IsEqual(view.get()));
  EXPECT_EQ(root->GetSize(), 1) << "the root path itself is left as it was";
  // A product builds the chain of products down from the root.
  path = Probe::Path(sub, root.get());
  ASSERT_TRUE(path);
  ASSERT_EQ(path->GetSize(), 3);
  EXPECT_TRUE((*path)[1]->IsEqual(part.get()));
  QelAssertionCapture capture;
  EXPECT_FALSE(Probe::Path(view, nullptr));
  EXPECT_FALSE(Probe::Path(set_, root.get())) << "a set builds no path";
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 2);
}

TEST_F(ToolboxTest, SceneShowsShownPartsPlacedInTheRoot) {
  auto box = std::make_shared<const QelMeshShape>(QelMeshShape::Box({0, 0, 0}, {1, 1, 1}));
  QelBaseUnknown_var part = b_.AddProduct(
      b_.Root(), {.alias = "Part", .placement = QelMathTransformation::Translation({10, 0, 0}), .shape = box});
  b_.AddProduct(part, {.alias = "Hidden", .shown = false, .shape = box});
  auto scene = QelMakeVar<QelModelScene>(b_.Root().get());
  QelRenderScene collected;
  scene->CollectScene(collected, nullptr);
  ASSERT_EQ(collected.meshes.size(), 1u);
  EXPECT_EQ(collected.meshes[0].toWorld.Apply({0, 0, 0}), (QelMathPoint{10, 0, 0}));
}

TEST_F(ToolboxTest, FactoriesFilterOtherSetsAndClipInTheContext) {
  QelBaseUnknown_var part = b_.AddProduct(
      b_.Root(), {.alias = "Part", .placement = QelMathTransformation::Translation({0, 0, 100})});
  set_ = b_.AddSet(part, {.alias = "Mine", .light = true});
  QelBaseUnknown_var mine = b_.AddAnnotation(set_, {.alias = "M", .typeName = "Datum"});
  QelBaseUnknown_var other = b_.AddSet(b_.Root(), {.alias = "Other", .light = true});
  QelBaseUnknown_var theirs = b_.AddAnnotation(other, {.alias = "T", .typeName = "Datum"});
  QelBaseUnknown_var view = View("V", {mine.get()}, Plane({0, 0, 1}, {0, 0, 5}), true);
  QelBaseUnknown_var plain = View("P", {mine.get()}, Plane({0, 0, 1}, {0, 0, 5}));
  QelBaseUnknown_var capture = b_.AddCapture(set_, {.alias = "C", .view = view.get()});
  auto path = RootPath();
  path->AddChildElement(part.get());
  path->AddChildElement(capture.get());

  QelVar<QelIDriFilterFactory> filters{capture.get()};
  ASSERT_TRUE(filters);
  QelVar<QelDbrFilter> filter;
  ASSERT_EQ(filters->GetFilter(path.get(), false, filter), S_OK);
  EXPECT_TRUE(filter->IsFilteredOut(theirs.get()));
  EXPECT_FALSE(filter->IsFilteredOut(mine.get()));
  // What the view holds is drawn even while the display hides it, as activating shows it.
  EXPECT_TRUE(filter->IsKeptIn(mine.get()));
  EXPECT_TRUE(filter->IsKeptIn(set_.get()));
  EXPECT_FALSE(filter->IsKeptIn(theirs.get()));
  ASSERT_EQ(filters->GetFilter(path.get(), true, filter), S_OK) << "the view holds all of its set";
  EXPECT_FALSE(filter->IsFilteredOut(theirs.get()));
  EXPECT_TRUE(filter->IsKeptIn(mine.get()));

  QelVar<QelIDriClippingFactory> clippings{view.get()};
  ASSERT_TRUE(clippings);
  QelVar<QelDbrClipping> clipping;
  ASSERT_EQ(clippings->GetClipping(path.get(), true, clipping), S_OK);
  EXPECT_DOUBLE_EQ(clipping->GetPlane().DistanceTo({0, 0, 105}), 0.0) << "the part's plane, placed in the root";
  EXPECT_EQ(QelVar<QelIDriClippingFactory>(capture.get())->GetClipping(path.get(), true, clipping), S_FALSE);
  EXPECT_FALSE(clipping);
  // Only a section view cuts the model.
  EXPECT_EQ(QelVar<QelIDriClippingFactory>(plain.get())->GetClipping(path.get(), true, clipping), S_FALSE);
  EXPECT_FALSE(clipping);
}
