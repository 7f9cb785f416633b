#include "QelHostCommands.h"

#include <ostream>

#include "QelDlgNotify.h"
#include "QelHostBrowser.h"
#include "QelHostPanelCommands.h"
#include "QelHostPictures.h"
#include "QelHostSession.h"
#include "QelModelPrinter.h"
#include "QelReviewFramework.h"

namespace {
bool NeedArguments(const std::vector<std::string>& args, size_t count, const char* usage, std::string& error) {
  if (args.size() == count) return true;
  error = std::string("expects ") + usage;
  return false;
}

bool Open(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 1, "one model file", error)) return false;
  return session.Open(args[0], error);
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
  if (QelHostPictures::WriteThumbnails(session.Module(), session.Root(), args[0], args[1]) != 0) {
    error = "thumbnail '" + args[0] + "' not written (see above)";
    return false;
  }
  return true;
}

bool Picture(QelHostSession& session, const std::vector<std::string>& args, std::string& error) {
  if (!NeedArguments(args, 1, "a PNG file", error) || !NeedModel(session, error)) return false;
  QelReviewFramework::Register();
  session.Out().flush();
  // After an activation the picture is the capture's, as the page shows it.
  if (QelHostPictures::WritePicture(session.Root(), session.Viewer(), args[0], !session.ActivatedCapture().empty()) != 0) {
    error = "picture not written (see above)";
    return false;
  }
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
      {"facets", "", "print the panel's rows as trees: label path, kind, check state", &QelHostPanelCommands::Facets},
      {"tick", "PATH", "click a row's box by its label path and print what the display changed", &QelHostPanelCommands::Tick},
      {"untick", "PATH", "click a ticked row's box by its label path", &QelHostPanelCommands::Untick},
      {"answer", "yes|no", "answer the next confirmation question ahead", &Answer},
      {"range", "PATH OP V [OP V]", "enter a tolerance range in a range row and apply it", &QelHostPanelCommands::Range},
      {"expand", "PATH", "unfold a section or a row with sub-rows", &QelHostPanelCommands::Expand},
      {"collapse", "PATH", "fold a section or a row with sub-rows", &QelHostPanelCommands::Collapse},
      {"scroll", "H V", "scroll the panel to the offsets", &QelHostPanelCommands::Scroll},
      {"refresh", "", "press the panel's refresh button", &QelHostPanelCommands::Refresh},
      {"close", "", "press the panel's close button (switches the panel off here)", &QelHostPanelCommands::Close},
      {"minimize", "", "minimize the docked panel", &QelHostPanelCommands::Minimize},
      {"restore", "", "show the minimized panel again", &QelHostPanelCommands::Restore},
      {"panel", "[json]", "print the panel as a person sees it (or as JSON)", &QelHostPanelCommands::Panel},
      {"widgets", "[json]", "the same as panel", &QelHostPanelCommands::Panel},
      {"display", "", "print the model with what is shown and hidden", &Display},
      {"window", "list|open K|activate N|close N", "the editor's windows (kinds 3d, 2dl, dft)", &QelHostPanelCommands::Window},
      {"workbench", "[NAME]", "switch workbench (LumReview, TPSCfg, GopLookoutWorkbench have the panel)", &QelHostPanelCommands::Workbench},
      {"setting", "KEY [INT]", "read or write a setting of QelRovDataFiltering", &QelHostPanelCommands::Setting},
      {"close-editor", "", "close the open model's editor", &QelHostPanelCommands::CloseEditor},
      {"select", "[NAME]", "select an object by name (none: empty the selection)", &QelHostPanelCommands::Select},
      {"light-load", "PRODUCT on|off", "switch a product's light-load mode", &QelHostPanelCommands::LightLoad},
      {"thumbnail", "NAME FILE", "write the thumbnail of a view or capture as PNG (NAME \"*\": all, into a folder)", &Thumbnail},
      {"picture", "FILE", "write a picture of the whole model, as shown, as PNG", &Picture},
      {"browser", "[thumbnails DIR]", "print the views browser, or write its thumbnails and an index.html into DIR", &QelHostBrowserCommand},
      {"activate", "NAME", "activate a browser item: a capture's viewpoint and display are applied", &QelHostActivateCommand},
      {"ui-active", "PRODUCT", "make a product UI-active: the views browser shows its sets", &QelHostPanelCommands::UiActive},
      {"why", "NAME", "say which row, switch, range, capture or set keeps an annotation from being drawn", &QelHostPanelCommands::Why},
      {"reset", "", "click the panel back to how it read when the model opened", &QelHostPanelCommands::Reset},
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
