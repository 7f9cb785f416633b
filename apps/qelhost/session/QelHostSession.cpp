#include "QelHostSession.h"

#include <editline/readline.h>
#include <signal.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <filesystem>

#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelDlgNotify.h"
#include "QelFrmLayout.h"
#include "QelHostCommands.h"
#include "QelHostDisplayReasons.h"
#include "QelHostModelFiles.h"
#include "QelModelLoader.h"
#include "QelModelScene.h"
#include "QelPLMProductOccurrence.h"
#include "QelPathElement.h"
#include "QelRovFacetServices.h"
#include "QelSampleProduct.h"
#include "QelSettingRepository.h"

namespace {
bool IsShown(QelBaseUnknown* object) { return QelRovFacetServices::IsDisplayEnabled(object) == S_OK; }

using QelHostDisplayReasons::NameOf;

volatile std::sig_atomic_t interrupted = 0;

void OnInterrupt(int) { interrupted = 1; }

// What a read from the terminal gave.
enum class Read { Line, Interrupted, End };

// One line from the terminal with editing and history. Ctrl-C abandons the line being
// typed (Interrupted); Ctrl-D on an empty line ends the input (End).
Read ReadLine(const char* prompt, std::string& line) {
  interrupted = 0;
  char* read = readline(prompt);
  if (interrupted) {
    std::free(read);
    std::fputs("\n", stdout);
    return Read::Interrupted;
  }
  if (!read) {
    // The terminal's cursor is left after the prompt: end the line for the shell.
    std::fputs("\n", stdout);
    return Read::End;
  }
  line = read;
  std::free(read);
  return Read::Line;
}

// Ctrl-C reaches the session as an interruption of the read, not as the end of qelhost.
// Installed while the session reads the terminal.
class InterruptScope {
 public:
  InterruptScope() {
    struct sigaction action {};
    action.sa_handler = &OnInterrupt;
    sigemptyset(&action.sa_mask);
    action.sa_flags = 0;  // no restart: the read returns
    sigaction(SIGINT, &action, &previous_);
  }
  ~InterruptScope() { sigaction(SIGINT, &previous_, nullptr); }
  InterruptScope(const InterruptScope&) = delete;
  InterruptScope& operator=(const InterruptScope&) = delete;

 private:
  struct sigaction previous_ {};
};

std::string HistoryFile() { return QelSettingRepository::SettingsFolder() + "/qelhost_history"; }
}  // namespace

QelHostSession::QelHostSession(std::ostream& out, std::ostream& err) : out_(out), err_(err) {
  // The questions the facets ask take the frame's main window as parent.
  QelApplicationFrame::CreateFrame(QelString(kDefaultWorkbench));
  QelDlgNotify::SetRefusalReporter([this](const QelUnicodeString& report) { out_ << report.Utf8() << '\n'; });
}

QelHostSession::~QelHostSession() {
  QelDlgNotify::SetRefusalReporter(nullptr);
  QelDlgNotify::SetAsker(nullptr);
  if (displayCallback_) QelCallbackManager::Get().RemoveCallback(displayCallback_);
  controller_ = nullptr;
  if (QelApplicationFrame* frame = QelApplicationFrame::GetFrame()) {
    if (editor_) frame->GetLayout()->CloseEditor(editor_.get());
  }
  if (window_) window_->SetViewer(nullptr);
  QelDelayedDestruction::FlushIdle();
}

bool QelHostSession::Open(const std::string& path, std::string& error) {
  QelBaseUnknown_var root;
  const HRESULT loaded = path.empty() ? QelModelLoader::LoadText(kQelSampleProductText, kQelSampleProductName, root, error)
                                      : QelHostModelFiles::Load(path, root, error, out_);
  if (loaded != S_OK) return false;
  return Attach(root, path.empty() ? kQelSampleProductName : path, error);
}

bool QelHostSession::Attach(const QelBaseUnknown_var& root, const std::string& name, std::string& error) {
  auto controller = QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController");
  if (!controller) {
    error = "the plug-in gives no panel controller (is it loaded, is QEL_REFINEMENT_DEV 0?)";
    return false;
  }
  auto editor = QelMakeVar<QelFrmEditor>(root.get());
  if (displayCallback_) QelCallbackManager::Get().RemoveCallback(displayCallback_);
  displayCallback_ = QelRovFacetServices::AddDisplayChangeCallback(
      root.get(), editor.get(), [this](QelBaseUnknown*, QelBaseUnknown* object) {
        if (!recording_ || !object) return;
        QelBaseUnknown_var held(object);
        if (shownBefore_.emplace(held->GetImpl(), !IsShown(object)).second) changed_.push_back(held);
      });
  // The editor's 3D window, current in the frame's layout: what pictures are drawn from
  // and where thumbnails take their view modes.
  QelFrmLayout* layout = QelApplicationFrame::GetFrame()->GetLayout();
  // The model open before goes with its editor; the controller drops its panel.
  if (editor_) layout->CloseEditor(editor_.get());
  if (window_) window_->SetViewer(nullptr);
  auto window = QelMakeVar<Qel3DWindow>(editor.get());
  auto viewer = QelMakeVar<Qel3DViewer>(800, 600);
  viewer->SetSceneSource(QelMakeVar<QelModelScene>(root.get()).get());
  window->SetViewer(viewer.get());
  layout->AddWindow(window.get());
  layout->SetCurrentWindow(window.get());
  // The root is the UI-active object, as when a product is opened; its editor is the
  // current one by now, as listeners of the change expect.
  auto active = QelMakeVar<QelPathElement>();
  active->AddChildElement(root.get());
  editor->SetUIActivePath(active.get());
  window_ = window;
  viewer_ = viewer;
  root_ = root;
  editor_ = editor;
  controller_ = controller;
  out_ << "model " << name << " open\n";
  SwitchPanelOnByDefault();
  controller_->CreateDataFilteringPanelIfNecessary();
  QelDelayedDestruction::FlushIdle();
  activatedCapture_.clear();
  openingMarks_ = QelHostPanel::Marks(QelHostPanel::ReadRows(QelHostPanel::Find(editor_.get())));
  return true;
}

