// The facet widget: names, rows, hidden rows, alternation, the spacer and its weight,
// sub-property expanders, and a facet that is gone or empty.
#include "QelRovFacetPropertyGroup.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidSpacer.h"
#include "QelVidWidgetPrinter.h"
#include "WidgetTestDoubles.h"

using QelRovRefinementFacetTest = PanelTest;

TEST_F(QelRovRefinementFacetTest, ThreePropertiesGiveNamedRowsASpacerWithWeightAndAlternateRows) {
  for (const char* name : {"a", "b", "c"}) Add(name);
  auto widget = Build();
  auto* expander = dynamic_cast<QelVidCtlExpander*>(widget->RetrieveSypNamedObject(QelString("ExpanderFacet")));
  ASSERT_NE(expander, nullptr);
  EXPECT_EQ(expander->GetName().Str(), "Types");
  EXPECT_TRUE(expander->GetExpandedState());
  QelVidLayGrid* grid = widget->GetGrid();
  ASSERT_NE(grid, nullptr);
  for (int row = 0; row < 3; ++row) {
    QelRovRefinementProperty* p = Row(widget.get(), row);
    ASSERT_NE(p, nullptr);
    EXPECT_EQ(p->GetName().Str(), "Types_Property" + std::to_string(row));
    EXPECT_EQ(p->IsAlternate(), row == 1);
    EXPECT_EQ(p->GetKind(), QelRovRefinementProperty::KindSingleElement);
  }
  const auto lastRow = grid->GetWidgetsInRow(2);
  ASSERT_EQ(lastRow.size(), 2u);
  EXPECT_NE(dynamic_cast<QelVidSpacer*>(lastRow[1]), nullptr);
  QelVidGridConstraints spacerCell;
  ASSERT_TRUE(grid->GetConstraints(lastRow[1], spacerCell));
  EXPECT_EQ(spacerCell, (QelVidGridConstraints{0, 2, 1, 1, 1, 1, 1, 1}));
  EXPECT_DOUBLE_EQ(grid->GetRowWeight(2), 1.0);
  EXPECT_EQ(grid->GetRowCount(), 3);
  EXPECT_EQ(std::get<QelUnicodeString>(Read(widget.get(), "FacetIcon")), QelUnicodeString("QelTPSIcon_EmptyIcon.png"));
  EXPECT_EQ(std::get<QelUnicodeString>(Read(widget.get(), "FacetName")), QelUnicodeString("Types"));
  EXPECT_EQ(capture.Count(), 0);

  // The section's state lives in the facet: a person collapses it, a rebuild keeps it.
  expander->Collapse();
  bool expanded = true;
  facet->GetExpandedFlag(expanded);
  EXPECT_FALSE(expanded);
  auto rebuilt = Build();
  EXPECT_FALSE(dynamic_cast<QelVidCtlExpander*>(rebuilt->RetrieveSypNamedObject(QelString("ExpanderFacet")))
                   ->GetExpandedState());
  EXPECT_EQ(std::get<int>(Read(rebuilt.get(), "ExpandedFlag")), 0);
}

TEST_F(QelRovRefinementFacetTest, HiddenSecondRowTakesNoRoomAndDoesNotBreakTheAlternation) {
  for (const char* name : {"a", "b", "c", "d"}) Add(name);
  QelListValQelBaseUnknown_var properties;
  facet->GetProperties(properties);
  QelSysDynamicCast<QelRovFacetProperty>(properties[2].get())->SetVisibleFlag(false);
  auto widget = Build();
  QelVidLayGrid* grid = widget->GetGrid();
  for (int row = 0; row < 4; ++row) ASSERT_NE(Row(widget.get(), row), nullptr);
  EXPECT_FALSE(grid->RowTakesRoom(1));
  EXPECT_EQ(Row(widget.get(), 1)->GetVisibleFlag(), 0);
  EXPECT_TRUE(grid->RowTakesRoom(0) && grid->RowTakesRoom(2) && grid->RowTakesRoom(3));
  EXPECT_FALSE(Row(widget.get(), 0)->IsAlternate());
  EXPECT_TRUE(Row(widget.get(), 2)->IsAlternate());
  EXPECT_FALSE(Row(widget.get(), 3)->IsAlternate());
}

