// Style sheets: a template's parts, bindings and routes, and every refusal reported with
// the file, the style and the place, leaving the control without parts.
#include <gtest/gtest.h>

#include <cstdlib>

#include "ProbeControl.h"
#include "QelVidCtlButton.h"
#include "QelVidLayGrid.h"
#include "QelVidStyleSheet.h"

namespace {
const char* kGoodSheet = R"({
  // comments are allowed
  "styles": {
    "Main": {"template": {
      "kind": "Frame", "name": "Body", "attributes": {"layout": "row"},
      "bind": {"background": "Shade"}, "on": {"MouseEnter": "OnEnter"},
      "children": [
        {"kind": "Label", "name": "Caption", "bind": {"text": "Title"}},
        {"kind": "Button", "name": "Press", "bind": {"enabled": "Flag"}, "on": {"Clicked": "OnPress"}},
        {"kind": "Grid", "name": "Rows", "children": [{"kind": "Spacer", "cell": [0, 3, 1, 1, 1, 1, 1, 1]}]}
      ]}}
  }
})";

std::string Replace(std::string text, const std::string& from, const std::string& to) {
  return text.replace(text.find(from), from.size(), to);
}
}  // namespace

TEST(QelVidStyleSheet, TemplateGivesPartsBindingsAndRoutesBeforeTheHook) {
  StyleFolder folder;
  folder.Write("probe.sypstyle", kGoodSheet);
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    auto probe = QelMakeVar<ProbeControl>();
    ASSERT_EQ(probe->SetCustomStyle(QelString("probe.sypstyle"), QelString("Main"), QelString("")), S_OK);
    EXPECT_TRUE(probe->templateApplied);
    auto* press = dynamic_cast<QelVidCtlButton*>(probe->RetrieveSypNamedObject(QelString("Press")));
    ASSERT_NE(press, nullptr);
    EXPECT_EQ(probe->pressPartAtHook, press);
    QelVidWidget* body = probe->RetrieveSypNamedObject(QelString("Body"));
    EXPECT_EQ(std::get<QelVidColor>(body->GetAttribute("background")), QelVidColor(1, 2, 3, 4));
    EXPECT_EQ(probe->RetrieveSypNamedObject(QelString("Caption"))->TextAttribute("text"), QelUnicodeString("Probe"));
    auto* rows = dynamic_cast<QelVidLayGrid*>(probe->RetrieveSypNamedObject(QelString("Rows")));
    ASSERT_NE(rows, nullptr);
    EXPECT_EQ(rows->GetWidgetsInRow(3).size(), 1u);

    EXPECT_EQ(press->IsEnabled(), 0);  // bound to Flag, 0
    EXPECT_FALSE(press->Click());
    probe->flag = 1;
    probe->DispatchModifyProperty("Flag");
    EXPECT_EQ(press->IsEnabled(), 1);
    EXPECT_TRUE(press->Click());
    ASSERT_EQ(probe->presses.size(), 1u);
    EXPECT_EQ(probe->presses[0], static_cast<QelBaseUnknown*>(press));
    body->MouseEnter();
    EXPECT_EQ(probe->enters, 1);
    EXPECT_TRUE(QelVidStyleSheet::TakeDiagnostics().empty());
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);  // parts do not keep their control
}

TEST(QelVidStyleSheet, RefusalsNameFileStyleAndPlaceAndLeaveTheControlWithoutParts) {
  StyleFolder folder;
  struct Case {
    std::string sheet;
    std::string style;
    std::string expected;  // in the report, besides the file
  };
  const std::vector<Case> cases = {
      {"", "Main", "cannot be read (style \"Main\" asked for)"},
      {"{\n  \"styles\": {\n    \"Main\": {,}\n", "Main", "malformed at line 3, column"},
      {kGoodSheet, "Other", "style \"Other\": no such style"},
      {Replace(kGoodSheet, "\"OnPress\"", "\"OnPush\""), "Main",
       "style \"Main\": at /styles/Main/template/children/1/on/Clicked: the class ProbeControl has no handler "
       "\"OnPush\""},
      {Replace(kGoodSheet, "\"Title\"", "\"Heading\""), "Main",
       "at /styles/Main/template/children/0/bind/text: the class ProbeControl has no property \"Heading\""},
      {Replace(kGoodSheet, "\"Clicked\"", "\"Pressed\""), "Main",
       "at /styles/Main/template/children/1/on/Pressed: a Button raises no event \"Pressed\""},
      {Replace(kGoodSheet, "\"Label\"", "\"Lable\""), "Main",
       "at /styles/Main/template/children/0/kind: unknown kind \"Lable\""},
      {Replace(kGoodSheet, "\"Caption\"", "\"Press\""), "Main", "the part name \"Press\" is used twice"},
      {Replace(kGoodSheet, "[0, 3, 1, 1, 1, 1, 1, 1]", "[0, -3]"), "Main",
       "at /styles/Main/template/children/2/children/0/cell/1: not an integer of 0 or more"},
      {"[1, 2]", "Main", "the sheet must be an object with an object \"styles\""},
  };
  for (size_t i = 0; i < cases.size(); ++i) {
    SCOPED_TRACE(cases[i].expected);
    const std::string file = "case" + std::to_string(i) + ".sypstyle";
    if (!cases[i].sheet.empty()) folder.Write(file, cases[i].sheet);
    auto probe = QelMakeVar<ProbeControl>();
    EXPECT_EQ(probe->SetCustomStyle(QelString(file), QelString(cases[i].style), QelString("")), E_FAIL);
    EXPECT_FALSE(probe->templateApplied);
    EXPECT_EQ(probe->GetChildCount(), 0);
    EXPECT_EQ(probe->RetrieveSypNamedObject(QelString("Press")), nullptr);
    const std::vector<std::string> reports = QelVidStyleSheet::TakeDiagnostics();
    ASSERT_EQ(reports.size(), 1u);
    EXPECT_NE(reports[0].find(folder.Path() + "/styles/" + file), std::string::npos) << reports[0];
    EXPECT_NE(reports[0].find(cases[i].expected), std::string::npos) << reports[0];
  }
  auto probe = QelMakeVar<ProbeControl>();
  EXPECT_EQ(probe->SetCustomStyle(QelString("../x.sypstyle"), QelString("Main"), QelString("")), E_FAIL);
  folder.Write("good.sypstyle", kGoodSheet);
  EXPECT_EQ(probe->SetCustomStyle(QelString("good.sypstyle"), QelString("Main"), QelString("v")), E_FAIL);
  EXPECT_EQ(QelVidStyleSheet::TakeDiagnostics().size(), 2u);
}

