#pragma once
// QelModelGenerator: writes synthetic product model files for the benchmarks: a root with
// 20 parts, one set per part, the annotations spread evenly over the sets, one view per
// 50 annotations and one capture per view.
#include <string>

class QelModelGenerator {
 public:
  QelModelGenerator() = delete;
  static std::string MakeModelText(int annotations);
};
