#pragma once
// QelModelJsonWriter: writes a product model as a model file (docs/model-format.md) that
// QelModelLoader reads back to the same objects, names, values, links, shapes and shown
// states. Identifiers are made up in model order (p1, r1, s1, a1, v1, c1); shapes are
// written as triangle lists. The model is only read.
#include <ostream>
#include <string>

#include "QelVar.h"

class QelModelJsonWriter {
 public:
  QelModelJsonWriter() = delete;

  // False when `root` is not the root product of a model. Not `indented`: all on one
  // line, half the bytes, for a model handed from process to process rather than read.
  static bool Write(QelBaseUnknown* root, std::ostream& out, bool indented = true);
  // Writes through a temporary file beside `path` and renames it into place, so a failed
  // write leaves what was there. False with `error` ("<path>: ...").
  static bool WriteFile(QelBaseUnknown* root, const std::string& path, std::string& error);
};
