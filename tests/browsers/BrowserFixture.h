#pragma once
// A review session for browser tests: a frame with one 3D window whose editor shows the
// model built in the test, and a host review browser of type 1 over that model. Every
// scenario must leave no object alive behind it.
#include <gtest/gtest.h>

#include <memory>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelAssert.h"
#include "QelDbrBrowser.h"
#include "QelDelayedDestruction.h"
#include "QelFrmLayout.h"
#include "QelIAlias.h"
#include "QelModelBuilder.h"
#include "QelModelScene.h"
#include "QelReviewFramework.h"

class BrowserFixture : public ::testing::Test {
 protected:
  void SetUp() override {
    QelReviewFramework::Register();
    frame_ = QelApplicationFrame::CreateFrame("LumReview");
  }
  void TearDown() override {
    browser_ = nullptr;
    if (window_) window_->SetViewer(nullptr);
    window_ = nullptr;
    editor_ = nullptr;
    viewer_ = nullptr;
    root_ = nullptr;
    owned_.reset();
    QelApplicationFrame::DestroyFrame();
    QelDelayedDestruction::FlushIdle();
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), liveBefore_) << "the scenario leaked or left a cycle";
  }

  // Puts the model in an editor of a current 3D window (a 2D layout window when asked).
  template <class Window = Qel3DWindow>
  void ShowModel() {
    root_ = b_.Root();
    editor_ = QelMakeVar<QelFrmEditor>(root_.get());
    window_ = QelMakeVar<Window>(editor_.get());
    viewer_ = QelMakeVar<Qel3DViewer>(160, 120);
    viewer_->SetSceneSource(QelMakeVar<QelModelScene>(root_.get()).get());
    window_->SetViewer(viewer_.get());
    frame_->GetLayout()->AddWindow(window_.get());
    frame_->GetLayout()->SetCurrentWindow(window_.get());
  }
  QelVar<QelPathElement> RootPath() const {
    auto path = QelMakeVar<QelPathElement>();
    path->AddChildElement(root_.get());
    return path;
  }
  // A browser of type 1 opened on the root, rendering its previews small.
  HRESULT OpenBrowser() {
    auto previews = QelMakeVar<Qel3DViewer>(96, 72);
    previews->SetSceneSource(QelMakeVar<QelModelScene>(root_.get()).get());
    browser_ = QelMakeVar<QelDbrBrowser>(1, RootPath().get(), previews.get());
    return browser_->Open(root_.get(), editor_.get());
  }
  // The items of the node, as aliases.
  std::vector<std::string> Aliases(const QelListValQelBaseUnknown_var& items) const {
    std::vector<std::string> out;
    for (const auto& item : items) {
      QelUnicodeString alias;
      if (QelVar<QelIAlias> named{item.get()}) named->GetAlias(alias);
      out.push_back(alias.Utf8());
    }
    return out;
  }

  // Counted before any member makes an object.
  int64_t liveBefore_ = QelBaseUnknown::LiveObjectCount();
  QelApplicationFrame* frame_ = nullptr;
  std::unique_ptr<QelModelBuilder> owned_ = std::make_unique<QelModelBuilder>();
  QelModelBuilder& b_ = *owned_;
  QelBaseUnknown_var root_;
  QelVar<QelFrmEditor> editor_;
  QelVar<QelFrmWindow> window_;
  QelVar<Qel3DViewer> viewer_;
  QelVar<QelDbrBrowser> browser_;
};
