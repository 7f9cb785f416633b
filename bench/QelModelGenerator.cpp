#include "QelModelGenerator.h"

#include <algorithm>

namespace {
constexpr int kSets = 20;
constexpr int kAnnotationsPerView = 50;
const int kCodes[] = {3, 5, 6, 7, 8, 9, 13, 4, 11};
const char* const kTypes[] = {"Datum", "Geometrical Tolerance", "Dimension", "Roughness", "Weld",
                              "Note", "Annotated Geometry", "Note", "Semantic Text"};
}  // namespace

std::string QelModelGenerator::MakeModelText(int annotations) {
  std::string out;
  out.reserve(static_cast<size_t>(annotations) * 200 + 4096);
  out += R"({"format": "qel-product-model", "version": 1, "root": {"id": "root", "alias": "Generated", "children": [)";
  for (int p = 0; p < kSets; ++p) {
    if (p) out += ',';
    out += R"({"id": "p)" + std::to_string(p) + R"(", "alias": "Part )" + std::to_string(p) +
           R"(", "lightLoadMode": true})";
  }
  out += R"(]}, "sets": [)";
  int next = 0;
  for (int s = 0; s < kSets; ++s) {
    const int count = annotations / kSets + (s < annotations % kSets ? 1 : 0);
    if (s) out += ',';
    out += R"({"id": "s)" + std::to_string(s) + R"(", "alias": "Set.)" + std::to_string(s) + R"(", "owner": "p)" +
           std::to_string(s) + R"(", "light": )" + (s % 2 ? "true" : "false") + R"(, "annotations": [)";
    const int first = next;
    for (int a = 0; a < count; ++a, ++next) {
      const int k = next % 9;
      if (a) out += ',';
      out += R"({"id": "a)" + std::to_string(next) + R"(", "alias": "Annotation.)" + std::to_string(next) +
             R"(", "type": ")" + kTypes[k] + R"(", "subType": "Sub)" + std::to_string(next % 4) +
             R"(", "code": )" + std::to_string(kCodes[k]) + (k == 6 ? R"(, "geometry": true)" : "") +
             (next % 3 ? R"(, "tolerance": )" + std::to_string((next % 100) / 100.0) : std::string()) +
             (next % 5 == 0 ? R"(, "default": true)" : "") + "}";
    }
    out += R"(], "views": [)";
    const int views = std::max(1, count / kAnnotationsPerView);
    for (int v = 0; v < views; ++v) {
      if (v) out += ',';
      out += R"({"id": "s)" + std::to_string(s) + "v" + std::to_string(v) + R"(", "alias": "View.)" +
             std::to_string(v) + R"(", "elements": [)";
      for (int e = 0; e < kAnnotationsPerView && v * kAnnotationsPerView + e < count; ++e) {
        if (e) out += ',';
        out += "\"a" + std::to_string(first + v * kAnnotationsPerView + e) + "\"";
      }
      out += "]}";
    }
    out += R"(], "captures": [)";
    for (int v = 0; v < views; ++v) {
      if (v) out += ',';
      out += R"({"id": "s)" + std::to_string(s) + "c" + std::to_string(v) + R"(", "alias": "Capture.)" +
             std::to_string(v) + R"(", "view": "s)" + std::to_string(s) + "v" + std::to_string(v) +
             R"(", "camera": {"origin": [0, -100, 0], "target": [0, 0, 0], "zenith": [0, 0, 1]}})";
    }
    out += "]}";
  }
  out += "]}";
  return out;
}