// Sheets are kept per resource folder: once the folder setting changes, the same file
// name is the new folder's sheet, and going back finds the first again. Two routes of one
// template naming the same handler each reach it, and other routes stay their own.
TEST(QelVidStyleSheet, TheSameFileNameInAnotherFolderIsThatFoldersSheet) {
  const std::string twoButtons =
      Replace(kGoodSheet, R"({"kind": "Grid")",
              R"({"kind": "Button", "name": "Again", "on": {"Clicked": "OnPress"}}, {"kind": "Grid")");
  StyleFolder first;
  first.Write("probe.sypstyle", kGoodSheet);
  StyleFolder second;  // the setting names this folder now
  second.Write("probe.sypstyle", twoButtons);
  auto styled = [] {
    auto probe = QelMakeVar<ProbeControl>();
    EXPECT_EQ(probe->SetCustomStyle(QelString("probe.sypstyle"), QelString("Main"), QelString("")), S_OK);
    return probe;
  };
  EXPECT_NE(styled()->RetrieveSypNamedObject(QelString("Again")), nullptr);
  ::setenv("QEL_RESOURCES_DIR", first.Path().c_str(), 1);
  EXPECT_EQ(styled()->RetrieveSypNamedObject(QelString("Again")), nullptr);
  ::setenv("QEL_RESOURCES_DIR", second.Path().c_str(), 1);

  auto probe = styled();
  auto* again = dynamic_cast<QelVidCtlButton*>(probe->RetrieveSypNamedObject(QelString("Again")));
  auto* press = dynamic_cast<QelVidCtlButton*>(probe->RetrieveSypNamedObject(QelString("Press")));
  ASSERT_NE(again, nullptr);
  ASSERT_NE(press, nullptr);
  probe->flag = 1;
  probe->DispatchModifyProperty("Flag");
  EXPECT_TRUE(again->Click());
  EXPECT_TRUE(press->Click());
  EXPECT_EQ(probe->presses, (std::vector<QelBaseUnknown*>{again, press}));
  probe->RetrieveSypNamedObject(QelString("Body"))->MouseEnter();
  EXPECT_EQ(probe->enters, 1);
  EXPECT_EQ(probe->presses.size(), 2u);
  EXPECT_TRUE(QelVidStyleSheet::TakeDiagnostics().empty());
}

// A styled control's handlers are made on the first event of their name and kept for the
// next; parts that outlive their control make none and call nothing.
TEST(QelVidStyleSheet, RoutedHandlersLiveForTheirEventOnlyAndNeverReachAGoneControl) {
  StyleFolder folder;
  folder.Write("probe.sypstyle", kGoodSheet);
  auto probe = QelMakeVar<ProbeControl>();
  ASSERT_EQ(probe->SetCustomStyle(QelString("probe.sypstyle"), QelString("Main"), QelString("")), S_OK);
  probe->flag = 1;
  probe->DispatchModifyProperty("Flag");
  auto press = QelVar<QelVidWidget>::Retain(probe->RetrieveSypNamedObject(QelString("Press")));
  auto body = QelVar<QelVidWidget>::Retain(probe->RetrieveSypNamedObject(QelString("Body")));
  auto* button = dynamic_cast<QelVidCtlButton*>(press.get());
  ASSERT_NE(button, nullptr);

  // A second control of the style shares the first one's router: it costs its parts only.
  const int64_t styled = QelBaseUnknown::LiveObjectCount();
  auto twin = QelMakeVar<ProbeControl>();
  ASSERT_EQ(twin->SetCustomStyle(QelString("probe.sypstyle"), QelString("Main"), QelString("")), S_OK);
  const int64_t parts = QelBaseUnknown::LiveObjectCount() - styled - 1;
  twin = nullptr;

  EXPECT_TRUE(button->Click());
  EXPECT_TRUE(button->Click());
  body->MouseEnter();
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), styled);
  EXPECT_EQ(probe->presses.size(), 2u);
  EXPECT_EQ(probe->enters, 1);
  EXPECT_GT(parts, 1);

  probe = nullptr;  // the parts held here outlive their control
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), styled - 1);
  body->MouseEnter();
  button->Click();
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), styled - 1);
  EXPECT_EQ(body->GetParent(), nullptr);
  EXPECT_TRUE(QelVidStyleSheet::TakeDiagnostics().empty());
}
