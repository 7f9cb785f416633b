#include "QelHostPanel.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <ostream>

#include "QelApplicationFrame.h"
#include "QelVidCtl.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlFrame.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidLayGrid.h"

namespace {
using Row = QelHostPanelRow;

std::vector<QelVidWidget*> ChildrenInOrder(QelVidWidget* w) {
  if (auto* grid = dynamic_cast<QelVidLayGrid*>(w)) return grid->GetWidgetsInOrder();
  std::vector<QelVidWidget*> children;
  for (int i = 0; i < w->GetChildCount(); ++i) children.push_back(w->GetChild(i));
  return children;
}

QelVidWidget* Descendant(QelVidWidget* w, const char* name) { return w ? w->FindDescendant(name) : nullptr; }

// A property row's frame: its label, its visible check part, and whether it edits a range.
void ReadRowFrame(QelVidWidget* frame, Row& row) {
  row.row = QelVar<QelVidWidget>::Retain(frame);
  if (QelVidWidget* label = Descendant(frame, "PropertyLabel")) row.label = label->TextAttribute("text").Utf8();
  for (const char* part : {"CheckBox", "RadioButton"}) {
    auto* button = dynamic_cast<QelVidCtlCheckButton*>(Descendant(frame, part));
    if (!button || !button->GetVisibleFlag()) continue;
    row.check = QelVar<QelVidWidget>::Retain(button);
    row.state = button->GetCheckState();
    row.kind = button->IsRadio() ? Row::Kind::Radio : Row::Kind::CheckBox;
    break;
  }
  if (Descendant(frame, "RangeButton")) row.kind = Row::Kind::Range;
}

void Walk(QelVidWidget* w, std::vector<Row>& rows);

void WalkExpander(QelVidCtlExpander* expander, std::vector<Row>& rows) {
  Row row;
  if (QelVidWidget* header = expander->GetHeader()) {
    ReadRowFrame(header, row);
    if (!row.check) row.kind = Row::Kind::Group;
  } else {
    row.kind = Row::Kind::Facet;
    row.label = expander->GetName().Str();
    row.row = QelVar<QelVidWidget>::Retain(expander);
  }
  row.expander = QelVar<QelVidWidget>::Retain(expander);
  // A collapsed section's rows are still there, only folded away.
  if (QelVidWidget* body = expander->GetBody())
    for (QelVidWidget* child : ChildrenInOrder(body)) Walk(child, row.children);
  rows.push_back(std::move(row));
}

void Walk(QelVidWidget* w, std::vector<Row>& rows) {
  if (!w || !w->GetVisibleFlag()) return;
  if (auto* expander = dynamic_cast<QelVidCtlExpander*>(w)) return WalkExpander(expander, rows);
  auto* frame = dynamic_cast<QelVidCtlFrame*>(w);
  if (frame && frame->IsRow() && Descendant(frame, "PropertyLabel")) {
    Row row;
    ReadRowFrame(frame, row);
    rows.push_back(std::move(row));
    return;
  }
  for (QelVidWidget* child : ChildrenInOrder(w)) Walk(child, rows);
}

const char* KindName(Row::Kind kind) {
  switch (kind) {
    case Row::Kind::Facet: return "facet";
    case Row::Kind::Radio: return "radio";
    case Row::Kind::CheckBox: return "check box";
    case Row::Kind::Group: return "group";
    case Row::Kind::Range: return "range";
  }
  return "?";
}

const char* StateName(int state) { return state == 1 ? "checked" : state == 2 ? "partially checked" : "unchecked"; }

void PrintRows(std::ostream& out, const std::vector<Row>& rows, const std::string& parent, int depth) {
  for (const Row& row : rows) {
    const std::string path = parent.empty() ? row.label : parent + "/" + row.label;
    out << std::string(2 * depth, ' ') << path;
    if (row.kind != Row::Kind::Facet) {
      out << "  [" << KindName(row.kind);
      if (row.check) out << ", " << StateName(row.state);
      out << "]";
    }
    out << '\n';
    PrintRows(out, row.children, path, depth + 1);
  }
}

void CollectPaths(const std::vector<Row>& rows, const std::string& parent, std::vector<std::string>& paths) {
  for (const Row& row : rows) {
    const std::string path = parent.empty() ? row.label : parent + "/" + row.label;
    paths.push_back(path);
    CollectPaths(row.children, path, paths);
  }
}

size_t Distance(const std::string& a, const std::string& b) {
  std::vector<size_t> previous(b.size() + 1), current(b.size() + 1);
  for (size_t j = 0; j <= b.size(); ++j) previous[j] = j;
  for (size_t i = 1; i <= a.size(); ++i) {
    current[0] = i;
    for (size_t j = 1; j <= b.size(); ++j)
      current[j] = std::min({previous[j] + 1, current[j - 1] + 1, previous[j - 1] + (a[i - 1] != b[j - 1] ? 1 : 0)});
    std::swap(previous, current);
  }
  return previous[b.size()];
}
}  // namespace

