// The property row: what its properties read, a click the property refuses, hover
// colours, and a style sheet without the row's style.
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "QelSYPEventHandler.h"
#include "QelSYPMetaClass.h"
#include "QelToolkitCheck.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidStyleSheet.h"
#include "WidgetTestDoubles.h"

namespace {
class EventCounter final : public QelSYPEventHandler {
 public:
  void HandleEvent(QelVidWidget*, QelBaseUnknown* args) override {
    ++count;
    auto* a = dynamic_cast<QelSYPEventArgs*>(args);
    origin = a ? a->GetOrigin() : nullptr;
  }
  int count = 0;
  QelBaseUnknown* origin = nullptr;

 private:
  ~EventCounter() override = default;
};

QelVidColor Color(const QelSYPValue& v) { return std::get<QelVidColor>(v); }
}  // namespace

using QelRovRefinementPropertyTest = PanelTest;

TEST_F(QelRovRefinementPropertyTest, PropertiesReadTheModelAndShowInTheParts) {
  auto box = Add("Box");
  auto radio = Add("Radio", QelRovFacetProperty::FlagsRadio);
  auto icon = Make<IconProperty>("Icon", facet.get(), "normal\\I_Set");
  facet->Add(icon.get());
  box->SetCheckState(Checked);
  auto widget = Build();
  QelRovRefinementProperty* boxRow = Row(widget.get(), 0);
  QelRovRefinementProperty* radioRow = Row(widget.get(), 1);
  QelRovRefinementProperty* iconRow = Row(widget.get(), 2);

  EXPECT_EQ(std::get<int>(Read(boxRow, "CheckState")), 1);
  EXPECT_EQ(std::get<int>(Read(boxRow, "CheckBoxVisibility")), 1);
  EXPECT_EQ(std::get<int>(Read(boxRow, "RadioVisibility")), 0);
  EXPECT_EQ(std::get<int>(Read(radioRow, "CheckBoxVisibility")), 0);
  EXPECT_EQ(std::get<int>(Read(radioRow, "RadioVisibility")), 1);
  EXPECT_EQ(std::get<int>(Read(boxRow, "IconVisibility")), 0);
  EXPECT_EQ(std::get<QelUnicodeString>(Read(boxRow, "Icon")), QelUnicodeString());
  EXPECT_EQ(std::get<int>(Read(iconRow, "IconVisibility")), 1);
  EXPECT_EQ(std::get<QelUnicodeString>(Read(iconRow, "Icon")), QelUnicodeString("normal\\I_Set"));
  EXPECT_EQ(std::get<QelUnicodeString>(Read(radioRow, "PropertyName")), QelUnicodeString("Radio"));

  // The parts follow: the radio row shows a radio and no check box.
  EXPECT_EQ(radioRow->RetrieveSypNamedObject(QelString("CheckBox"))->GetVisibleFlag(), 0);
  EXPECT_EQ(radioRow->RetrieveSypNamedObject(QelString("RadioButton"))->GetVisibleFlag(), 1);
  EXPECT_EQ(iconRow->RetrieveSypNamedObject(QelString("PropertyIcon"))->GetVisibleFlag(), 1);
  EXPECT_EQ(boxRow->RetrieveSypNamedObject(QelString("PropertyLabel"))->TextAttribute("text"),
            QelUnicodeString("Box"));

  const QelSYPMetaClass* meta = boxRow->GetSYPMetaClass();
  ASSERT_NE(meta, nullptr);
  for (const char* readOnly : {"LineColor", "IconVisibility", "RangeButtonEnableFlag", "LeftValue", "Icon"})
    EXPECT_TRUE(meta->FindProperty(readOnly)->readOnly) << readOnly;
  EXPECT_FALSE(meta->FindProperty("CheckState")->readOnly);
  EXPECT_EQ(meta->FindProperty("LineColor")->type, "QelVidColor");
  EXPECT_EQ(meta->GetProperties().size(), 13u);
  EXPECT_EQ(meta->GetHandlers().size(), 10u);
  EXPECT_EQ(boxRow->GetResourceFilename(0).Str(), "QelRovRefinementProperty");
  EXPECT_EQ(boxRow->GetResourceFilename(1).Str(), "QelVidCtl");
  EXPECT_EQ(capture.Count(), 0);

  // A row that outlives its property shows nothing it read before and says it is gone.
  facet->Remove(icon.get());
  icon = nullptr;
  EXPECT_EQ(std::get<int>(Read(iconRow, "IconVisibility")), 0);
  EXPECT_EQ(std::get<QelUnicodeString>(Read(iconRow, "Icon")), QelUnicodeString());
  EXPECT_EQ(std::get<int>(Read(iconRow, "CheckBoxVisibility")), 0);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 3);
}

