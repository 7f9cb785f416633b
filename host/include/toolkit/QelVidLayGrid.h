#pragma once
// QelVidLayGrid: a grid layout. It holds the widgets added to it (as children) with their
// constraints, and a weight per row: free height goes to the rows with weight. A row
// takes room when one of its widgets does (see QelVidWidget::TakesRoom).
#include <map>
#include <utility>
#include <vector>

#include "QelVidGridConstraints.h"
#include "QelVidWidget.h"

class QelVidLayGrid : public QelVidWidget {
 public:
  QelVidLayGrid(QelVidWidget* parent, const QelString& name) : QelVidWidget(parent, name) {}
  const char* GetWidgetKind() const override { return "Grid"; }

  // 0 for a null widget or a negative row or column (nothing added); 1 otherwise.
  int AddWidget(QelVidWidget* widget, const QelVidGridConstraints& constraints);
  // 0 when the widget is not in the grid.
  int RemoveWidget(QelVidWidget* widget);
  // Room for `count` widgets in all, for a maker that knows how many it will add: a
  // section of 10k rows then grows its lists once instead of some fifteen times.
  void Reserve(size_t count);
  // Removes every widget at once, handing them over in order of addition; row weights stay.
  std::vector<QelVar<QelVidWidget>> TakeWidgets();
  // False (and nothing stored) for a negative row.
  bool SetRowWeight(int row, double weight);
  double GetRowWeight(int row) const;

  // One past the last row used, 0 when empty.
  int GetRowCount() const;
  // The widgets whose cell starts in `row`, in order of addition.
  std::vector<QelVidWidget*> GetWidgetsInRow(int row) const;
  bool RowTakesRoom(int row) const;
  // False when the widget is not in the grid.
  bool GetConstraints(QelVidWidget* widget, QelVidGridConstraints& constraints) const;
  // All widgets sorted by row, then column, then order of addition.
  std::vector<QelVidWidget*> GetWidgetsInOrder() const;
  // The same, each with its constraints (one pass, where GetConstraints per widget is a search).
  std::vector<std::pair<QelVidWidget*, QelVidGridConstraints>> GetCellsInOrder() const;

 protected:
  ~QelVidLayGrid() override = default;

 private:
  struct Cell {
    QelVidWidget* widget;  // held as a child
    QelVidGridConstraints constraints;
  };
  std::vector<Cell> cells_;
  std::map<int, double> weights_;
};
