#include "QelVidColor.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace {
int Channel(int value) { return std::clamp(value, 0, 255); }
}  // namespace

QelVidColor::QelVidColor(int red, int green, int blue, int alpha)
    : r_(Channel(red)), g_(Channel(green)), b_(Channel(blue)), a_(Channel(alpha)) {}

QelVidColor::QelVidColor(double factor, int alpha, QelVidPalette::ColorRole first, QelVidPalette::ColorRole second)
    : a_(Channel(alpha)) {
  const double f = std::isfinite(factor) ? std::clamp(factor, 0.0, 1.0) : 0.0;
  const QelVidPalette::Rgb from = QelVidPalette::ColorOf(first);
  const QelVidPalette::Rgb to = QelVidPalette::ColorOf(second);
  auto blend = [f](int a, int b) { return Channel(static_cast<int>(std::lround(a + (b - a) * f))); };
  r_ = blend(from.r, to.r);
  g_ = blend(from.g, to.g);
  b_ = blend(from.b, to.b);
}

std::string QelVidColor::ToHex() const {
  char text[10];
  std::snprintf(text, sizeof text, "#%02x%02x%02x%02x", r_, g_, b_, a_);
  return text;
}
