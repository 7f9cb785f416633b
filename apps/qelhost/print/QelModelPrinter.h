#pragma once
// QelModelPrinter: writes a product model as an indented tree a person can read: the
// product occurrences with their annotation sets, and under each set its annotations,
// views and captures, each marked [shown] or [hidden]. Reads the model only through the
// host's interfaces and the facet services, as any client would.
#include <ostream>
#include <string>

#include "QelListValQelBaseUnknown_var.h"

#include "QelVar.h"

class QelModelPrinter {
 public:
  QelModelPrinter() = delete;
  static void Print(QelBaseUnknown* root, std::ostream& out);
  // Every object of the model (product, set, annotation, view, capture) named `alias`, in
  // the order Print shows them.
  static QelListValQelBaseUnknown_var FindByAlias(QelBaseUnknown* root, const std::string& alias);
};
