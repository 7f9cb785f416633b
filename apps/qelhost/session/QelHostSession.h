#pragma once
// QelHostSession: qelhost's review session. It holds the open model, its editor and 3D
// window, and the plug-in's panel controller, and runs command lines (QelHostCommands)
// from a terminal, a script file or standard input. After every line the host is idle:
// delayed destructions are done. A script stops at its first bad line; a
// person at a terminal is told what was wrong and goes on.
#include <istream>
#include <map>
#include <ostream>
#include <string>
#include <vector>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelCallbackManager.h"
#include "QelFrmEditor.h"
#include "QelHostPanel.h"
#include "QelIHyxFacetCtrl.h"

// The workbench a session starts in: one of those that have the panel.
inline constexpr const char* kDefaultWorkbench = "LumReview";

class QelHostSession {
 public:
  QelHostSession(std::ostream& out, std::ostream& err);
  ~QelHostSession();
  QelHostSession(const QelHostSession&) = delete;
  QelHostSession& operator=(const QelHostSession&) = delete;

  // Opens a model file (empty: the embedded sample) in a new editor and 3D window, which
  // replace the open ones, and asks the plug-in's controller for the panel. False with
  // `error` when the file or the controller cannot be had; the model open before stays
  // open then.
  bool Open(const std::string& path, std::string& error);
  // Takes a model already loaded as the open one.
  bool Attach(const QelBaseUnknown_var& root, const std::string& name, std::string& error);

  // Runs one command line. False with `error` (the reason) for a bad line.
  bool Execute(const std::string& line, std::string& error);
  // Every line of `in`; stops at the first bad one, reported as "<name>:<line>: <reason>"
  // on the error stream. 0, or 1 after a bad line.
  int RunScript(std::istream& in, const std::string& name);
  // Reads lines with a prompt and line editing until quit or end of input; bad lines are
  // reported and the session goes on. Also answers the confirmation questions.
  int RunInteractive();

  // The loaded plug-in (a QelModuleLoader handle), for the functions it exports by name.
  void SetModule(void* module) { module_ = module; }
  void* Module() const { return module_; }

  bool QuitRequested() const { return quit_; }
  void RequestQuit() { quit_ = true; }

  std::ostream& Out() { return out_; }
  QelBaseUnknown* Root() const { return root_.get(); }
  QelFrmEditor* Editor() const { return editor_.get(); }
  // Makes `product` (a product of the open model) the UI-active object, along its path from
  // the root; the views browser follows. False without an editor or for another object.
  bool MakeUIActive(QelBaseUnknown* product);
  QelIHyxFacetCtrl* Controller() const { return controller_.get(); }
  // The open model's 3D viewer, in the current window.
  Qel3DViewer* Viewer() const { return viewer_.get(); }

  // Starts recording the display changes of the open model; EndChanges prints the objects
  // whose shown state differs from before, by name.
  void BeginChanges();
  void EndChanges();

  // The panel's boxes and radios as they read once the model was open: what `reset`
  // brings back.
  const std::vector<QelHostPanelMark>& OpeningMarks() const { return openingMarks_; }
  // The capture activated last, which hid what its view does not hold; empty after reset.
  const std::string& ActivatedCapture() const { return activatedCapture_; }
  void SetActivatedCapture(std::string name) { activatedCapture_ = std::move(name); }

 private:
  void SwitchPanelOnByDefault();

  std::ostream& out_;
  std::ostream& err_;
  QelBaseUnknown_var root_;
  QelVar<QelFrmEditor> editor_;
  QelVar<Qel3DWindow> window_;
  QelVar<Qel3DViewer> viewer_;
  QelVar<QelIHyxFacetCtrl> controller_;
  QelCallbackId displayCallback_ = 0;
  bool recording_ = false;
  std::vector<QelBaseUnknown_var> changed_;           // in order of first change
  std::map<QelBaseUnknown*, bool> shownBefore_;       // state before the first change
  bool quit_ = false;
  void* module_ = nullptr;
  std::vector<QelHostPanelMark> openingMarks_;
  std::string activatedCapture_;
};