TEST_F(QelRovRefinementFacetTest, SubPropertiesGiveANamedExpanderWhoseClickReachesTheFacetWidget) {
  auto groupProperty =
      Make<QelRovFacetPropertyGroup>(QelUnicodeString("Group"), QelUnicodeString(), facet.get(), false);
  auto first = Make<TestProperty>("first", groupProperty.get());
  auto second = Make<TestProperty>("second", groupProperty.get());
  groupProperty->AddProperty(first.get());
  groupProperty->AddProperty(second.get());
  facet->Add(groupProperty.get());
  auto panel = Make<RebuildingPanel>(std::vector<QelBaseUnknown*>{facet.get()});
  panel->Rebuild();
  QelRovRefinementProperty* row = Row(panel->FacetWidget(0), 0);
  ASSERT_NE(row, nullptr);
  EXPECT_EQ(row->GetKind(), QelRovRefinementProperty::KindExpander);
  auto* expander = dynamic_cast<QelVidCtlExpander*>(row->RetrieveSypNamedObject(QelString("ExpanderProp")));
  ASSERT_NE(expander, nullptr);
  EXPECT_EQ(expander->GetName().Str(), "Group_Expander");
  EXPECT_FALSE(expander->GetExpandedState());
  ASSERT_NE(row->GetGrid(), nullptr);
  auto* body0 = dynamic_cast<QelRovRefinementProperty*>(row->GetGrid()->GetWidgetsInRow(0).at(0));
  auto* body1 = dynamic_cast<QelRovRefinementProperty*>(row->GetGrid()->GetWidgetsInRow(1).at(0));
  ASSERT_TRUE(body0 && body1);
  EXPECT_EQ(body0->GetName().Str(), "Group_Property0");
  EXPECT_EQ(body1->GetName().Str(), "Group_Property1");
  EXPECT_TRUE(body1->IsAlternate());

  expander->Expand();
  bool expanded = false;
  groupProperty->GetExpandedFlag(expanded);
  EXPECT_TRUE(expanded);

  // A person ticks the nested row: its event climbs to the outer row's handler, the facet
  // widget forwards it, and the panel rebuilds from the model.
  auto* box = dynamic_cast<QelVidCtlCheckButton*>(body1->RetrieveSypNamedObject(QelString("CheckBox")));
  ASSERT_NE(box, nullptr);
  const int rebuildsBefore = panel->rebuilds;
  EXPECT_TRUE(box->Click());
  EXPECT_EQ(panel->rebuilds, rebuildsBefore + 1);
  EXPECT_EQ(second->GetCheckState(), Checked);
  QelRovRefinementProperty* rebuiltRow = Row(panel->FacetWidget(0), 0);
  ASSERT_NE(rebuiltRow, nullptr);
  auto* rebuiltSecond = dynamic_cast<QelRovRefinementProperty*>(rebuiltRow->GetGrid()->GetWidgetsInRow(1).at(0));
  EXPECT_EQ(rebuiltSecond->GetCheckState(), 1);
  EXPECT_TRUE(dynamic_cast<QelVidCtlExpander*>(rebuiltRow->RetrieveSypNamedObject(QelString("ExpanderProp")))
                  ->GetExpandedState());
  // The group's row is new, its nested rows are the previous ones renewed, and the whole
  // prints as a section made from nothing.
  EXPECT_NE(rebuiltRow, row);
  EXPECT_EQ(rebuiltSecond, body1);
  EXPECT_EQ(QelVidPrintJson(panel->FacetWidget(0)), QelVidPrintJson(Build().get()));
  // The renewed nested row's events climb through its new group row: one click, one rebuild.
  EXPECT_TRUE(box->Click());
  EXPECT_EQ(panel->rebuilds, rebuildsBefore + 2);
  EXPECT_EQ(second->GetCheckState(), Unchecked);
  EXPECT_EQ(capture.Count(), 0);
}

