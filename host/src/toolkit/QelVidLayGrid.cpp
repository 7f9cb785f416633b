#include "QelVidLayGrid.h"

#include <algorithm>

int QelVidLayGrid::AddWidget(QelVidWidget* widget, const QelVidGridConstraints& constraints) {
  if (!widget || constraints.row < 0 || constraints.column < 0) return 0;
  if (widget->GetParent() == this) RemoveWidget(widget);
  AddChild(widget);
  cells_.push_back({widget, constraints});
  return 1;
}

int QelVidLayGrid::RemoveWidget(QelVidWidget* widget) {
  auto it = std::find_if(cells_.begin(), cells_.end(), [widget](const Cell& c) { return c.widget == widget; });
  if (it == cells_.end()) return 0;
  cells_.erase(it);
  RemoveChild(widget);
  return 1;
}

void QelVidLayGrid::Reserve(size_t count) {
  cells_.reserve(count);
  ReserveChildren(count);
}

std::vector<QelVar<QelVidWidget>> QelVidLayGrid::TakeWidgets() {
  cells_.clear();
  return TakeChildren();
}

bool QelVidLayGrid::SetRowWeight(int row, double weight) {
  if (row < 0) return false;
  weights_[row] = weight;
  return true;
}

double QelVidLayGrid::GetRowWeight(int row) const {
  auto it = weights_.find(row);
  return it == weights_.end() ? 0.0 : it->second;
}

int QelVidLayGrid::GetRowCount() const {
  int count = 0;
  for (const Cell& c : cells_) count = std::max(count, c.constraints.row + std::max(1, c.constraints.rowSpan));
  return count;
}

std::vector<QelVidWidget*> QelVidLayGrid::GetWidgetsInRow(int row) const {
  std::vector<QelVidWidget*> in;
  for (const Cell& c : cells_)
    if (c.constraints.row == row) in.push_back(c.widget);
  return in;
}

bool QelVidLayGrid::RowTakesRoom(int row) const {
  for (const Cell& c : cells_)
    if (c.constraints.row == row && c.widget->TakesRoom()) return true;
  return false;
}

bool QelVidLayGrid::GetConstraints(QelVidWidget* widget, QelVidGridConstraints& constraints) const {
  for (const Cell& c : cells_)
    if (c.widget == widget) {
      constraints = c.constraints;
      return true;
    }
  return false;
}

std::vector<QelVidWidget*> QelVidLayGrid::GetWidgetsInOrder() const {
  std::vector<QelVidWidget*> out;
  for (const auto& [widget, constraints] : GetCellsInOrder()) out.push_back(widget);
  return out;
}

std::vector<std::pair<QelVidWidget*, QelVidGridConstraints>> QelVidLayGrid::GetCellsInOrder() const {
  std::vector<const Cell*> sorted;
  for (const Cell& c : cells_) sorted.push_back(&c);
  std::stable_sort(sorted.begin(), sorted.end(), [](const Cell* a, const Cell* b) {
    if (a->constraints.row != b->constraints.row) return a->constraints.row < b->constraints.row;
    return a->constraints.column < b->constraints.column;
  });
  std::vector<std::pair<QelVidWidget*, QelVidGridConstraints>> out;
  out.reserve(sorted.size());
  for (const Cell* c : sorted) out.emplace_back(c->widget, c->constraints);
  return out;
}
