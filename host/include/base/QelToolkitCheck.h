#pragma once
// The UI toolkit's check routines, used by widget event plumbing and item adapters
// instead of the assertion routine. A failed check is logged through QelSysLogError as
//   ">> CHECK FAILED <kind>: <detail> [File: <file>:<line>].<<\n"
// (with ": <message>" before the file part when one is given) and the caller goes on; it
// never aborts, not even in a development run. A QelAssertionCapture records it instead,
// under one of the three kinds below, with the checked name or condition as detail.
//
//   if (!QelTkCheckPointer(pArgs, "pArgs")) return;
//   if (!QelTkCheckCondition(QelSucceeded(hr), "SUCCEEDED(GetIntrospectable( &pIntros ))")) return E_FAIL;
#include <source_location>
#include <string>

inline constexpr const char* kQelTkCheckKindPointer = "NULL POINTER";
inline constexpr const char* kQelTkCheckKindHandler = "MISSING HANDLER";
inline constexpr const char* kQelTkCheckKindCondition = "CONDITION FAILED";

// Exactly the text a failed check logs; kind, detail, message and file are cut at 32,
// 128, 128 and 128 characters.
std::string QelFormatToolkitCheck(const char* kind, const char* detail, const char* message, const char* file,
                                  int line);

void QelToolkitCheckFailed(const char* kind, const char* detail, const char* message, const char* file, int line);

inline void QelTkReportNullPointer(const char* name, std::source_location at = std::source_location::current()) {
  QelToolkitCheckFailed(kQelTkCheckKindPointer, name, "", at.file_name(), static_cast<int>(at.line()));
}
inline void QelTkReportMissingHandler(const char* name, std::source_location at = std::source_location::current()) {
  QelToolkitCheckFailed(kQelTkCheckKindHandler, name, "", at.file_name(), static_cast<int>(at.line()));
}
inline void QelTkReportFailedCondition(const char* condition, const char* message = "",
                                       std::source_location at = std::source_location::current()) {
  QelToolkitCheckFailed(kQelTkCheckKindCondition, condition, message, at.file_name(), static_cast<int>(at.line()));
}

// Each returns true when the check holds and reports a failure otherwise. `p` may be a
// raw pointer or anything testable like one (a QelVar handle).
template <class P>
bool QelTkCheckPointer(const P& p, const char* name, std::source_location at = std::source_location::current()) {
  if (p) return true;
  QelTkReportNullPointer(name, at);
  return false;
}
template <class H>
bool QelTkCheckHandler(const H& handler, const char* name,
                       std::source_location at = std::source_location::current()) {
  if (handler) return true;
  QelTkReportMissingHandler(name, at);
  return false;
}
inline bool QelTkCheckCondition(bool holds, const char* condition, const char* message = "",
                                std::source_location at = std::source_location::current()) {
  if (holds) return true;
  QelTkReportFailedCondition(condition, message, at);
  return false;
}
