#pragma once
// QelVidGridConstraints: where a widget sits in a grid: column, row, rows spanned,
// columns spanned, and whether it is attached to the left, right, top and bottom of its
// cell (attached on both sides of an axis, it stretches along it).
struct QelVidGridConstraints {
  int column = 0;
  int row = 0;
  int rowSpan = 1;
  int columnSpan = 1;
  int attachLeft = 1;
  int attachRight = 1;
  int attachTop = 1;
  int attachBottom = 0;
  friend bool operator==(const QelVidGridConstraints&, const QelVidGridConstraints&) = default;
};
