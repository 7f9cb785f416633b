// The dialog: rows of its sections and spacers when a section fails, rebuilding in place
// with the scroll kept, and its buttons reaching the group and the controller by name.
#include "PanelFixture.h"

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelRovRefinementDlg.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidLayGrid.h"

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
