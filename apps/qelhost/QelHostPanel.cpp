#include "QelHostPanel.h"

#include <algorithm>
#include <ostream>

#include "QelApplicationFrame.h"
#include "QelVidCtl.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlFrame.h"
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
