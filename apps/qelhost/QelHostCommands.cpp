#include "QelHostCommands.h"

#include <algorithm>
#include <functional>
#include <ostream>

#include <dlfcn.h>

#include "QelDlgNotify.h"
#include "QelHostBrowser.h"
#include "QelHostPictures.h"
#include "QelHostSession.h"
#include "QelModelPrinter.h"
#include "QelReviewFramework.h"

namespace {
using Row = QelIRovFacetReview::Row;
using Kind = QelIRovFacetReview::Kind;

const char* KindName(Kind kind) {
  switch (kind) {
    case Kind::Facet: return "facet";
    case Kind::Radio: return "radio";
    case Kind::CheckBox: return "check box";
    case Kind::Group: return "group";
    case Kind::Range: return "range";
  }
  return "?";
}

const char* StateName(QelCheckState state) {
  if (state == Checked) return "checked";
  if (state == Unchecked) return "unchecked";
  if (state == PartiallyChecked) return "partially checked";
  return "unknown";
}

bool ListRows(QelHostSession& session, std::vector<Row>& facets, std::string& error) {
  if (!session.Review() || session.Review()->ListRows(facets) != S_OK) {
    error = "no facets: no model is open";
    return false;
  }
  return true;
}

void PrintRows(std::ostream& out, const std::vector<Row>& rows, const std::string& parent, int depth) {
  for (const Row& row : rows) {
    const std::string path = parent.empty() ? row.label : parent + "/" + row.label;
    out << std::string(2 * depth, ' ') << path;
    if (row.kind != Kind::Facet) out << "  [" << KindName(row.kind) << ", " << StateName(row.state) << "]";
    out << '\n';
    PrintRows(out, row.children, path, depth + 1);
  }
}

void CollectPaths(const std::vector<Row>& rows, const std::string& parent, std::vector<std::string>& paths) {
  for (const Row& row : rows) {
    const std::string path = parent.empty() ? row.label : parent + "/" + row.label;
    paths.push_back(path);
    CollectPaths(row.children, path, paths);
  }
}

// Labels may hold slashes themselves ("Part1/Set.1"), so each level tries every label
// that starts the rest of the path.
const Row* Resolve(const std::vector<Row>& rows, const std::string& path) {
  for (const Row& row : rows) {
    if (path == row.label) return &row;
    if (path.size() > row.label.size() && path.compare(0, row.label.size(), row.label) == 0 &&
        path[row.label.size()] == '/')
      if (const Row* found = Resolve(row.children, path.substr(row.label.size() + 1))) return found;
  }
  return nullptr;
}

size_t Distance(const std::string& a, const std::string& b) {
  std::vector<size_t> previous(b.size() + 1), current(b.size() + 1);
  for (size_t j = 0; j <= b.size(); ++j) previous[j] = j;
  for (size_t i = 1; i <= a.size(); ++i) {
    current[0] = i;
    for (size_t j = 1; j <= b.size(); ++j)
      current[j] = std::min({previous[j] + 1, current[j - 1] + 1, previous[j - 1] + (a[i - 1] != b[j - 1] ? 1 : 0)});
    std::swap(previous, current);
  }
  return previous[b.size()];
}

bool NeedArguments(const std::vector<std::string>& args, size_t count, const char* usage, std::string& error) {
  if (args.size() == count) return true;
  error = std::string("expects ") + usage;
  return false;
}

bool Click(QelHostSession& session, const std::vector<std::string>& args, bool checked, std::string& error) {
  if (!NeedArguments(args, 1, "one label path, for example \"Annotation Sets/All sets\"", error)) return false;
  std::vector<Row> facets;
  if (!ListRows(session, facets, error)) return false;
  const Row* row = Resolve(facets, args[0]);
  if (!row) {
    std::vector<std::string> paths;
    CollectPaths(facets, "", paths);
    std::string closest;
    size_t best = SIZE_MAX;
    for (const auto& path : paths)
      if (size_t d = Distance(args[0], path); d < best) best = d, closest = path;
    error = "no property \"" + args[0] + "\"" + (closest.empty() ? "" : "; closest: \"" + closest + "\"");
    return false;
  }
  if (!row->property) {
    error = "\"" + args[0] + "\" is a facet; tick one of its properties";
    return false;
  }
  session.BeginChanges();
  const HRESULT clicked = session.Review()->Click(row->property.get(), checked);
  std::ostream& out = session.Out();
  out << (checked ? "tick " : "untick ") << args[0] << ": ";
  if (clicked == S_OK)
    out << "done\n";
  else if (clicked == S_FALSE)
    out << (checked ? "already ticked\n" : "not changed (a radio choice is left by choosing another)\n");
  else
    out << "refused\n";
  session.EndChanges();
  return true;
}

bool Open(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 1, "one model file", error)) return false;
  return session.Open(args[0], error);
}

