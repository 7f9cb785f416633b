#include "QelFrmEditor.h"

#include <vector>

#include "FrameTestFixture.h"
#include "QelAssert.h"

namespace {

using EditorTest = FrameTest;

QelVar<QelPathElement> PathOf(std::initializer_list<QelBaseUnknown*> objects) {
  auto path = QelMakeVar<QelPathElement>();
  for (QelBaseUnknown* object : objects) path->AddChildElement(object);
  return path;
}

TEST_F(EditorTest, SelectionIsAnnouncedOnlyWhenItsContentChanges) {
  auto editor = NewEditor();
  auto x = NewObject(), y = NewObject();
  int changes = 0;
  frame_->AddCallback(editor->GetCSO(), kQelCSOChangeNotification, nullptr, [&](QelBaseUnknown* publisher, QelBaseUnknown* payload) {
    EXPECT_EQ(publisher, editor->GetCSO());
    EXPECT_EQ(payload, nullptr);
    ++changes;
  });
  QelListValQelBaseUnknown_var both;
  both.Append(x);
  both.Append(y);
  EXPECT_TRUE(editor->SetSelection(both));
  EXPECT_FALSE(editor->SetSelection(both));
  EXPECT_EQ(editor->GetCSO()->GetSize(), 2);
  EXPECT_TRUE(editor->SetSelection(y.get())) << "a shorter selection is a change";
  EXPECT_FALSE(editor->GetCSO()->SetSelection(y.get()));
  EXPECT_TRUE(editor->GetCSO()->Empty());
  EXPECT_FALSE(editor->GetCSO()->Empty());
  EXPECT_EQ(changes, 3);
}

TEST_F(EditorTest, UIActivePathChangeIsAnnouncedOnTheLayoutAndTheEditor) {
  auto editor = NewEditor();
  auto root = NewObject(), part = NewObject();
  std::vector<QelBaseUnknown*> onLayout;
  int onEditor = 0;
  frame_->AddCallback(layout_, kQelUIActiveObjectChanged, nullptr,
                      [&](QelBaseUnknown*, QelBaseUnknown* payload) { onLayout.push_back(payload); });
  frame_->AddCallback(editor.get(), kQelUIActiveObjectChanged, nullptr,
                      [&](QelBaseUnknown*, QelBaseUnknown*) { ++onEditor; });

  ASSERT_TRUE(editor->GetUIActivePath());
  EXPECT_EQ(editor->GetUIActivePath()->GetSize(), 0) << "nothing UI-active: an empty path, not null";

  auto path = PathOf({root.get(), part.get()});
  editor->SetUIActivePath(path.get());
  editor->SetUIActivePath(PathOf({root.get(), part.get()}).get());  // the same objects
  path->AddChildElement(NewObject().get());
  EXPECT_EQ(editor->GetUIActivePath()->GetSize(), 2) << "the editor keeps its own copy";
  editor->GetUIActivePath()->AddChildElement(root.get());
  EXPECT_EQ(editor->GetUIActivePath()->GetSize(), 2) << "and hands out copies";
  editor->SetUIActivePath(nullptr);
  EXPECT_EQ(onLayout, (std::vector<QelBaseUnknown*>{editor.get(), editor.get()}));
  EXPECT_EQ(onEditor, 2);
}

TEST_F(EditorTest, PathCursorWalksFromTheLeafTowardsTheRoot) {
  auto root = NewObject(), part = NewObject(), leaf = NewObject();
  auto path = PathOf({root.get(), part.get(), leaf.get()});
  EXPECT_EQ(path->GetSize(), 3);
  EXPECT_EQ((*path)[0].get(), root.get());
  EXPECT_EQ((*path)[3].get(), nullptr);
  EXPECT_EQ((*path)[-1].get(), nullptr);
  EXPECT_EQ(path->NextFatherElement().get(), nullptr) << "no cursor before InitToLeafElement";

  auto copy = path->Copy();
  copy->InitToLeafElement();
  EXPECT_EQ(copy->NextFatherElement().get(), leaf.get());
  EXPECT_EQ(copy->NextFatherElement().get(), part.get());
  EXPECT_EQ(copy->NextFatherElement().get(), root.get());
  EXPECT_EQ(copy->NextFatherElement().get(), nullptr);
  EXPECT_EQ(path->NextFatherElement().get(), nullptr) << "the copy has its own cursor";
  path->InitToRootElement();
  EXPECT_EQ(path->NextChildElement().get(), root.get());

  auto empty = QelMakeVar<QelPathElement>();
  empty->InitToLeafElement();
  EXPECT_EQ(empty->NextFatherElement().get(), nullptr);
  EXPECT_EQ(empty->GetLeaf().get(), nullptr);
}

TEST_F(EditorTest, NullPathElementIsABrokenContractAndIsNotAdded) {
  QelAssertionCapture capture;
  auto path = QelMakeVar<QelPathElement>();
  path->AddChildElement(nullptr);
  EXPECT_EQ(path->GetSize(), 0);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 1);
}

TEST_F(EditorTest, EditorReleasesRootSelectionAndPathWhenItGoes) {
  QelBaseUnknown_WR rootWeak, selectedWeak, csoWeak;
  {
    auto root = NewObject(), selected = NewObject();
    rootWeak = root.get();
    selectedWeak = selected.get();
    auto editor = QelMakeVar<QelFrmEditor>(root.get());
    csoWeak = editor->GetCSO();
    editor->SetSelection(selected.get());
    editor->SetUIActivePath(PathOf({root.get(), selected.get()}).get());
    EXPECT_EQ(editor->GetRootObject().get(), root.get());
  }
  EXPECT_FALSE(rootWeak.IsAlive());
  EXPECT_FALSE(selectedWeak.IsAlive());
  EXPECT_FALSE(csoWeak.IsAlive());
}

}  // namespace
