#pragma once
// The one assertion routine. A broken contract (a null pointer, a null handle, a false
// condition) is reported with the text
//   ">> ASSERTION FAILED <kind>: <detail> [File: <file>:<line>].<<\n"
// A development run (QelDevelopmentStage) prints it and aborts through QelSysLogAbend;
// any other run logs it through QelSysLogError and the caller goes on.
//
//   if (!facet) { QelAssertPointer(); return E_UNEXPECTED; }
#include <source_location>
#include <string>
#include <string_view>
#include <vector>

inline constexpr const char* kQelAssertKindPointer = "ON POINTER ";
inline constexpr const char* kQelAssertKindBool = "BOOL IS FALSE";
inline constexpr const char* kQelAssertNullHandler = "NULL handler";

// Exactly the text the routine reports, built in a buffer of 287 characters, so kind,
// detail and file are cut at 32, 40 and 128 characters.
std::string QelFormatAssertion(const char* kind, const char* detail, const char* file, int line);

void QelAssertionFailed(const char* kind, const char* detail, const char* file, int line);

inline void QelAssertPointer(const char* detail = "", std::source_location at = std::source_location::current()) {
  QelAssertionFailed(kQelAssertKindPointer, detail, at.file_name(), static_cast<int>(at.line()));
}
inline void QelAssertNullHandler(std::source_location at = std::source_location::current()) {
  QelAssertionFailed(kQelAssertKindPointer, kQelAssertNullHandler, at.file_name(), static_cast<int>(at.line()));
}
inline void QelAssertBool(const char* detail = "", std::source_location at = std::source_location::current()) {
  QelAssertionFailed(kQelAssertKindBool, detail, at.file_name(), static_cast<int>(at.line()));
}

// True in a development run: QEL_DEVELOPMENT_STAGE=1 in the environment, or set by the host.
bool QelDevelopmentStage();
void QelSetDevelopmentStage(bool on);

void QelSysLogError(const char* text);
// Where QelSysLogError writes: standard error (an empty path, the default) or the end of a
// log file, its folder made when missing; a file that cannot be written falls back to
// standard error. A program for people sends reports to a file and says how many it wrote.
void QelSetSysLogFile(const std::string& path);
const std::string& QelSysLogFile();
int QelSysLogCount();
[[noreturn]] void QelSysLogAbend(const char* text);

struct QelAssertionReport {
  std::string kind;
  std::string detail;
  std::string file;
  int line = 0;
  std::string text;
};

// Hands a report to the innermost capture; false when none is active. The toolkit's check
// routines (QelToolkitCheck.h) report through it too.
bool QelCaptureReport(QelAssertionReport report);

// While one exists, reports are recorded here instead of being logged or aborting:
// tests count them by kind and detail. Captures nest; the innermost one records.
class QelAssertionCapture {
 public:
  QelAssertionCapture();
  ~QelAssertionCapture();
  QelAssertionCapture(const QelAssertionCapture&) = delete;
  QelAssertionCapture& operator=(const QelAssertionCapture&) = delete;

  const std::vector<QelAssertionReport>& Reports() const { return reports_; }
  int Count() const { return static_cast<int>(reports_.size()); }
  int Count(std::string_view kind, std::string_view detail = {}) const;
  void Clear() { reports_.clear(); }

 private:
  friend bool QelCaptureReport(QelAssertionReport report);
  std::vector<QelAssertionReport> reports_;
  QelAssertionCapture* outer_;
};

// The host's environment lookup; empty when unset.
std::string QelGetEnv(const char* name);
