// The range row: reading the filter data into the combos and values, a person's edits,
// the range button, and the pending range stored by a check.
#include "QelVidCtlButton.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "WidgetTestDoubles.h"

namespace {
class QelRovRefinementRangeTest : public PanelTest {
 protected:
  // A range property checked or not, the filter data holding (leftOp left, rightOp right).
  QelRovRefinementProperty* BuildRange(bool checked, QelPropertyOperator leftOp, double left,
                                       QelPropertyOperator rightOp, double right) {
    range = Add("Tolerance", QelRovFacetProperty::FlagsCheckBoxRange);
    range->SetCheckState(checked ? Checked : Unchecked);
    filter->SetToleranceValues(leftOp, &left, rightOp, &right);
    widget = Build();
    QelRovRefinementProperty* row = Row(widget.get(), 0);
    EXPECT_NE(row, nullptr);
    return row;
  }
  template <class T>
  static T* Part(QelRovRefinementProperty* row, const char* name) {
    return dynamic_cast<T*>(row->RetrieveSypNamedObject(QelString(name)));
  }
  void Stored(QelPropertyOperator& leftOp, double& left, QelPropertyOperator& rightOp, double& right) {
    double* l = nullptr;
    double* r = nullptr;
    filter->GetToleranceValues(leftOp, l, rightOp, r);
    left = l ? *l : -1.0;
    right = r ? *r : -1.0;
  }

  QelVar<TestProperty> range;
  QelVar<QelRovRefinementFacet> widget;
};
}  // namespace

TEST_F(QelRovRefinementRangeTest, FilterDataSelectTheOperatorsAndShowTheValues) {
  QelRovRefinementProperty* row =
      BuildRange(false, QelPropertyOperatorGreater, 1.5, QelPropertyOperatorLessOrEqual, 2.5);
  EXPECT_EQ(row->GetKind(), QelRovRefinementProperty::KindRange);
  auto* left = Part<QelVidCtlImageAndLabelCombo>(row, "LeftCombo");
  auto* right = Part<QelVidCtlImageAndLabelCombo>(row, "RightCombo");
  ASSERT_TRUE(left && right);
  EXPECT_EQ(left->GetLineCount(), 3);
  EXPECT_EQ(right->GetLineCount(), 2);
  EXPECT_EQ(left->GetLine(left->GetSelectedIndex()), QelUnicodeString("<"));
  EXPECT_EQ(right->GetLine(right->GetSelectedIndex()), QelUnicodeString("<="));
  EXPECT_EQ(std::get<QelUnicodeString>(Read(row, "LeftValue")), QelUnicodeString("1.5"));
  EXPECT_EQ(std::get<QelUnicodeString>(Read(row, "RightValue")), QelUnicodeString("2.5"));
  EXPECT_EQ(std::get<int>(Read(row, "RightPartEnableFlag")), 1);
  EXPECT_EQ(std::get<int>(Read(row, "RangeButtonEnableFlag")), 0);  // nothing pending
  EXPECT_EQ(Part<QelVidCtlLineEditor>(row, "LeftEditor")->GetText(), QelUnicodeString("1.5"));
  EXPECT_EQ(Part<QelVidCtlLineEditor>(row, "RightEditor")->GetText(), QelUnicodeString("2.5"));
  EXPECT_TRUE(row->IsRangeApplied());
  EXPECT_EQ(capture.Count(), 0);
}

TEST_F(QelRovRefinementRangeTest, EqualOnTheLeftSendsTheLeftValueAsTheUpperOneAndDisablesTheRightPart) {
  QelRovRefinementProperty* row = BuildRange(true, QelPropertyOperatorGreater, 1.0, QelPropertyOperatorLess, 5.0);
  ASSERT_TRUE(Part<QelVidCtlImageAndLabelCombo>(row, "LeftCombo")->Select(0));
  EXPECT_EQ(Part<QelVidCtlImageAndLabelCombo>(row, "RightCombo")->IsEnabled(), 0);
  EXPECT_EQ(Part<QelVidCtlLineEditor>(row, "RightEditor")->IsEnabled(), 0);
  ASSERT_TRUE(Part<QelVidCtlLineEditor>(row, "LeftEditor")->Enter(QelUnicodeString("2")));
  auto* apply = Part<QelVidCtlButton>(row, "RangeButton");
  EXPECT_EQ(apply->IsEnabled(), 1);
  ASSERT_TRUE(apply->Click());
  QelPropertyOperator leftOp, rightOp;
  double left, right;
  Stored(leftOp, left, rightOp, right);
  EXPECT_EQ(leftOp, QelPropertyOperatorEqual);
  EXPECT_DOUBLE_EQ(left, 2.0);
  EXPECT_EQ(rightOp, QelPropertyOperatorLess);
  EXPECT_DOUBLE_EQ(right, 2.0);
  EXPECT_EQ(apply->IsEnabled(), 0);
  EXPECT_EQ(facet->applied.size(), 1u);  // the property told its facet
}