void QelHostSession::SwitchPanelOnByDefault() {
  // A person who never switched the panel off in this workbench gets it; the choice is
  // kept in memory only until someone saves the repository.
  QelFrmContext* context = QelFrmContext::GetContext();
  QelSettingRepository* repository = QelSettingRepository::GetRepository("QelRovDataFiltering");
  if (!context || !repository) return;
  const std::string key = std::string("DataFilteringPanel_") + context->GetWorkbenchName().CastToCharPtr();
  if (!repository->IsPresent(key.c_str())) repository->WriteSetting(key.c_str(), 1, 1);
}

void QelHostSession::BeginChanges() {
  changed_.clear();
  shownBefore_.clear();
  recording_ = true;
}

void QelHostSession::EndChanges() {
  recording_ = false;
  std::string shown, hidden;
  for (const auto& object : changed_) {
    const bool now = IsShown(object.get());
    if (now == shownBefore_[object->GetImpl()]) continue;
    std::string& list = now ? shown : hidden;
    list += (list.empty() ? "" : ", ") + NameOf(object.get());
  }
  if (shown.empty() && hidden.empty()) out_ << "  no display change\n";
  if (!shown.empty()) out_ << "  shown: " << shown << '\n';
  if (!hidden.empty()) out_ << "  hidden: " << hidden << '\n';
  changed_.clear();
  shownBefore_.clear();
}

bool QelHostSession::Execute(const std::string& line, std::string& error) {
  std::vector<std::string> words;
  if (!QelHostSplitLine(line, words, error)) return false;
  if (words.empty() || words[0][0] == '#') return true;
  for (const QelHostCommand& command : QelHostCommandTable()) {
    if (words[0] != command.name) continue;
    const bool done = command.run(*this, std::vector<std::string>(words.begin() + 1, words.end()), error);
    // The line is over: the host is idle.
    QelDelayedDestruction::FlushIdle();
    if (done) return true;
    error = words[0] + ": " + error;
    return false;
  }
  error = "unknown command \"" + words[0] + "\" (help lists the commands)";
  return false;
}

int QelHostSession::RunScript(std::istream& in, const std::string& name) {
  std::string line;
  for (int number = 1; !quit_ && std::getline(in, line); ++number) {
    std::string error;
    if (!Execute(line, error)) {
      out_.flush();
      err_ << name << ":" << number << ": " << error << '\n';
      return 1;
    }
  }
  return 0;
}

int QelHostSession::RunInteractive() {
  QelDlgNotify::SetAsker([this](const QelDlgNotify&, const QelUnicodeString& message, const QelUnicodeString& title) {
    out_ << title.Utf8() << '\n' << message.Utf8() << '\n';
    out_.flush();
    for (std::string answer;;) {
      const Read read = ReadLine("yes/no? ", answer);
      // Ctrl-C at the question is a no; only the end of input leaves it unanswered.
      if (read == Read::Interrupted) return QelDlgNotify::AnswerNo;
      if (read == Read::End) return QelDlgNotify::AnswerNone;
      if (answer == "yes" || answer == "y") return QelDlgNotify::AnswerYes;
      if (answer == "no" || answer == "n") return QelDlgNotify::AnswerNo;
    }
  });
  const InterruptScope interrupts;
  // The lines of earlier sessions come back with the arrow keys.
  const std::string history = HistoryFile();
  std::error_code ignored;
  std::filesystem::create_directories(QelSettingRepository::SettingsFolder(), ignored);
  stifle_history(1000);
  read_history(history.c_str());
  out_ << "qelhost review session; help lists the commands, quit or Ctrl-D ends it\n";
  std::string line;
  for (int number = 1; !quit_; ++number) {
    out_.flush();
    const Read read = ReadLine("qelhost> ", line);
    if (read == Read::End) break;
    if (read == Read::Interrupted) continue;
    if (!line.empty()) {
      add_history(line.c_str());
      write_history(history.c_str());
    }
    std::string error;
    if (!Execute(line, error)) out_ << "line " << number << ": " << error << '\n';
  }
  QelDlgNotify::SetAsker(nullptr);
  return 0;
}

bool QelHostSession::MakeUIActive(QelBaseUnknown* product) {
  auto* occurrence = QelSysDynamicCast<QelPLMProductOccurrence>(product);
  if (!editor_ || !occurrence) return false;
  // The path runs from the root down to the product, as a click in a product tree makes it.
  std::vector<QelPLMProductOccurrence*> chain;
  for (QelPLMProductOccurrence* at = occurrence; at; at = at->Father()) chain.push_back(at);
  auto path = QelMakeVar<QelPathElement>();
  for (auto it = chain.rbegin(); it != chain.rend(); ++it) path->AddChildElement(*it);
  editor_->SetUIActivePath(path.get());
  return true;
}
