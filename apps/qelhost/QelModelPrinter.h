#pragma once
// QelModelPrinter: writes a product model as an indented tree a person can read: the
// product occurrences with their annotation sets, and under each set its annotations,
// views and captures, each marked [shown] or [hidden]. Reads the model only through the
// host's interfaces and the facet services, as any client would.
#include <ostream>

#include "QelVar.h"

class QelModelPrinter {
 public:
  QelModelPrinter() = delete;
  static void Print(QelBaseUnknown* root, std::ostream& out);
};
