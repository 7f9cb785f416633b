#include "QelFrmLayout.h"

#include <string>
#include <utility>
#include <vector>

#include "FrameTestFixture.h"

namespace {

using LayoutTest = FrameTest;

TEST_F(LayoutTest, WindowListKeepsOrderAndFiltersByEditorAndKind) {
  auto first = NewEditor(), second = NewEditor();
  QelFrmWindow* a = AddWindow<Qel3DWindow>(first.get());
  QelFrmWindow* b = AddWindow<Qel2DLWindow>(second.get());
  QelFrmWindow* c = AddWindow<Qel3DWindow>(second.get());
  EXPECT_EQ(layout_->AddWindow(a), S_FALSE);

  QelListValQelBaseUnknown_var all = layout_->GetWindowList(0, 0);
  ASSERT_EQ(all.Size(), 3);
  EXPECT_EQ(all[1].get(), a);
  EXPECT_EQ(all[3].get(), c);
  QelListValQelBaseUnknown_var ofSecond = layout_->GetWindowList(second.get());
  ASSERT_EQ(ofSecond.Size(), 2);
  EXPECT_EQ(ofSecond[1].get(), b);
  QelListValQelBaseUnknown_var threeD = layout_->GetWindowList(nullptr, "Qel3DWindow");
  EXPECT_EQ(threeD.Size(), 2);
  EXPECT_EQ(layout_->GetWindowList(first.get(), "Qel2DLWindow").Size(), 0);
}

TEST_F(LayoutTest, ActivationIsAnnouncedOnceAndTheCurrentEditorFollows) {
  auto first = NewEditor(), second = NewEditor();
  QelFrmWindow* a = AddWindow<Qel3DWindow>(first.get());
  QelFrmWindow* b = AddWindow<Qel3DWindow>(second.get());
  EXPECT_EQ(QelFrmEditor::GetCurrentEditor(), nullptr);

  std::vector<QelBaseUnknown*> activated;
  auto subscriber = NewObject();
  frame_->AddCallback(layout_, kQelWindowActivated, subscriber.get(),
                      [&](QelBaseUnknown* publisher, QelBaseUnknown* window) {
                        EXPECT_EQ(publisher, layout_);
                        EXPECT_EQ(layout_->GetCurrentWindow(), window) << "announced after the change";
                        activated.push_back(window);
                      });
  EXPECT_EQ(layout_->SetCurrentWindow(a), S_OK);
  EXPECT_EQ(layout_->SetCurrentWindow(a), S_FALSE);
  EXPECT_EQ(QelFrmEditor::GetCurrentEditor(), first.get());
  EXPECT_EQ(layout_->SetCurrentWindow(b), S_OK);
  EXPECT_EQ(QelFrmEditor::GetCurrentEditor(), second.get());
  auto stranger = QelMakeVar<Qel3DWindow>(first.get());
  EXPECT_EQ(layout_->SetCurrentWindow(stranger.get()), E_FAIL) << "a window outside the layout";
  EXPECT_EQ(activated, (std::vector<QelBaseUnknown*>{a, b}));
  EXPECT_EQ(frame_->RemoveCallbacksOn(layout_, subscriber.get()), 1);
}

TEST_F(LayoutTest, ClosingAnEditorDropsOnlyItsWindowsAnnouncesItThenActivatesAnother) {
  auto kept = NewEditor(), closing = NewEditor();
  QelFrmWindow* keptWindow = AddWindow<Qel3DWindow>(kept.get());
  QelFrmWindow* closingWindow = AddWindow<Qel3DWindow>(closing.get());
  AddWindow<Qel2DLWindow>(closing.get());
  layout_->SetCurrentWindow(closingWindow);
  QelBaseUnknown_WR closingWindowWeak(closingWindow);

  std::vector<std::string> events;
  auto subscriber = NewObject();
  frame_->AddCallback(layout_, kQelEditorCloseEnded, subscriber.get(), [&](QelBaseUnknown*, QelBaseUnknown* editor) {
    events.push_back(editor == closing.get() ? "closed" : "closed-other");
    EXPECT_TRUE(closing->IsClosed());
    EXPECT_EQ(layout_->GetWindowList(closing.get()).Size(), 0);
  });
  frame_->AddCallback(layout_, kQelWindowActivated, subscriber.get(), [&](QelBaseUnknown*, QelBaseUnknown* window) {
    events.push_back(window == keptWindow ? "activated-kept" : "activated-other");
  });

  EXPECT_EQ(layout_->CloseEditor(closing.get()), S_OK);
  EXPECT_EQ(events, (std::vector<std::string>{"closed", "activated-kept"}));
  EXPECT_EQ(layout_->GetWindowList().Size(), 1);
  EXPECT_EQ(QelFrmEditor::GetCurrentEditor(), kept.get());
  EXPECT_FALSE(closingWindowWeak.IsAlive()) << "the layout held the only reference";
  EXPECT_EQ(layout_->CloseEditor(closing.get()), S_FALSE);
  EXPECT_EQ(events.size(), 2u);
}

// The controller and facet groups unsubscribe from inside notifications; these prove the
// frame's notifications survive that.
TEST_F(LayoutTest, RemovingTheCurrentWindowHandsOverToTheLastRemainingOne) {
  auto editor = NewEditor();
  QelFrmWindow* a = AddWindow<Qel3DWindow>(editor.get());
  QelFrmWindow* b = AddWindow<Qel3DWindow>(editor.get());
  layout_->SetCurrentWindow(b);
  EXPECT_EQ(layout_->RemoveWindow(b), S_OK);
  EXPECT_EQ(layout_->GetCurrentWindow(), a);
  EXPECT_EQ(layout_->RemoveWindow(a), S_OK);
  EXPECT_EQ(layout_->GetCurrentWindow(), nullptr);
  EXPECT_EQ(QelFrmEditor::GetCurrentEditor(), nullptr);
}

}  // namespace
