#pragma once
// QelMsgCatalog: the texts a person sees, looked up by catalog and key. A catalog is the
// UTF-8 file <resources>/catalogs/<catalog>.qelcat, where <resources> is $QEL_RESOURCES_DIR
// or else the host's own resource folder. Each file is parsed on first use and kept for
// the whole process. File format, one entry per line:
//
//   // a comment line; blank lines are ignored too
//   Annotation.All = "All annotations";
//   Dlg.Message    = "Show /p1 sets?\nThis may take a while.";
//
// Inside the quotes \" \\ \n and \t are the only escapes. "/p1", "/p2" ... are replaced by
// the first, second ... parameter; a placeholder without a parameter stays as written.
// A malformed line is reported once (file and line) through QelSysLogError and skipped;
// the rest of the file still loads. A missing catalog or key gives the default text.
#include <string>
#include <vector>

#include "QelString.h"
#include "QelUnicodeString.h"

class QelMsgCatalog {
 public:
  static QelUnicodeString BuildMessage(const char* catalog, const char* key,
                                       const std::vector<QelUnicodeString>& params = {},
                                       const QelUnicodeString& defaultText = {});
  // The keys of a catalog in ascending order; empty when the catalog cannot be read.
  static std::vector<QelString> ListKeys(const char* catalog);
  // The folder the catalogs are read from, as it is resolved right now.
  static std::string CatalogFolder();
  // Drops every parsed catalog, so the next look-up reads the files again. Texts already
  // built stay valid; for a host whose resources changed, and for tests.
  static void ForgetCatalogs();
};
