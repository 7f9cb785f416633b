#include "QelSYPValue.h"

#include <cmath>
#include <cstdio>

int QelSYPValueToInt(const QelSYPValue& value, int fallback) {
  if (const int* i = std::get_if<int>(&value)) return *i;
  if (const double* d = std::get_if<double>(&value)) return std::isfinite(*d) ? static_cast<int>(*d) : fallback;
  return fallback;
}

std::string QelSYPValueToText(const QelSYPValue& value) {
  if (const int* i = std::get_if<int>(&value)) return std::to_string(*i);
  if (const double* d = std::get_if<double>(&value)) {
    char text[32];
    std::snprintf(text, sizeof text, "%g", *d);
    return text;
  }
  if (const auto* s = std::get_if<QelUnicodeString>(&value)) return s->Utf8();
  if (const auto* c = std::get_if<QelVidColor>(&value)) return c->ToHex();
  return "";
}
