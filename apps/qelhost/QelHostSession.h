#pragma once
// QelHostSession: qelhost's review session. It holds the open model, its editor and the
// plug-in's facet review of that editor, and runs command lines (QelHostCommands) from a
// terminal, a script file or standard input. A script stops at its first bad line; a
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
#include "QelIRovFacetReview.h"

class QelHostSession {
 public:
  QelHostSession(std::ostream& out, std::ostream& err);
  ~QelHostSession();
  QelHostSession(const QelHostSession&) = delete;
  QelHostSession& operator=(const QelHostSession&) = delete;

  // Opens a model file (empty: the embedded sample) and the facets of its editor. False
  // with `error` when the file or the plug-in's review cannot be had; the model open
  // before stays open then.
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

  bool QuitRequested() const { return quit_; }
  void RequestQuit() { quit_ = true; }

  std::ostream& Out() { return out_; }
  QelBaseUnknown* Root() const { return root_.get(); }
  QelIRovFacetReview* Review() const { return review_.get(); }
  // The open model's 3D viewer, in the current window.
  Qel3DViewer* Viewer() const { return viewer_.get(); }

  // Starts recording the display changes of the open model; EndChanges prints the objects
  // whose shown state differs from before, by name.
  void BeginChanges();
  void EndChanges();

 private:
  std::ostream& out_;
  std::ostream& err_;
  QelBaseUnknown_var root_;
  QelVar<QelFrmEditor> editor_;
  QelVar<Qel3DWindow> window_;
  QelVar<Qel3DViewer> viewer_;
  QelVar<QelIRovFacetReview> review_;
  QelCallbackId displayCallback_ = 0;
  bool recording_ = false;
  std::vector<QelBaseUnknown_var> changed_;           // in order of first change
  std::map<QelBaseUnknown*, bool> shownBefore_;       // state before the first change
  bool quit_ = false;
};
