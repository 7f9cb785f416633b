#pragma once
// QelHostModelFiles: opens a model file for qelhost whatever its kind, told apart by its
// content and never by its name: a STEP file goes through the STEP importer, anything else
// through the JSON model loader. Also writes a model out as a JSON model file.
#include <ostream>
#include <string>

#include "QelVar.h"

namespace QelHostModelFiles {
// S_OK and the root; E_FAIL and `error` ("<path>: ...") otherwise. What a person should
// know about a file that opened (e.g. a STEP file without annotations) goes to `notes`, one
// line each; the progress of a large import is shown on standard error when it is a terminal.
HRESULT Load(const std::string& path, QelBaseUnknown_var& root, std::string& error, std::ostream& notes);
// Writes the model of `root` to `path` as a JSON model file; false with `error`.
bool ExportJson(QelBaseUnknown* root, const std::string& path, std::string& error);
}  // namespace QelHostModelFiles
