#include "QelVidPalette.h"

QelVidPalette::Rgb QelVidPalette::ColorOf(int32_t role) {
  switch (role) {
    case Window: return {239, 239, 239};
    case Text: return {0, 0, 0};
    case Highlight: return {48, 140, 198};
    case Base:
    default: return {255, 255, 255};
  }
}
