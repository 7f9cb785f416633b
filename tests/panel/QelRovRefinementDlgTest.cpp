// The dialog: rows of its sections and spacers when a section fails, rebuilding in place
// with the scroll kept, and its buttons reaching the group and the controller by name.
#include "PanelFixture.h"

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovRefinementDlg.h"
#include "QelRovRefinementFacet.h"
#include "QelRovRefinementProperty.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidLayGrid.h"
#include "QelVidWidgetPrinter.h"

namespace {
using DialogTest = PanelFixture;

std::vector<std::string> RowNames(QelVidLayGrid* grid) {
  std::vector<std::string> names;
  for (int row = 0; row < grid->GetRowCount(); ++row)
    for (QelVidWidget* w : grid->GetWidgetsInRow(row)) names.push_back(std::to_string(row) + ":" + w->GetName().Str());
  return names;
}

TEST_F(DialogTest, AFailingSectionIsLeftOutAndRebuildsKeepTheScroll) {
  QelAssertionCapture capture;
  auto group = Make<TestFacetGroup>(editor.get());
  auto first = Make<TestFacet>(group.get());
  auto notAFacet = Make<RecordingObserver>();
  auto third = Make<TestFacet>(group.get());
  QelListValQelBaseUnknown_var facets;
  facets.Append(static_cast<QelBaseUnknown*>(first.get()));
  facets.Append(static_cast<QelBaseUnknown*>(notAFacet.get()));
  facets.Append(static_cast<QelBaseUnknown*>(third.get()));
  auto dialog = Make<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), facets, editor.get());
  EXPECT_EQ(dialog->GetFacetGroup(), static_cast<QelRovFacetGroup*>(group.get()));

  ASSERT_EQ(dialog->BuildFacetWidgets(), S_OK);
  EXPECT_GE(capture.Count(kQelAssertKindBool), 1);
  QelVidLayGrid* grid = dialog->GetGrid();
  const std::vector<std::string> rows{"0:Facet0", "1:Spacer", "2:Facet2", "3:Spacer"};
  EXPECT_EQ(RowNames(grid), rows);
  EXPECT_EQ(grid->GetRowWeight(3), 1.0);
  EXPECT_EQ(grid->GetRowWeight(1), 0.0);
  EXPECT_EQ(grid->GetWidgetsInRow(1)[0]->GetMinimumDimension(), (QelVidPoint{10.0, 10.0}));

  dialog->GetScrollableArea()->SetHScrollOffset(5);
  dialog->GetScrollableArea()->SetVScrollOffset(70);
  dialog->SetRefreshButtonEnableFlag(1);
  EXPECT_EQ(dialog->GetCloseButton()->IsEnabled(), 1);
  dialog->RefreshFacetWidgets();
  dialog->RefreshFacetWidgets();
  EXPECT_EQ(RowNames(grid), rows);
  EXPECT_EQ(grid->GetChildCount(), 4);
  EXPECT_EQ(dialog->GetScrollableArea()->GetHScrollOffset(), 5);
  EXPECT_EQ(dialog->GetScrollableArea()->GetVScrollOffset(), 70);
  EXPECT_EQ(dialog->GetRefreshButtonEnableFlag(), 0);
  auto* refresh = dynamic_cast<QelVidCtlButton*>(dialog->RetrieveSypNamedObject(QelString("RefreshButton")));
  ASSERT_NE(refresh, nullptr);
  EXPECT_EQ(refresh->IsEnabled(), 0);  // the style binds it to the flag
}