TEST_F(QelRovRefinementRangeTest, InconsistentRangeDisablesTheButtonAndIsNotStoredByACheck) {
  QelRovRefinementProperty* row = BuildRange(false, QelPropertyOperatorGreater, 1.0, QelPropertyOperatorLess, 5.0);
  Part<QelVidCtlLineEditor>(row, "LeftEditor")->Enter(QelUnicodeString("3"));
  Part<QelVidCtlLineEditor>(row, "RightEditor")->Enter(QelUnicodeString("2"));
  EXPECT_EQ(std::get<int>(Read(row, "RangeButtonEnableFlag")), 0);
  row->SetChecked(1);
  QelPropertyOperator leftOp, rightOp;
  double left, right;
  Stored(leftOp, left, rightOp, right);
  EXPECT_DOUBLE_EQ(left, 1.0);
  EXPECT_DOUBLE_EQ(right, 5.0);
  EXPECT_EQ(range->GetCheckState(), Checked);
}

TEST_F(QelRovRefinementRangeTest, PendingValidRangeIsStoredBeforeTheCheckChangesAndAZeroOneIsNot) {
  QelRovRefinementProperty* row = BuildRange(false, QelPropertyOperatorGreater, 1.0, QelPropertyOperatorLess, 5.0);
  Part<QelVidCtlImageAndLabelCombo>(row, "LeftCombo")->Select(0);
  Part<QelVidCtlLineEditor>(row, "LeftEditor")->Enter(QelUnicodeString("1.5"));
  EXPECT_EQ(std::get<int>(Read(row, "RangeButtonEnableFlag")), 0);  // not checked yet
  row->SetChecked(1);
  QelPropertyOperator leftOp, rightOp;
  double left, right;
  Stored(leftOp, left, rightOp, right);
  EXPECT_EQ(leftOp, QelPropertyOperatorEqual);
  EXPECT_DOUBLE_EQ(left, 1.5);
  EXPECT_DOUBLE_EQ(right, 1.5);
  // The range reached the facet while the property was still unchecked.
  EXPECT_EQ(facet->statesAtApply, (std::vector<QelCheckState>{Unchecked, Checked}));

  // A pending 0 enables the button of a checked row but is not stored by a check.
  facet->statesAtApply.clear();
  BuildRange(true, QelPropertyOperatorGreater, 1.0, QelPropertyOperatorLess, 5.0);
  QelRovRefinementProperty* checkedRow = Row(widget.get(), 1);
  ASSERT_NE(checkedRow, nullptr);
  Part<QelVidCtlImageAndLabelCombo>(checkedRow, "LeftCombo")->Select(0);
  Part<QelVidCtlLineEditor>(checkedRow, "LeftEditor")->Enter(QelUnicodeString("0"));
  EXPECT_EQ(std::get<int>(Read(checkedRow, "RangeButtonEnableFlag")), 1);
  checkedRow->SetChecked(0);
  Stored(leftOp, left, rightOp, right);
  EXPECT_DOUBLE_EQ(left, 1.0);
  EXPECT_EQ(facet->statesAtApply, (std::vector<QelCheckState>{Unchecked}));
}

TEST_F(QelRovRefinementRangeTest, TextThatIsNotANumberKeepsTheValueAndMarksTheRangePending) {
  QelRovRefinementProperty* row = BuildRange(true, QelPropertyOperatorGreater, 1.5, QelPropertyOperatorLess, 5.0);
  Part<QelVidCtlLineEditor>(row, "LeftEditor")->Enter(QelUnicodeString("1.5mm"));
  EXPECT_DOUBLE_EQ(row->GetLeftNumber(), 1.5);
  EXPECT_FALSE(row->IsRangeApplied());
  EXPECT_EQ(std::get<int>(Read(row, "RangeButtonEnableFlag")), 1);
  // An editor event whose origin is no editor is reported and changes nothing.
  auto args = QelMakeVar<QelSYPEventArgs>(QelVidCtlLineEditor::TextEnteredEvent());
  args->SetOrigin(row);
  row->RightEditorEvent(nullptr, args.get());
  row->LeftEditorEvent(nullptr, nullptr);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 2);
  EXPECT_DOUBLE_EQ(row->GetRightNumber(), 5.0);
}