QelDbrFraPanel* QelHostPanel::Find(QelFrmEditor* editor) {
  QelApplicationFrame* frame = QelApplicationFrame::GetFrame();
  if (!editor || !frame) return nullptr;
  QelListValQelBaseUnknown_var windows = frame->GetLayout()->GetWindowList(editor);
  for (const auto& entry : windows) {
    auto* window = QelSysDynamicCast<QelFrmWindow>(entry.get());
    QelBaseUnknown_var viewer = window ? window->GetViewer() : nullptr;
    for (QelDbrFraPanel* panel : QelDbrFraPanel::PanelsInViewer(viewer.get())) return panel;
  }
  return nullptr;
}

std::vector<QelHostPanelRow> QelHostPanel::ReadRows(QelDbrFraPanel* panel) {
  std::vector<Row> rows;
  if (QelVidWidget* dialog = panel ? panel->GetApplicativeWidget() : nullptr)
    if (QelVidWidget* grid = dialog->FindDescendant("DialogGrid"))
      for (QelVidWidget* child : ChildrenInOrder(grid)) Walk(child, rows);
  return rows;
}

const QelHostPanelRow* QelHostPanel::Resolve(const std::vector<Row>& rows, const std::string& path) {
  for (const Row& row : rows) {
    if (path == row.label) return &row;
    if (path.size() > row.label.size() && path.compare(0, row.label.size(), row.label) == 0 &&
        path[row.label.size()] == '/')
      if (const Row* found = Resolve(row.children, path.substr(row.label.size() + 1))) return found;
  }
  return nullptr;
}

std::string QelHostPanel::Closest(const std::vector<Row>& rows, const std::string& path) {
  std::vector<std::string> paths;
  CollectPaths(rows, "", paths);
  std::string closest;
  size_t best = SIZE_MAX;
  for (const auto& candidate : paths)
    if (size_t d = Distance(path, candidate); d < best) best = d, closest = candidate;
  return closest;
}

void QelHostPanel::Print(std::ostream& out, const std::vector<Row>& rows) { PrintRows(out, rows, "", 0); }

bool QelHostPanel::PressRefresh(QelFrmEditor* editor) {
  QelDbrFraPanel* panel = Find(editor);
  QelVidWidget* dialog = panel ? panel->GetApplicativeWidget() : nullptr;
  auto* button = dialog ? dynamic_cast<QelVidCtlButton*>(dialog->FindDescendant("RefreshButton")) : nullptr;
  if (!button || !button->IsEnabled()) return false;
  // The click puts a new dialog into the panel; the old one goes when the host is idle.
  QelVar<QelDbrFraPanel> hold = QelVar<QelDbrFraPanel>::Retain(panel);
  return button->Click();
}