// A rebuild after a click keeps, in every section, the rows it would make alike: plain
// rows and the nested rows of a group, whose own row is made again.
TEST_F(DialogTest, ARebuildKeepsTheRowsOfEverySectionItWouldMakeAlike) {
  auto group = Make<TestFacetGroup>(editor.get());
  auto plain = Make<TestFacet>(group.get());
  auto grouped = Make<TestFacet>(group.get());
  auto item = Make<QelRovFacetPropertyItem>(QelUnicodeString("item"), plain.get());
  plain->Add(item.get());
  auto kind = Make<QelRovFacetPropertyGroup>(QelUnicodeString("Kind"), QelUnicodeString(), grouped.get(), false);
  auto a = Make<QelRovFacetPropertyItem>(QelUnicodeString("a"), kind.get());
  auto b = Make<QelRovFacetPropertyItem>(QelUnicodeString("b"), kind.get());
  kind->AddProperty(a.get());
  kind->AddProperty(b.get());
  grouped->Add(kind.get());
  QelListValQelBaseUnknown_var facets;
  facets.Append(static_cast<QelBaseUnknown*>(plain.get()));
  facets.Append(static_cast<QelBaseUnknown*>(grouped.get()));
  auto dialog = Make<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), facets, editor.get());
  ASSERT_EQ(dialog->BuildFacetWidgets(), S_OK);

  auto firstRow = [&](int section) {
    auto* widget = dynamic_cast<QelRovRefinementFacet*>(dialog->GetGrid()->GetWidgetsInRow(2 * section).at(0));
    return dynamic_cast<QelRovRefinementProperty*>(widget->GetGrid()->GetWidgetsInRow(0).at(0));
  };
  auto rows = [&] {
    QelRovRefinementProperty* kindRow = firstRow(1);
    return std::vector<QelVidWidget*>{firstRow(0), kindRow, kindRow->GetGrid()->GetWidgetsInRow(0).at(0),
                                      kindRow->GetGrid()->GetWidgetsInRow(1).at(0)};
  };
  const std::vector<QelVidWidget*> before = rows();
  const std::string printed = QelVidPrintJson(dialog.get());
  dialog->RefreshFacetWidgets();
  const std::vector<QelVidWidget*> after = rows();
  EXPECT_EQ(after[0], before[0]);
  EXPECT_NE(after[1], before[1]);
  EXPECT_EQ(after[2], before[2]);
  EXPECT_EQ(after[3], before[3]);
  EXPECT_EQ(QelVidPrintJson(dialog.get()), printed);
}

// Items gone from the middle of a group: the rows of those after them are renewed where
// they now stand, not made again, and the panel reads as a fresh build would.
TEST_F(DialogTest, ARowFollowsItsPropertyWhenItemsBeforeItGo) {
  auto group = Make<TestFacetGroup>(editor.get());
  auto grouped = Make<TestFacet>(group.get());
  auto kind = Make<QelRovFacetPropertyGroup>(QelUnicodeString("Kind"), QelUnicodeString(), grouped.get(), false);
  std::vector<QelVar<QelRovFacetPropertyItem>> items;
  for (const char* name : {"a", "b", "c", "d"}) {
    items.push_back(Make<QelRovFacetPropertyItem>(QelUnicodeString(name), kind.get()));
    kind->AddProperty(items.back().get());
  }
  grouped->Add(kind.get());
  QelListValQelBaseUnknown_var facets;
  facets.Append(static_cast<QelBaseUnknown*>(grouped.get()));
  auto dialog = Make<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), facets, editor.get());
  ASSERT_EQ(dialog->BuildFacetWidgets(), S_OK);
  auto itemRows = [&] {
    auto* section = dynamic_cast<QelRovRefinementFacet*>(dialog->GetGrid()->GetWidgetsInRow(0).at(0));
    auto* kindRow = dynamic_cast<QelRovRefinementProperty*>(section->GetGrid()->GetWidgetsInRow(0).at(0));
    std::vector<QelVidWidget*> rows;
    for (int i = 0; i < kindRow->GetGrid()->GetRowCount(); ++i) rows.push_back(kindRow->GetGrid()->GetWidgetsInRow(i).at(0));
    return rows;
  };
  const std::vector<QelVidWidget*> before = itemRows();
  ASSERT_EQ(before.size(), 4u);

  kind->RemoveAllProperties();
  for (size_t i : {0u, 2u, 3u}) kind->AddProperty(items[i].get());
  dialog->RefreshFacetWidgets();
  const std::vector<QelVidWidget*> after = itemRows();
  ASSERT_EQ(after.size(), 3u);
  EXPECT_EQ(after[0], before[0]);
  EXPECT_EQ(after[1], before[2]) << "c's row moved up with it";
  EXPECT_EQ(after[2], before[3]);
  const std::string renewed = QelVidPrintJson(dialog.get());
  auto fresh = Make<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), facets, editor.get());
  ASSERT_EQ(fresh->BuildFacetWidgets(), S_OK);
  EXPECT_EQ(renewed, QelVidPrintJson(fresh.get()));
}

TEST_F(DialogTest, CloseReachesTheControllerEvenWithoutAFacetGroup) {
  QelRovFacetController* ctrl = Controller();
  WriteSetting("LumReview", 1, true);
  QelAssertionCapture capture;
  auto dialog = Make<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), QelListValQelBaseUnknown_var(),
                                          editor.get());
  EXPECT_EQ(dialog->GetFacetGroup(), nullptr);
  EXPECT_EQ(dialog->BuildFacetWidgets(), E_UNEXPECTED);
  capture.Clear();
  dialog->OnRefresh(nullptr, nullptr);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 1);

  ASSERT_TRUE(dialog->GetCloseButton()->Click());
  EXPECT_EQ(ctrl->ReadDataFilteringPanelSetting(QelString("LumReview")), 0);
}
}  // namespace
