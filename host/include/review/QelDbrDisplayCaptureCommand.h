#pragma once
// QelDbrDisplayCaptureCommand: the command behind the header "QelTPSDisplayCaptureHdr". It
// takes the capture selected in the current editor, puts the capture's viewpoint on the
// current window's viewer and shows the capture, its set, its linked view and what that view
// holds, hiding every other annotation of the model. Static; no state.
#include "QelVar.h"

class Qel3DViewer;

class QelDbrDisplayCaptureCommand {
 public:
  QelDbrDisplayCaptureCommand() = delete;

  static constexpr const char* kHeaderName = "QelTPSDisplayCaptureHdr";

  // What the header runs: the current editor's selection, the current window's viewer.
  static void Run();
  // S_OK done; E_FAIL when `capture` is no capture of a model or `viewer` is null.
  static HRESULT Display(QelBaseUnknown* capture, Qel3DViewer* viewer);
};
