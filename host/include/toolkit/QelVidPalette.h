#pragma once
// QelVidPalette: the host's colour roles. A palette colour is a blend of two roles, so a
// style can shade a row slightly towards the text colour without naming any RGB value.
#include <cstdint>

class QelVidPalette {
 public:
  enum ColorRole : int32_t { Window = 0, Base = 1, Text = 2, Highlight = 3 };
  struct Rgb {
    int r, g, b;
  };
  // Unknown roles read as the base colour.
  static Rgb ColorOf(int32_t role);

  QelVidPalette() = delete;
};
