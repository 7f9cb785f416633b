// The views browser over a generated model of 50 light sets, 500 views and 1,000 captures
// (each part a box, each view showing 4 annotations, two captures per view): opening the
// browser (every node's items listed and attached), rendering every item's thumbnail once,
// and asking for the kept thumbnails again, which must render nothing.
#include <benchmark/benchmark.h>

#include <memory>
#include <string>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDbrBrowser.h"
#include "QelDbrBrowserContextLFT.h"
#include "QelDelayedDestruction.h"
#include "QelFrmLayout.h"
#include "QelIVIABaseUI.h"
#include "QelModelBuilder.h"
#include "QelModelScene.h"
#include "QelReviewFramework.h"

namespace {
constexpr int kSets = 50;
constexpr int kViewsPerSet = 10;
constexpr int kCapturesPerView = 2;

// The model in an editor of the current 3D window, and a browser of type 1 over it.
class Session {
 public:
  Session() {
    QelReviewFramework::Register();
    // Names a class of the plug-in so the linker keeps it: its registration runs at load.
    QelDbrBrowserContextLFT::MetaObject();
    frame_ = QelApplicationFrame::CreateFrame("LumReview");
    QelModelBuilder b({.alias = "Root"});
    auto box = std::make_shared<const QelMeshShape>(QelMeshShape::Box({-10, -10, -10}, {10, 10, 10}));
    for (int s = 0; s < kSets; ++s) {
      const std::string n = std::to_string(s);
      auto part = b.AddProduct(b.Root(), {.alias = "Part" + n,
                                          .placement = QelMathTransformation::Translation({30.0 * (s % 10), 30.0 * (s / 10), 0}),
                                          .shape = box});
      auto set = b.AddSet(part, {.alias = "Set" + n, .light = true, .rootScope = QelRootSetScope::ARM});
      for (int v = 0; v < kViewsPerSet; ++v) {
        std::vector<QelBaseUnknown*> held;
        std::vector<QelBaseUnknown_var> annotations;
        for (int a = 0; a < 4; ++a) {
          annotations.push_back(b.AddAnnotation(set, {.alias = "A" + n + "." + std::to_string(v * 4 + a),
                                                      .typeName = a % 2 ? "Datum" : "Geometrical Tolerance",
                                                      .anchor = {2.0 * a, 1.0 * v, 10}}));
          held.push_back(annotations.back().get());
        }
        auto view = b.AddView(set, {.alias = "V" + n + "." + std::to_string(v), .elements = held});
        for (int c = 0; c < kCapturesPerView; ++c)
          b.AddCapture(set, {.alias = "C" + n + "." + std::to_string(v * kCapturesPerView + c), .view = view.get(),
                             .camera = QelModelCameraDesc{.origin = {0, -80, 60.0 + c}, .target = {0, 0, 0}}});
      }
    }
    root_ = b.Finish();
    editor_ = QelMakeVar<QelFrmEditor>(root_.get());
    window_ = QelMakeVar<Qel3DWindow>(editor_.get());
    // Previews take their view modes from the current window's viewer.
    window_->SetViewer(QelMakeVar<Qel3DViewer>(576, 432).get());
    frame_->GetLayout()->AddWindow(window_.get());
    frame_->GetLayout()->SetCurrentWindow(window_.get());
    path_ = QelMakeVar<QelPathElement>();
    path_->AddChildElement(root_.get());
    previews_ = QelMakeVar<Qel3DViewer>(576, 432);
    previews_->SetSceneSource(QelMakeVar<QelModelScene>(root_.get()).get());
  }
  ~Session() {
    browser_ = nullptr;
    window_->SetViewer(nullptr);
    window_ = nullptr;
    editor_ = nullptr;
    previews_ = nullptr;
    path_ = nullptr;
    root_ = nullptr;
    QelApplicationFrame::DestroyFrame();
    QelDelayedDestruction::FlushIdle();
  }
  QelDbrBrowser* Open() {
    browser_ = QelMakeVar<QelDbrBrowser>(1, path_.get(), previews_.get());
    browser_->Open(root_.get(), editor_.get());
    return browser_.get();
  }
  void Close() {
    browser_->Close();
    browser_ = nullptr;
  }

 private:
  QelApplicationFrame* frame_ = nullptr;
  QelBaseUnknown_var root_;
  QelVar<QelFrmEditor> editor_;
  QelVar<Qel3DWindow> window_;
  QelVar<QelPathElement> path_;
  QelVar<Qel3DViewer> previews_;
  QelVar<QelDbrBrowser> browser_;
};

int CountItems(const QelDbrBrowser& browser) {
  int items = 0;
  for (const auto& node : browser.GetNodes()) items += node.items.Size();
  return items;
}

// Asks every item for its thumbnail; answers how many came back.
int AskThumbnails(const QelDbrBrowser& browser) {
  int images = 0;
  for (const auto& node : browser.GetNodes())
    for (const auto& item : node.items) {
      QelPixelImage* image = nullptr;
      if (QelVar<QelIVIABaseUI> ui{item.get()}) ui->GetThumbnail(&image);
      if (image) {
        ++images;
        image->Release();
      }
    }
  return images;
}

// Open, list every node's items (and attach each to the browser view), close.
void BM_BrowserListing(benchmark::State& state) {
  Session session;
  int items = 0;
  for (auto _ : state) {
    QelDbrBrowser* browser = session.Open();
    items = CountItems(*browser);
    benchmark::DoNotOptimize(items);
    session.Close();
  }
  state.counters["items"] = items;
  state.counters["per_item"] = benchmark::Counter(static_cast<double>(items) * state.iterations(),
                                                  benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}
BENCHMARK(BM_BrowserListing)->Unit(benchmark::kMillisecond);

// A fresh model each round (not timed): the listing plus one render of every thumbnail.
void BM_BrowserListingWithThumbnails(benchmark::State& state) {
  int items = 0;
  for (auto _ : state) {
    state.PauseTiming();
    auto session = std::make_unique<Session>();
    state.ResumeTiming();
    QelDbrBrowser* browser = session->Open();
    items = CountItems(*browser);
    if (AskThumbnails(*browser) != items || browser->GetPreviewCount() != items) {
      state.SkipWithError("not every item rendered exactly once");
      break;
    }
    state.PauseTiming();
    session.reset();
    state.ResumeTiming();
  }
  state.counters["items"] = items;
  state.counters["per_item"] = benchmark::Counter(static_cast<double>(items) * state.iterations(),
                                                  benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}
BENCHMARK(BM_BrowserListingWithThumbnails)->Unit(benchmark::kMillisecond)->Iterations(1);

// The thumbnails again while the items live: kept images only, no preview at all.
void BM_KeptThumbnails(benchmark::State& state) {
  Session session;
  QelDbrBrowser* browser = session.Open();
  const int items = CountItems(*browser);
  AskThumbnails(*browser);
  const int rendered = browser->GetPreviewCount();
  for (auto _ : state) benchmark::DoNotOptimize(AskThumbnails(*browser));
  if (browser->GetPreviewCount() != rendered) state.SkipWithError("a kept thumbnail was rendered again");
  state.counters["items"] = items;
  state.counters["per_item"] = benchmark::Counter(static_cast<double>(items) * state.iterations(),
                                                  benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
  session.Close();
}
// Fixed iterations: the set-up renders 1,000 thumbnails and must run once.
BENCHMARK(BM_KeptThumbnails)->Unit(benchmark::kMillisecond)->Iterations(200);
}  // namespace

BENCHMARK_MAIN();
