// Grid layout and the controls' own state: rows, weights, room taken by hidden widgets,
// combo lines and selection, expander and editor events raised only by a person.
#include <gtest/gtest.h>

#include "QelSYPEventHandler.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidLayGrid.h"
#include "QelVidSpacer.h"

namespace {
class Counter final : public QelSYPEventHandler {
 public:
  void HandleEvent(QelVidWidget*, QelBaseUnknown*) override { ++count; }
  int count = 0;

 private:
  ~Counter() override = default;
};
}  // namespace

TEST(QelVidLayGrid, RowsWeightsAndRoomOfHiddenWidgets) {
  auto grid = QelMakeVar<QelVidLayGrid>(nullptr, QelString("g"));
  auto a = QelMakeVar<QelVidWidget>(nullptr, QelString("a"));
  auto b = QelMakeVar<QelVidWidget>(nullptr, QelString("b"));
  auto spacer = QelMakeVar<QelVidSpacer>();
  EXPECT_EQ(grid->AddWidget(a.get(), {0, 0, 1, 1, 1, 1, 1, 0}), 1);
  EXPECT_EQ(grid->AddWidget(b.get(), {0, 1, 1, 1, 1, 1, 1, 0}), 1);
  EXPECT_EQ(grid->AddWidget(spacer.get(), {0, 1, 1, 1, 1, 1, 1, 1}), 1);
  EXPECT_EQ(grid->AddWidget(spacer.get(), {0, -1, 1, 1, 1, 1, 1, 1}), 0);  // refused, still in row 1
  EXPECT_TRUE(grid->SetRowWeight(1, 1.0));
  EXPECT_FALSE(grid->SetRowWeight(-1, 1.0));
  EXPECT_EQ(grid->GetRowCount(), 2);
  EXPECT_EQ(grid->GetWidgetsInRow(1), (std::vector<QelVidWidget*>{b.get(), spacer.get()}));
  EXPECT_DOUBLE_EQ(grid->GetRowWeight(1), 1.0);
  EXPECT_DOUBLE_EQ(grid->GetRowWeight(0), 0.0);
  EXPECT_EQ(a->GetParent(), grid.get());

  a->SetVisibleFlag(0);
  EXPECT_TRUE(grid->RowTakesRoom(0));  // hidden but keeps its room
  a->SetLayoutWhenUnvisibleFlag(0);
  EXPECT_FALSE(grid->RowTakesRoom(0));

  EXPECT_EQ(grid->RemoveWidget(a.get()), 1);
  EXPECT_EQ(grid->RemoveWidget(a.get()), 0);
  EXPECT_EQ(a->GetParent(), nullptr);
  EXPECT_EQ(grid->GetChildCount(), 2);
}

TEST(QelVidControls, StateFromCodeRaisesNothingAndAPersonsActionRaisesItsEvent) {
  auto combo = QelMakeVar<QelVidCtlImageAndLabelCombo>(nullptr, QelString("c"));
  auto expander = QelMakeVar<QelVidCtlExpander>(nullptr, QelString("e"));
  auto editor = QelMakeVar<QelVidCtlLineEditor>(nullptr, QelString("l"));
  auto button = QelMakeVar<QelVidCtlButton>(nullptr, QelString("b"));
  auto counter = QelMakeVar<Counter>();
  combo->AddHandler(combo->FindEvent("SelectionChanged"), counter.get(), 0);
  expander->AddHandler(expander->FindEvent("Expanded"), counter.get(), 0);
  expander->AddHandler(expander->FindEvent("Collapsed"), counter.get(), 0);
  editor->AddHandler(editor->FindEvent("TextEntered"), counter.get(), 0);
  button->AddHandler(button->FindEvent("Clicked"), counter.get(), 0);

  for (const char* line : {"=", "<", "<="}) combo->SetLine(QelUnicodeString(line), nullptr, -1, 0);
  EXPECT_EQ(combo->SetLine(QelUnicodeString("x"), nullptr, 7, 0), -1);
  EXPECT_TRUE(combo->SetSelectedIndex(2));
  EXPECT_FALSE(combo->SetSelectedIndex(3));
  EXPECT_EQ(combo->GetSelectedIndex(), 2);
  expander->SetExpandedState(false);
  editor->SetText(QelUnicodeString("1.5"));
  EXPECT_EQ(counter->count, 0);

  EXPECT_TRUE(combo->Select(1));
  expander->Expand();
  expander->Collapse();
  EXPECT_TRUE(editor->Enter(QelUnicodeString("2")));
  EXPECT_TRUE(button->Click());
  EXPECT_EQ(counter->count, 5);
  EXPECT_EQ(combo->TextAttribute("selected"), QelUnicodeString("<"));
  EXPECT_FALSE(expander->GetExpandedState());

  button->SetEnabled(0);
  editor->SetEnabled(0);
  EXPECT_FALSE(button->Click());
  EXPECT_FALSE(editor->Enter(QelUnicodeString("3")));
  EXPECT_EQ(editor->GetText(), QelUnicodeString("2"));
  combo->ClearLines();
  EXPECT_EQ(combo->GetSelectedIndex(), -1);
  EXPECT_EQ(counter->count, 5);
}

TEST(QelVidWidget, AttributesKeepTheirOrderAndValuesAcrossGrowth) {
  auto w = QelMakeVar<QelVidWidget>(nullptr, QelString("w"));
  w->SetAttribute("a", 1);
  w->SetAttribute("b", QelUnicodeString("long enough to live outside a short string"));
  w->SetAttribute("c", 2.5);
  // The fourth attribute outgrows the room inside the widget while its value is read
  // from one of the attributes that move.
  w->SetAttribute("d", w->GetAttributes().begin()[1].value);
  w->SetAttribute("a", 3);
  std::string order;
  for (const QelVidAttribute& attribute : w->GetAttributes()) order += attribute.Name();
  EXPECT_EQ(order, "abcd");
  EXPECT_EQ(w->IntAttribute("a", 0), 3);
  EXPECT_EQ(w->TextAttribute("d"), QelUnicodeString("long enough to live outside a short string"));
  EXPECT_EQ(w->TextAttribute("b"), w->TextAttribute("d"));
  EXPECT_EQ(QelVidAttributeName("d"), w->GetAttributes().begin()[3].name);
}
