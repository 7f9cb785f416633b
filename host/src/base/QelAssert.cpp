#include "QelAssert.h"

#include <sys/stat.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <system_error>
#include <utility>

namespace {
int g_developmentStage = -1;  // -1: not decided yet, read from the environment
QelAssertionCapture* g_capture = nullptr;
std::string g_logFile;
int g_logCount = 0;

// The log file stays open between reports: a pass over thousands of annotations may report
// each one, and opening the file for every line cost more than the pass itself. A file
// removed or replaced meanwhile is opened anew, so later reports stay where people look.
struct OpenLog {
  std::FILE* file = nullptr;
  dev_t device = 0;
  ino_t inode = 0;

  void Close() {
    if (file) std::fclose(file);
    file = nullptr;
  }
  std::FILE* For(const std::string& path) {
    struct stat named = {};
    if (file && (::stat(path.c_str(), &named) != 0 || named.st_dev != device || named.st_ino != inode)) Close();
    if (file) return file;
    file = std::fopen(path.c_str(), "a");
    if (!file) {
      std::error_code ignored;
      std::filesystem::create_directories(std::filesystem::path(path).parent_path(), ignored);
      file = std::fopen(path.c_str(), "a");
    }
    struct stat opened = {};
    if (file && ::fstat(fileno(file), &opened) != 0) Close();
    device = opened.st_dev;
    inode = opened.st_ino;
    return file;
  }
};
OpenLog g_openLog;

const char* BaseName(const char* path) {
  const char* slash = std::strrchr(path, '/');
  return slash ? slash + 1 : path;
}
}  // namespace

std::string QelFormatAssertion(const char* kind, const char* detail, const char* file, int line) {
  char buffer[287];
  std::snprintf(buffer, sizeof buffer, ">> ASSERTION FAILED %.32s: %.40s [File: %.128s:%4d].<<\n", kind ? kind : "",
                detail ? detail : "", file ? file : "", line);
  return buffer;
}

void QelAssertionFailed(const char* kind, const char* detail, const char* file, int line) {
  const char* shortFile = BaseName(file ? file : "");
  std::string text = QelFormatAssertion(kind, detail, shortFile, line);
  if (QelCaptureReport({kind ? kind : "", detail ? detail : "", shortFile, line, text})) return;
  if (QelDevelopmentStage()) QelSysLogAbend(text.c_str());  // prints the text once, then aborts
  QelSysLogError(text.c_str());
}

bool QelCaptureReport(QelAssertionReport report) {
  if (!g_capture) return false;
  g_capture->reports_.push_back(std::move(report));
  return true;
}

bool QelDevelopmentStage() {
  if (g_developmentStage < 0) g_developmentStage = QelGetEnv("QEL_DEVELOPMENT_STAGE") == "1" ? 1 : 0;
  return g_developmentStage == 1;
}

void QelSetDevelopmentStage(bool on) { g_developmentStage = on ? 1 : 0; }

namespace {
// Reports the same as the one before (a refresh over 10k annotations may raise one per
// annotation) are counted, not written; the count follows when another report comes, the
// log changes or the process ends. The first of them is always written at once.
std::string g_lastReport;
int g_repeats = 0;

void Write(const std::string& text) {
  if (!g_logFile.empty()) {
    // Flushed at once: the report must be on disk if the run ends abnormally.
    if (std::FILE* file = g_openLog.For(g_logFile);
        file && std::fputs(text.c_str(), file) >= 0 && std::fflush(file) == 0)
      return;
    g_openLog.Close();
  }
  std::fputs(text.c_str(), stderr);
  std::fflush(stderr);
}

std::string TakeRepeats() {
  if (g_repeats == 0) return {};
  std::string line = "   (the report above " + std::to_string(g_repeats) + " more time" + (g_repeats > 1 ? "s" : "") + ")\n";
  g_repeats = 0;
  return line;
}

struct RepeatsAtExit {
  ~RepeatsAtExit() {
    if (std::string repeats = TakeRepeats(); !repeats.empty()) Write(repeats);
  }
} g_repeatsAtExit;
}  // namespace

void QelSysLogError(const char* text) {
  ++g_logCount;
  std::string report = text ? text : "";
  if (!report.empty() && report == g_lastReport) {
    ++g_repeats;
    return;
  }
  g_lastReport = report;
  Write(TakeRepeats() + report);
}

void QelSetSysLogFile(const std::string& path) {
  if (path == g_logFile) return;
  if (std::string repeats = TakeRepeats(); !repeats.empty()) Write(repeats);
  g_lastReport.clear();
  g_openLog.Close();
  g_logFile = path;
}
const std::string& QelSysLogFile() { return g_logFile; }
int QelSysLogCount() { return g_logCount; }

void QelSysLogAbend(const char* text) {
  std::fprintf(stderr, "qel: abnormal end: %s", text ? text : "");
  std::fflush(stderr);
  std::abort();
}

QelAssertionCapture::QelAssertionCapture() : outer_(g_capture) { g_capture = this; }
QelAssertionCapture::~QelAssertionCapture() { g_capture = outer_; }

int QelAssertionCapture::Count(std::string_view kind, std::string_view detail) const {
  int n = 0;
  for (const auto& report : reports_)
    if (report.kind == kind && (detail.empty() || report.detail == detail)) ++n;
  return n;
}

std::string QelGetEnv(const char* name) {
  const char* value = name ? std::getenv(name) : nullptr;
  return value ? value : "";
}
