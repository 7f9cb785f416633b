#pragma once
// QelHostOptions: qelhost's command line, parsed into what the program must do. Parsing is
// kept apart from running so that every refusal (unknown option, missing value, bad range)
// can be tested without starting the host.
#include <optional>
#include <string>
#include <vector>

#include "QelPropertyOperator.h"

struct QelToleranceRange {
  QelPropertyOperator leftOp = QelPropertyOperatorLessOrEqual;
  std::optional<double> left;
  QelPropertyOperator rightOp = QelPropertyOperatorLessOrEqual;
  std::optional<double> right;
};

struct QelHostOptions {
  enum class Action { Run, Help, Version };
  struct DisplayChange {
    std::string name;  // the alias of a product, set, annotation, view or capture
    bool show;
  };
  struct SettingRequest {
    std::string repository;
    std::string key;
    std::optional<std::string> value;  // absent: read only
  };

  Action action = Action::Run;
  std::string modelPath;  // empty: the embedded sample
  std::string modulePath = "libQelRovFacets.so";
  bool listModule = false;
  std::string scriptPath;  // empty: the session reads the terminal or standard input
  bool demo = false;       // the built-in review script instead
  std::string exportJsonPath;  // not empty: write the model there as a JSON model file and stop
  std::vector<DisplayChange> displayChanges;
  bool defaultOnly = false;
  std::optional<QelToleranceRange> tolerance;
  std::vector<SettingRequest> settings;
  bool serve = false;  // `serve`: the review page on 127.0.0.1 instead of a session
  int port = 0;        // with serve; 0 picks a free port

  // False with `error` (one line naming the argument) when the command line is refused.
  static bool Parse(const std::vector<std::string>& args, QelHostOptions& options, std::string& error);
  // "0.05<=t<0.2", "t<=0.1", "0.1<t", "t=0.05" or "any" (any tolerance value).
  static bool ParseToleranceRange(const std::string& text, QelToleranceRange& range, std::string& error);
  static const char* Usage();
};
