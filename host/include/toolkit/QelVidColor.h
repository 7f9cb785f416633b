#pragma once
// QelVidColor: an RGBA colour, each channel 0..255. The palette constructor blends the
// first role towards the second by `factor` (0 gives the first role, 1 the second), so
// a factor of 0.1 is a light shade of the first role.
#include <cstdint>
#include <string>

#include "QelVidPalette.h"

class QelVidColor {
 public:
  QelVidColor() = default;
  QelVidColor(int red, int green, int blue, int alpha = 255);
  QelVidColor(double factor, int alpha, QelVidPalette::ColorRole first, QelVidPalette::ColorRole second);

  int Red() const { return r_; }
  int Green() const { return g_; }
  int Blue() const { return b_; }
  int Alpha() const { return a_; }
  bool SameRgb(const QelVidColor& other) const { return r_ == other.r_ && g_ == other.g_ && b_ == other.b_; }
  // "#rrggbbaa"
  std::string ToHex() const;

  friend bool operator==(const QelVidColor&, const QelVidColor&) = default;

 private:
  int r_ = 0, g_ = 0, b_ = 0, a_ = 255;
};
