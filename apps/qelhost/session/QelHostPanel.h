#pragma once
// QelHostPanel: the data filtering panel of the open editor as a person meets it: the rows
// read off the docked panel's widgets (sections, property rows, their check marks) and
// the parts a person clicks, types into or scrolls. Nothing here reaches the plug-in's
// objects: every action is an event on a widget, routed as the styles say.
#include <string>
#include <vector>

#include "QelDbrFraPanel.h"
#include "QelFrmEditor.h"

struct QelHostPanelRow {
  enum class Kind { Facet, Radio, CheckBox, Group, Range };
  std::string label;
  Kind kind = Kind::CheckBox;
  int state = 0;                   // 0 unchecked, 1 checked, 2 partially checked
  QelVar<QelVidWidget> row;        // the row's widget (the section's expander for a facet)
  QelVar<QelVidWidget> check;      // the visible check box or radio, or null
  QelVar<QelVidWidget> expander;   // null for a row without sub-rows
  std::vector<QelHostPanelRow> children;
};

// A row's box or radio as it reads: its label path and state.
struct QelHostPanelMark {
  std::string path;
  bool radio = false;
  int state = 0;
};

namespace QelHostPanel {
// The editor's docked panel, in whichever window of the layout holds it; null when none.
QelDbrFraPanel* Find(QelFrmEditor* editor);
// The sections of the panel's dialog, with their rows (hidden rows left out).
std::vector<QelHostPanelRow> ReadRows(QelDbrFraPanel* panel);
// The row at a label path ("Annotation Sets/All sets"); labels may hold slashes.
const QelHostPanelRow* Resolve(const std::vector<QelHostPanelRow>& rows, const std::string& path);
// Every label path, for suggesting the closest to a mistyped one.
std::string Closest(const std::vector<QelHostPanelRow>& rows, const std::string& path);
void Print(std::ostream& out, const std::vector<QelHostPanelRow>& rows);
// Presses the panel's refresh button when it is enabled (a selection change enables it),
// so the rows read the display again after something outside the panel changed it. False
// when there is no panel or the button is disabled.
bool PressRefresh(QelFrmEditor* editor);

// Every row with a box or radio as a mark, in the panel's order.
std::vector<QelHostPanelMark> Marks(const std::vector<QelHostPanelRow>& rows);
// Clicks the panel's rows until each box and radio of `marks` reads as it did there
// (radios first, then boxes top down; a partial group follows its items). The panel's own
// questions are asked as a click asks them. The number of clicks, or -1 without a panel.
int RestoreMarks(QelFrmEditor* editor, const std::vector<QelHostPanelMark>& marks);

// The range a range row filters by, as its boxes show it ("0.05 <= t < 0.2", "t = 0.8"),
// or "off" when the row is not ticked.
std::string RangeInEffect(const QelHostPanelRow& row);
// Why a range entered in `row` cannot apply: empty when it can. `lower` is the lower
// operator's text (= < <=); an absent upper bound keeps the one the row shows. Checked
// before anything is typed, so a refused range is never half entered. `byTick`: the
// range comes with the row's tick, which takes bounds above 0 only.
std::string RangeProblem(const QelHostPanelRow& row, const std::string& lower, double lowerValue, bool hasUpper,
                         double upperValue, bool byTick);
}  // namespace QelHostPanel
