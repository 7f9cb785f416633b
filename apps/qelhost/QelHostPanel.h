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
}  // namespace QelHostPanel
