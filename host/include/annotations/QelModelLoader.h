#pragma once
// QelModelLoader: reads a product model file (JSON, format in docs/model-format.md) into
// a new model. All or nothing: a refused file leaves no object behind and one message
// "<file>: <JSON path>: <what is wrong>" (or "<file>:<line>:<column>: ..." for syntax).
#include <string>

#include "QelVar.h"

class QelModelLoader {
 public:
  QelModelLoader() = delete;

  // S_OK and the root product; E_FAIL, a null root and the message otherwise. Only a
  // regular file of at most 1 GiB is read; no exception leaves either call.
  static HRESULT LoadFile(const std::string& path, QelBaseUnknown_var& root, std::string& error);
  // `sourceName` names the text in messages.
  static HRESULT LoadText(const std::string& text, const std::string& sourceName, QelBaseUnknown_var& root,
                          std::string& error);
};
