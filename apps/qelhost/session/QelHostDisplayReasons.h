#pragma once
// QelHostDisplayReasons: what a reviewer asks of the display. Why an annotation is not
// drawn, read off the display rule's inputs (its set's state, its own state, and the panel
// rows, switch and range that set them), and a one-line summary of the filters in effect,
// each part with the row whose click undoes it. Computed when asked, never stored.
#include <string>
#include <vector>

#include "QelDbrFraPanel.h"
#include "QelHostPanel.h"

namespace QelHostDisplayReasons {
// One filter in effect and the click that undoes it: `undo` is the label path of the row
// to click (a tick, or an untick when `untick`); empty when no single click undoes it.
struct Part {
  std::string text;
  std::string undo;
  bool untick = false;
};

// The name an annotation's kind row shows: its first navigation name, else its alias.
std::string RowName(QelBaseUnknown* object);
// An object's name as the session prints display changes: its alias, followed by the name
// its panel row shows when that differs ("Datum A (row: A)").
std::string NameOf(QelBaseUnknown* object);

// Why the annotation or set named `name` is not drawn, one reason a line; "drawn" when it
// is. `capture` is the capture activated last, or empty. False with `error` when the
// model has no such object.
bool Why(QelBaseUnknown* root, QelDbrFraPanel* panel, const std::string& name, const std::string& capture,
         std::vector<std::string>& reasons, std::string& error);

// The same for one object, with the panel's rows already read (empty without a panel):
// the page asks it of every hidden annotation at once.
std::vector<std::string> WhyNotDrawn(QelBaseUnknown* object, const std::vector<QelHostPanelRow>& rows,
                                     const std::string& capture);

// The filters in effect, read off the panel's rows, in the panel's order.
std::vector<Part> Summary(const std::vector<QelHostPanelRow>& rows);
std::vector<Part> Summary(QelDbrFraPanel* panel);
// The parts joined on one line ("sets: root product sets · kinds: no Datums"), or
// "no filter" when there is none.
std::string SummaryLine(const std::vector<Part>& parts);
}  // namespace QelHostDisplayReasons
