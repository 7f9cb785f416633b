#pragma once
// QelVidStyleSheet: a parsed style sheet file, <resources>/styles/<file> (JSON; the
// format is in docs/style-sheets.md). Sheets are parsed on first use and kept by path;
// a sheet that is missing or malformed is reported each time it is asked for.
// Every refusal is logged through QelSysLogError and kept for Diagnostics().
#include <memory>
#include <string>
#include <vector>

#include "QelStatus.h"

class QelVidCtl;

class QelVidStyleSheet {
 public:
  // The folder sheets are read from: $QEL_RESOURCES_DIR/styles, else the host's own.
  static std::string StyleFolder();
  // The sheet, or null after a report naming the file, the place and the style that was
  // asked for (`forStyle`, for the report only).
  static const QelVidStyleSheet* Load(const std::string& fileName, const std::string& forStyle = {});
  // Forgets the parsed sheets (tests that point QEL_RESOURCES_DIR elsewhere).
  static void ClearCache();

  bool HasStyle(const std::string& style) const;
  std::vector<std::string> StyleNames() const;
  // Builds the style's template under `control`: every part, attribute, binding and
  // route is checked first; any fault is reported (file, style, place) and nothing is
  // attached. E_FAIL then, S_OK otherwise.
  HRESULT Instantiate(QelVidCtl* control, const std::string& style) const;

  const std::string& Path() const { return path_; }

  // The reports since the last call, oldest first.
  static std::vector<std::string> TakeDiagnostics();
  static void Report(const std::string& text);

  ~QelVidStyleSheet();
  struct Document;

 private:
  QelVidStyleSheet(std::string path, std::unique_ptr<Document> document);
  static const QelVidStyleSheet* LoadByPath(const std::string& fileName, const std::string& forStyle);
  std::string path_;
  std::unique_ptr<Document> document_;
};
