// The panel as a person sees it: the text form of a small panel before and after a
// person's clicks, compared with one golden file per case, and the JSON form of the same
// walk. QEL_UPDATE_GOLDEN=1 rewrites the golden files from the current output.
#include <nlohmann/json.hpp>

#include <fstream>
#include <sstream>

#include "QelRovFacetPropertyGroup.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidWidgetPrinter.h"
#include "WidgetTestDoubles.h"

namespace {
void ExpectGolden(const std::string& name, const std::string& actual) {
  const std::string path = std::string(QEL_SOURCE_DIR) + "/tests/widgets/golden/" + name + ".txt";
  if (QelGetEnv("QEL_UPDATE_GOLDEN") == "1") {
    std::ofstream(path) << actual;
    return;
  }
  std::ifstream in(path);
  ASSERT_TRUE(in) << "no golden file " << path << " (run with QEL_UPDATE_GOLDEN=1 to write it)";
  std::stringstream expected;
  expected << in.rdbuf();
  EXPECT_EQ(actual, expected.str()) << "golden file " << path;
}

class QelRovPanelTextForm : public PanelTest {
 protected:
  void SetUp() override {
    PanelTest::SetUp();
    all = Add("All sets", QelRovFacetProperty::FlagsRadio);
    Add("No set", QelRovFacetProperty::FlagsRadio);
    setA = Add("Set A");
    Add("Set B")->SetVisibleFlag(false);
    setC = Add("Set C");
    all->SetCheckState(Checked);
    setA->SetCheckState(Checked);
    facet->Name("Annotation sets");

    types = Make<RecordingFacet>(group.get());
    types->Name("Annotation types");
    auto kinds = Make<QelRovFacetPropertyGroup>(QelUnicodeString("Kinds"), QelUnicodeString(), types.get(), false);
    for (const char* name : {"Datums", "Welds"}) {
      auto kind = Make<TestProperty>(name, kinds.get());
      kinds->AddProperty(kind.get());
    }
    kinds->SetExpandedFlag(true);
    types->Add(kinds.get());
    auto tolerance = Make<TestProperty>("Tolerance", types.get());
    tolerance->SetFlags(QelRovFacetProperty::FlagsCheckBoxRange);
    tolerance->SetRangeMode(3);
    types->Add(tolerance.get());
    const double low = 0.05, high = 0.2;
    filter->SetToleranceValues(QelPropertyOperatorGreaterOrEqual, &low, QelPropertyOperatorLess, &high);
    group->SetFacets(facet.get(), types.get(), nullptr, filter.get());
    capture.Clear();

    panel = Make<RebuildingPanel>(std::vector<QelBaseUnknown*>{facet.get(), types.get()});
    panel->Rebuild();
  }
  QelVidCtlCheckButton* Box(int facetIndex, int row) {
    return dynamic_cast<QelVidCtlCheckButton*>(
        Row(panel->FacetWidget(facetIndex), row)->RetrieveSypNamedObject(QelString("CheckBox")));
  }

  QelVar<TestProperty> all, setA, setC;
  QelVar<RecordingFacet> types;
  QelVar<RebuildingPanel> panel;
};
}  // namespace

TEST_F(QelRovPanelTextForm, PanelAsBuilt) { ExpectGolden("panel_built", QelVidPrintText(panel.get())); }

TEST_F(QelRovPanelTextForm, ClickOnARowChangesTheRowTheFacetAndTheDisplayTogether) {
  ASSERT_TRUE(Box(0, 4)->Click());  // "Set C"
  EXPECT_EQ(setC->display, Checked);
  EXPECT_EQ(facet->applied.size(), 1u);
  // Collapse the types section and hover over "Set A".
  dynamic_cast<QelVidCtlExpander*>(panel->FacetWidget(1)->RetrieveSypNamedObject(QelString("ExpanderFacet")))
      ->Collapse();
  Row(panel->FacetWidget(0), 2)->RetrieveSypNamedObject(QelString("PropertyRow"))->MouseEnter();
  ExpectGolden("panel_after_click", QelVidPrintText(panel.get()));
  EXPECT_EQ(capture.Count(), 0);
}

TEST_F(QelRovPanelTextForm, JsonFormCarriesEveryWidgetWithItsState) {
  const nlohmann::json tree = nlohmann::json::parse(QelVidPrintJson(panel.get()));
  EXPECT_EQ(tree["name"], "Panel");
  const nlohmann::json& grid = tree["children"][0];
  EXPECT_EQ(grid["kind"], "Grid");
  const nlohmann::json& facet0 = grid["children"][0];
  EXPECT_EQ(facet0["class"], "QelRovRefinementFacet");
  const nlohmann::json& expander = facet0["children"][0];
  EXPECT_EQ(expander["kind"], "Expander");
  EXPECT_EQ(expander["attributes"]["text"], "Annotation sets");
  EXPECT_EQ(expander["expanded"], true);
  const nlohmann::json& rows = expander["children"][0]["children"];
  EXPECT_EQ(rows[3]["name"], "Annotation sets_Property3");
  EXPECT_EQ(rows[3]["visible"], false);
  EXPECT_EQ(rows[3]["takesRoom"], false);
  EXPECT_EQ(rows[4]["row"], 4);
  const nlohmann::json& line = rows[0]["children"][0];
  EXPECT_EQ(line["attributes"]["background"], nlohmann::json({255, 255, 255, 150}));
  EXPECT_EQ(line["children"][1]["attributes"]["checked"], 1);  // the radio of "All sets"
}