namespace {
std::string SelectedText(const QelHostPanelRow& row, const char* part) {
  auto* combo = dynamic_cast<QelVidCtlImageAndLabelCombo*>(Descendant(row.row.get(), part));
  if (!combo || combo->GetSelectedIndex() < 0 || combo->GetSelectedIndex() >= combo->GetLineCount()) return {};
  return combo->GetLine(combo->GetSelectedIndex()).Utf8();
}

std::string EditorText(const QelHostPanelRow& row, const char* part) {
  auto* editor = dynamic_cast<QelVidCtlLineEditor*>(Descendant(row.row.get(), part));
  return editor ? editor->GetText().Utf8() : std::string();
}

std::string Number(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}
}  // namespace

std::string QelHostPanel::RangeInEffect(const QelHostPanelRow& row) {
  if (row.kind != Row::Kind::Range) return {};
  if (row.state != 1) return "off";
  const std::string lower = SelectedText(row, "LeftCombo");
  if (lower == "=") return "t = " + EditorText(row, "LeftEditor");
  return EditorText(row, "LeftEditor") + " " + lower + " t " + SelectedText(row, "RightCombo") + " " +
         EditorText(row, "RightEditor");
}

std::string QelHostPanel::RangeProblem(const QelHostPanelRow& row, const std::string& lower, double lowerValue,
                                       bool hasUpper, double upperValue, bool byTick) {
  if (!std::isfinite(lowerValue) || (hasUpper && !std::isfinite(upperValue)))
    return "a bound must be a finite number";
  if (lower == "=") return lowerValue > 0.0 || !byTick ? std::string() : "the value must be above 0";
  const double upper = hasUpper ? upperValue : std::strtod(EditorText(row, "RightEditor").c_str(), nullptr);
  // The row's tick takes a range only with bounds above 0, and the filter only a range
  // whose upper bound is not below its lower one.
  if (byTick && lowerValue <= 0.0) return "the lower bound must be above 0";
  if (upper < lowerValue)
    return "the upper bound " + Number(upper) + " is below the lower bound " + Number(lowerValue);
  return {};
}

namespace {
void CollectMarks(const std::vector<Row>& rows, const std::string& parent, std::vector<QelHostPanelMark>& marks) {
  for (const Row& row : rows) {
    const std::string path = parent.empty() ? row.label : parent + "/" + row.label;
    if (row.check) marks.push_back({path, row.kind == Row::Kind::Radio, row.state});
    CollectMarks(row.children, path, marks);
  }
}
}  // namespace

std::vector<QelHostPanelMark> QelHostPanel::Marks(const std::vector<Row>& rows) {
  std::vector<QelHostPanelMark> marks;
  CollectMarks(rows, "", marks);
  return marks;
}

int QelHostPanel::RestoreMarks(QelFrmEditor* editor, const std::vector<QelHostPanelMark>& marks) {
  if (!Find(editor)) return -1;
  int clicks = 0;
  // Each click rebuilds the rows, so the walk starts again after it; a click that changes
  // nothing (a refused question) is not tried twice.
  std::vector<bool> tried(marks.size(), false);
  for (bool clicked = true; clicked;) {
    clicked = false;
    QelDbrFraPanel* panel = Find(editor);
    if (!panel) break;
    const std::vector<Row> rows = ReadRows(panel);
    for (int pass = 0; pass < 2 && !clicked; ++pass)
      for (size_t i = 0; i < marks.size() && !clicked; ++i) {
        const QelHostPanelMark& mark = marks[i];
        if (tried[i] || mark.radio != (pass == 0) || mark.state == 2 || (mark.radio && mark.state != 1)) continue;
        const Row* row = Resolve(rows, mark.path);
        auto* check = row ? dynamic_cast<QelVidCtlCheckButton*>(row->check.get()) : nullptr;
        if (!check || row->state == mark.state) continue;
        tried[i] = true;
        QelVar<QelDbrFraPanel> hold = QelVar<QelDbrFraPanel>::Retain(panel);
        check->Click();
        ++clicks;
        clicked = true;
      }
  }
  return clicks;
}
