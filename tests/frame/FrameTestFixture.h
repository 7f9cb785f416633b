#pragma once
// A fresh application frame per test, and a check that the scenario left no object alive.
#include <gtest/gtest.h>

#include "Qel2DLWindow.h"
#include "Qel3DWindow.h"
#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelDftWindow.h"

class FrameTest : public ::testing::Test {
 protected:
  void SetUp() override {
    liveBefore_ = QelBaseUnknown::LiveObjectCount();
    frame_ = QelApplicationFrame::CreateFrame("LumReview");
    layout_ = frame_->GetLayout();
  }
  void TearDown() override {
    QelApplicationFrame::DestroyFrame();
    QelDelayedDestruction::FlushIdle();
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), liveBefore_) << "the scenario leaked or left a cycle";
  }

  // A window of kind W on `editor`, listed in the layout; the layout holds it.
  template <class W>
  W* AddWindow(QelFrmEditor* editor) {
    auto window = QelMakeVar<W>(editor);
    layout_->AddWindow(window.get());
    return window.get();
  }
  static QelVar<QelFrmEditor> NewEditor() { return QelMakeVar<QelFrmEditor>(); }

  QelApplicationFrame* frame_ = nullptr;
  QelFrmLayout* layout_ = nullptr;
  int64_t liveBefore_ = 0;
};

// A plain counted object to stand for subscribers and model objects.
class FrameTestObject : public QelBaseUnknown {
 public:
  FrameTestObject() = default;

 protected:
  ~FrameTestObject() override = default;
};
inline QelBaseUnknown_var NewObject() { return QelBaseUnknown_var::Adopt(new FrameTestObject); }
