#include "QelHostOptions.h"

#include <cerrno>
#include <cmath>
#include <cstdlib>

namespace {
bool ParseNumber(const std::string& text, double& value) {
  if (text.empty()) return false;
  errno = 0;
  char* end = nullptr;
  value = std::strtod(text.c_str(), &end);
  // strtod reads "nan" and "inf" too: a NaN bound would silently hide every annotation.
  return errno == 0 && end == text.c_str() + text.size() && std::isfinite(value);
}

bool ParseSettingRequest(const std::string& text, QelHostOptions::SettingRequest& request) {
  size_t slash = text.find('/');
  if (slash == std::string::npos || slash == 0) return false;
  size_t equals = text.find('=', slash);
  request.repository = text.substr(0, slash);
  request.key = text.substr(slash + 1, equals == std::string::npos ? std::string::npos : equals - slash - 1);
  if (equals != std::string::npos) request.value = text.substr(equals + 1);
  return !request.key.empty();
}
}  // namespace

const char* QelHostOptions::Usage() {
  return "usage: qelhost [options] [model.json]\n"
         "       qelhost serve [--port N] [options] [model.json]\n"
         "\n"
         "Opens a product model (the shipped sample when none is given), loads the\n"
         "QelRovFacets plug-in and shows the model's annotation sets, annotations, views\n"
         "and captures with the shown or hidden state of each. With serve, the review is a\n"
         "web page on this machine only: open the address qelhost prints.\n"
         "\n"
         "options:\n"
         "  --hide NAME          hide the product, set, annotation, view or capture NAME\n"
         "  --show NAME          show it (both may be repeated; applied in order)\n"
         "  --default-only       keep only the default annotations of the visible sets\n"
         "  --tolerance RANGE    keep only annotations whose tolerance value is in RANGE:\n"
         "                       0.05<=t<0.2, t<=0.1, 0.1<t, t=0.05, or any\n"
         "  --module FILE        the plug-in to load (default libQelRovFacets.so, next to qelhost)\n"
         "  --list-module        list what the plug-in registered with the host\n"
         "  --export-json FILE   write the model (JSON or STEP) to FILE as a JSON model file and stop\n"
         "  --script FILE        run the review session's commands from FILE (without it the\n"
         "                       session reads a terminal with a prompt, or standard input)\n"
         "  --demo               run a short scripted review of the model with the panel\n"
         "  --setting REPO/KEY[=VALUE]\n"
         "                       print a user setting, or write and save it; given alone,\n"
         "                       only the value is printed (\"not set\" when absent)\n"
         "  --thumbnail NAME     write the thumbnail of the view or capture NAME as PNG (\"*\":\n"
         "                       every one); needs --output; may be repeated\n"
         "  --output FILE        where the --thumbnail before it goes (a folder for \"*\")\n"
         "  --picture FILE       write the 3D viewer's picture of the whole model as PNG\n"
         "  --widgets [--json]   print the panel's widgets over the model's facets and stop\n"
         "  --port N             with serve: the port of the review page (default: a free one)\n"
         "  -h, --help           show this help and exit\n"
         "  -V, --version        show the version and exit\n";
}

bool QelHostOptions::ParseToleranceRange(const std::string& raw, QelToleranceRange& range, std::string& error) {
  std::string text;
  for (char c : raw)
    if (c != ' ') text += c;
  range = {};
  if (text == "any") return true;
  size_t t = text.find('t');
  if (t == std::string::npos || text.find('t', t + 1) != std::string::npos) {
    error = "--tolerance '" + raw + "': write the range around t, e.g. 0.05<=t<0.2";
    return false;
  }
  std::string before = text.substr(0, t), after = text.substr(t + 1);
  double value = 0;
  if (!before.empty()) {
    struct { const char* suffix; QelPropertyOperator op; } forms[] = {
        {"<=", QelPropertyOperatorGreaterOrEqual}, {"<", QelPropertyOperatorGreater}, {"=", QelPropertyOperatorEqual}};
    bool matched = false;
    for (const auto& form : forms) {
      std::string suffix = form.suffix;
      if (before.size() > suffix.size() && before.compare(before.size() - suffix.size(), suffix.size(), suffix) == 0 &&
          ParseNumber(before.substr(0, before.size() - suffix.size()), value)) {
        range.leftOp = form.op;
        range.left = value;
        matched = true;
        break;
      }
    }
    if (!matched) {
      error = "--tolerance '" + raw + "': '" + before + "' is not a lower bound such as 0.05<= or 0.05<";
      return false;
    }
  }
  if (!after.empty()) {
    if (after[0] == '=' && before.empty() && ParseNumber(after.substr(1), value)) {
      range.leftOp = QelPropertyOperatorEqual;
      range.left = value;
      return true;
    }
    bool orEqual = after.rfind("<=", 0) == 0;
    bool less = !orEqual && after.rfind('<', 0) == 0;
    if ((!orEqual && !less) || !ParseNumber(after.substr(orEqual ? 2 : 1), value) ||
        range.leftOp == QelPropertyOperatorEqual) {
      error = "--tolerance '" + raw + "': '" + after + "' is not an upper bound such as <0.2 or <=0.2";
      return false;
    }
    range.rightOp = orEqual ? QelPropertyOperatorLessOrEqual : QelPropertyOperatorLess;
    range.right = value;
  }
  if (!range.left && !range.right) {
    error = "--tolerance '" + raw + "': give at least one bound, or 'any'";
    return false;
  }
  return true;
}

