#pragma once
// QelVidPoint: a position or a size in the toolkit's layout units. A plain value type.
struct QelVidPoint {
  double x = 0.0;
  double y = 0.0;
  friend bool operator==(const QelVidPoint&, const QelVidPoint&) = default;
};