TEST_F(QelRovRefinementPropertyTest, ClickOnACheckedRadioRaisesTheEventWhileThePropertyRefuses) {
  auto radio = Add("Radio", QelRovFacetProperty::FlagsRadio);
  radio->SetCheckState(Checked);
  auto widget = Build();
  QelRovRefinementProperty* row = Row(widget.get(), 0);
  auto counter = QelMakeVar<EventCounter>();
  row->AddHandler(QelRovRefinementProperty::SendPropEvent(), counter.get(), 0);
  auto* button = dynamic_cast<QelVidCtlCheckButton*>(row->RetrieveSypNamedObject(QelString("RadioButton")));
  ASSERT_NE(button, nullptr);
  EXPECT_EQ(button->GetCheckState(), 1);
  EXPECT_TRUE(button->Click());
  EXPECT_EQ(counter->count, 1);
  EXPECT_EQ(counter->origin, static_cast<QelBaseUnknown*>(row));
  EXPECT_EQ(radio->GetCheckState(), Checked);  // a radio is left only by choosing another
  EXPECT_TRUE(facet->applied.empty());
  auto rebuilt = Build();
  EXPECT_EQ(std::get<int>(Read(Row(rebuilt.get(), 0), "CheckState")), 1);
}

TEST_F(QelRovRefinementPropertyTest, HoverSetsTheHoverColoursAndLeavingRestoresThePaletteOnes) {
  Add("a");
  Add("b");
  auto widget = Build();
  QelRovRefinementProperty* alternate = Row(widget.get(), 1);
  QelVidWidget* line = alternate->RetrieveSypNamedObject(QelString("PropertyRow"));
  const QelVidColor shade(0.1, 150, QelVidPalette::ColorRole(1), QelVidPalette::ColorRole(2));
  EXPECT_EQ(Color(line->GetAttribute("background")), shade);
  line->MouseEnter();
  EXPECT_TRUE(alternate->IsHovered());
  EXPECT_EQ(Color(line->GetAttribute("background")), QelVidColor(106, 158, 190, 100));
  EXPECT_EQ(Color(line->GetAttribute("border")), QelVidColor(33, 110, 159, 120));
  line->MouseLeave();
  EXPECT_EQ(Color(line->GetAttribute("background")), shade);
  EXPECT_EQ(Color(Read(alternate, "BorderColor")), QelVidColor(0.0, 0, QelVidPalette::Base, QelVidPalette::Text));
  EXPECT_EQ(Color(Read(Row(widget.get(), 0), "LineColor")), QelVidColor(255, 255, 255, 150));
}

TEST_F(QelRovRefinementPropertyTest, SheetWithoutTheRangeStyleLeavesTheRowOutWithoutACrash) {
  namespace fs = std::filesystem;
  const fs::path dir = fs::temp_directory_path() / ("qel-widgets-" + std::to_string(::getpid()));
  fs::create_directories(dir / "styles");
  const fs::path shipped = fs::path(QEL_SOURCE_DIR) / "host/resources/styles";
  fs::copy_file(shipped / "QelRovRefinementFacet.sypstyle", dir / "styles/QelRovRefinementFacet.sypstyle",
                fs::copy_options::overwrite_existing);
  std::ofstream(dir / "styles/QelRovRefinementProperty.sypstyle")
      << R"({"styles": {"SingleElementStyle": {"template": {"kind": "Frame"}}}})";
  ::setenv("QEL_RESOURCES_DIR", dir.c_str(), 1);
  QelVidStyleSheet::ClearCache();
  QelVidStyleSheet::TakeDiagnostics();

  Add("plain");
  Add("range", QelRovFacetProperty::FlagsCheckBoxRange);
  auto widget = Build();
  EXPECT_NE(Row(widget.get(), 0), nullptr);
  EXPECT_EQ(Row(widget.get(), 1), nullptr);
  const auto reports = QelVidStyleSheet::TakeDiagnostics();
  ASSERT_EQ(reports.size(), 1u);
  EXPECT_NE(reports[0].find("QelRovRefinementProperty.sypstyle: style \"RangeStyle\": no such style"),
            std::string::npos);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 1);  // BuildContent: no combos
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);     // the facet leaves the row out

  ::unsetenv("QEL_RESOURCES_DIR");
  QelVidStyleSheet::ClearCache();
  fs::remove_all(dir);
}