bool QelHostOptions::Parse(const std::vector<std::string>& args, QelHostOptions& options, std::string& error) {
  options = {};
  for (size_t i = 0; i < args.size(); ++i) {
    const std::string& arg = args[i];
    auto value = [&](std::string& out) {
      if (i + 1 >= args.size()) {
        error = "option '" + arg + "' needs a value";
        return false;
      }
      out = args[++i];
      return true;
    };
    std::string text;
    if (arg == "serve" && i == 0) {
      options.serve = true;
    } else if (arg == "--port") {
      if (!value(text)) return false;
      char* end = nullptr;
      const long port = std::strtol(text.c_str(), &end, 10);
      if (text.empty() || *end != '\0' || port < 0 || port > 65535) {
        error = "--port '" + text + "': give a port from 0 to 65535";
        return false;
      }
      options.port = static_cast<int>(port);
      if (!options.serve) {
        error = "--port is for qelhost serve";
        return false;
      }
    } else if (arg == "-h" || arg == "--help") {
      options.action = Action::Help;
      return true;
    } else if (arg == "-V" || arg == "--version") {
      options.action = Action::Version;
      return true;
    } else if (arg == "--hide" || arg == "--show") {
      if (!value(text)) return false;
      options.displayChanges.push_back({text, arg == "--show"});
    } else if (arg == "--default-only") {
      options.defaultOnly = true;
    } else if (arg == "--tolerance") {
      QelToleranceRange range;
      if (!value(text) || !ParseToleranceRange(text, range, error)) return false;
      options.tolerance = range;
    } else if (arg == "--module") {
      if (!value(options.modulePath)) return false;
      if (options.modulePath.empty()) {
        error = "option '--module' needs a file name, not an empty text";
        return false;
      }
    } else if (arg == "--script") {
      if (!value(options.scriptPath)) return false;
    } else if (arg == "--demo") {
      options.demo = true;
    } else if (arg == "--export-json") {
      if (!value(options.exportJsonPath)) return false;
      if (options.exportJsonPath.empty()) {
        error = "option '--export-json' needs a file name, not an empty text";
        return false;
      }
    } else if (arg == "--list-module") {
      options.listModule = true;
    } else if (arg == "--setting") {
      SettingRequest request;
      if (!value(text)) return false;
      if (!ParseSettingRequest(text, request)) {
        error = "--setting '" + text + "': write REPOSITORY/KEY or REPOSITORY/KEY=VALUE";
        return false;
      }
      options.settings.push_back(request);
    } else if (arg.empty()) {
      // An empty model path would otherwise mean "the sample" and hide the caller's mistake.
      error = "the model file name '' is empty";
      return false;
    } else if (arg[0] == '-') {
      error = "unknown option '" + arg + "'";
      return false;
    } else if (!options.modelPath.empty()) {
      error = "only one model file may be given ('" + options.modelPath + "', then '" + arg + "')";
      return false;
    } else {
      options.modelPath = arg;
    }
  }
  if (options.serve && (options.demo || !options.scriptPath.empty() || !options.exportJsonPath.empty())) {
    error = "serve runs no script, demo or export";
    return false;
  }
  return true;
}