TEST_F(QelRovRefinementFacetTest, RebuildAfterAClickRenewsRowsInPlaceAndPrintsAsAFreshBuild) {
  Add("a");
  auto hidden = Add("b");
  Add("c", QelRovFacetProperty::FlagsRadio);
  hidden->SetVisibleFlag(false);
  auto panel = Make<RebuildingPanel>(std::vector<QelBaseUnknown*>{facet.get()});
  panel->Rebuild();
  auto loose = Build();  // made without a parent: never retired, keeps its rows
  QelRovRefinementFacet* section = panel->FacetWidget(0);
  QelRovRefinementProperty* before[] = {Row(section, 0), Row(section, 1), Row(section, 2)};
  before[0]->RetrieveSypNamedObject(QelString("PropertyRow"))->MouseEnter();
  ASSERT_TRUE(before[0]->IsHovered());
  hidden->SetVisibleFlag(true);

  auto* box = dynamic_cast<QelVidCtlCheckButton*>(before[0]->RetrieveSypNamedObject(QelString("CheckBox")));
  ASSERT_NE(box, nullptr);
  EXPECT_TRUE(box->Click());
  EXPECT_EQ(panel->rebuilds, 2);
  QelRovRefinementFacet* rebuilt = panel->FacetWidget(0);
  ASSERT_NE(rebuilt, section);
  EXPECT_EQ(Row(rebuilt, 0), before[0]);
  EXPECT_FALSE(before[0]->IsHovered());
  EXPECT_NE(Row(rebuilt, 1), before[1]);  // it was hidden: a new row shows it
  EXPECT_EQ(Row(rebuilt, 2), before[2]);
  EXPECT_EQ(Row(rebuilt, 1)->IsAlternate(), true);
  EXPECT_EQ(Row(rebuilt, 2)->IsAlternate(), false);
  // Texts, states, colours and every attribute as a section made from nothing shows them.
  auto fresh = Build();
  EXPECT_EQ(QelVidPrintJson(rebuilt), QelVidPrintJson(fresh.get()));
  EXPECT_EQ(QelVidPrintText(rebuilt), QelVidPrintText(fresh.get()));
  EXPECT_EQ(loose->GetGrid()->GetChildCount(), 4);

  // The renewed row answers only to its new section: one click, one rebuild.
  EXPECT_TRUE(box->Click());
  EXPECT_EQ(panel->rebuilds, 3);
  EXPECT_EQ(Row(panel->FacetWidget(0), 0), before[0]);
  EXPECT_EQ(facet->statesAtApply, (std::vector<QelCheckState>{Checked, Unchecked}));
  EXPECT_EQ(capture.Count(), 0);
}

// A row is renewed only while its property lives: a property made where a gone one lay
// may have its address, and gets a new row of its own without a report.
TEST_F(QelRovRefinementFacetTest, ARowWhosePropertyIsGoneIsMadeAgainNotRenewed) {
  auto first = Add("first");
  auto panel = Make<RebuildingPanel>(std::vector<QelBaseUnknown*>{facet.get()});
  panel->Rebuild();
  auto section = QelVar<QelVidWidget>::Retain(panel->FacetWidget(0));  // kept: the rebuild may take its rows
  facet->Remove(first.get());
  first = nullptr;
  auto second = Add("second");
  panel->Rebuild();
  EXPECT_EQ(std::get<QelUnicodeString>(Read(Row(panel->FacetWidget(0), 0), "PropertyName")), QelUnicodeString("second"));
  EXPECT_EQ(capture.Count(), 0);
}

TEST_F(QelRovRefinementFacetTest, FacetWithoutPropertiesIsEmptyAndAFacetThatIsGoneIsReported) {
  auto widget = Build();
  EXPECT_EQ(widget->GetGrid()->GetChildCount(), 0);
  EXPECT_EQ(widget->GetGrid()->GetRowCount(), 0);

  facet = nullptr;
  group = nullptr;
  EXPECT_EQ(std::get<int>(Read(widget.get(), "ExpandedFlag")), 0);
  capture.Clear();
  EXPECT_EQ(widget->BuildPropertyWidgets(), E_UNEXPECTED);
  widget->OnExpanderCollapsed(nullptr, nullptr);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 2);

  auto orphan = Make<QelRovRefinementFacet>(nullptr, QelString("Facet9"), nullptr);
  EXPECT_EQ(orphan->GetChildCount(), 0);  // no style without a facet
  EXPECT_EQ(orphan->BuildPropertyWidgets(), E_UNEXPECTED);
}