bool Facets(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 0, "no argument", error)) return false;
  std::vector<Row> facets;
  if (!ListRows(session, facets, error)) return false;
  PrintRows(session.Out(), facets, "", 0);
  return true;
}

bool Tick(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  return Click(session, args, true, error);
}

bool Untick(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  return Click(session, args, false, error);
}

bool Answer(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 1, "yes or no", error)) return false;
  if (args[0] != "yes" && args[0] != "no") {
    error = "expects yes or no, not \"" + args[0] + "\"";
    return false;
  }
  QelDlgNotify::QueueAnswer(args[0] == "yes" ? QelDlgNotify::AnswerYes : QelDlgNotify::AnswerNo);
  session.Out() << "the next question will be answered " << args[0] << '\n';
  return true;
}

bool Display(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 0, "no argument", error)) return false;
  if (!session.Root()) {
    error = "no model is open";
    return false;
  }
  QelModelPrinter::Print(session.Root(), session.Out());
  return true;
}

bool NeedModel(QelHostSession& session, std::string& error) {
  if (session.Root()) return true;
  error = "no model is open";
  return false;
}

bool Thumbnail(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 2, "a view or capture name (or \"*\") and a PNG file (or a folder for \"*\")", error) ||
      !NeedModel(session, error))
    return false;
  QelReviewFramework::Register();
  session.Out().flush();
  // The plug-in is loaded globally, so the program's own handle finds its toolbox.
  static void* const global = dlopen(nullptr, RTLD_NOW);
  if (QelHostPictures::WriteThumbnails(global, session.Root(), args[0], args[1]) != 0) {
    error = "thumbnail '" + args[0] + "' not written (see above)";
    return false;
  }
  return true;
}

bool Picture(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 1, "a PNG file", error) || !NeedModel(session, error)) return false;
  QelReviewFramework::Register();
  session.Out().flush();
  if (QelHostPictures::WritePicture(session.Root(), session.Viewer(), args[0]) != 0) {
    error = "picture not written (see above)";
    return false;
  }
  return true;
}

bool Widgets(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  const bool json = args.size() == 1 && args[0] == "json";
  if (!json && !NeedArguments(args, 0, "no argument, or json", error)) return false;
  std::string text;
  if (!session.Review() || session.Review()->PrintWidgets(text, json) != S_OK) {
    error = "the panel's widgets could not be built";
    return false;
  }
  session.Out() << text;
  return true;
}

bool Help(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 0, "no argument", error)) return false;
  for (const QelHostCommand& command : QelHostCommandTable()) {
    std::string head = std::string(command.name) + (*command.arguments ? " " : "") + command.arguments;
    session.Out() << "  " << head << std::string(head.size() < 16 ? 16 - head.size() : 1, ' ') << command.summary
                  << '\n';
  }
  return true;
}

bool Quit(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 0, "no argument", error)) return false;
  session.RequestQuit();
  return true;
}
}  // namespace

std::vector<QelHostCommand>& QelHostCommandTable() {
  static std::vector<QelHostCommand> table = {
      {"open", "FILE", "open a product model (the sample is open at start)", &Open},
      {"facets", "", "print the facets as trees: label path, kind, check state", &Facets},
      {"tick", "PATH", "tick a property by its label path and print what the display changed", &Tick},
      {"untick", "PATH", "untick a property by its label path", &Untick},
      {"answer", "yes|no", "answer the next confirmation question ahead", &Answer},
      {"display", "", "print the model with what is shown and hidden", &Display},
      {"widgets", "[json]", "print the panel's facet widgets as a person sees them (or as JSON)", &Widgets},
      {"thumbnail", "NAME FILE", "write the thumbnail of a view or capture as PNG (NAME \"*\": all, into a folder)", &Thumbnail},
      {"picture", "FILE", "write a picture of the whole model, as shown, as PNG", &Picture},
      {"browser", "[thumbnails DIR]", "print the views browser, or write its thumbnails and an index.html into DIR", &QelHostBrowserCommand},
      {"activate", "NAME", "activate a browser item: a capture's viewpoint and display are applied", &QelHostActivateCommand},
      {"help", "", "list the commands", &Help},
      {"quit", "", "end the session", &Quit},
  };
  return table;
}

bool QelHostSplitLine(const std::string& line, std::vector<std::string>& words, std::string& error) {
  words.clear();
  size_t i = 0;
  while (i < line.size()) {
    if (line[i] == ' ' || line[i] == '\t' || line[i] == '\r') {
      ++i;
      continue;
    }
    std::string word;
    if (line[i] == '"') {
      const size_t end = line.find('"', i + 1);
      if (end == std::string::npos) {
        error = "unterminated quote";
        return false;
      }
      word = line.substr(i + 1, end - i - 1);
      i = end + 1;
    } else {
      while (i < line.size() && line[i] != ' ' && line[i] != '\t' && line[i] != '\r') word += line[i++];
    }
    words.push_back(word);
  }
  return true;
}
