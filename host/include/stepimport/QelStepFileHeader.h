#pragma once
// QelStepFileHeader: what an exchange file says about itself before anything is translated:
// whether it is a STEP file at all (its first statement), the schemas its header names, and
// whether it ends with the closing statement. A plain value read from a bounded head and
// tail of the file, so a wrong or cut file is refused without reading the rest.
#include <string>
#include <string_view>
#include <vector>

struct QelStepFileHeader {
  // The first statement ("ISO-10303-21;") was found at the start of the file.
  bool isStep = false;
  // The file ends with "END-ISO-10303-21;" (only trailing blanks after it).
  bool complete = false;
  // The names listed by FILE_SCHEMA, as written.
  std::vector<std::string> schemas;

  // Whether a schema is the managed model based 3D engineering protocol (AP242), the
  // one that carries semantic annotations and saved views.
  bool IsAP242() const;

  // The head (at least the header section) and the tail of a file.
  static QelStepFileHeader Parse(std::string_view head, std::string_view tail);
  // False with `error` ("<path>: ...") when the file cannot be read or is empty.
  static bool Read(const std::string& path, QelStepFileHeader& header, std::string& error);
};
