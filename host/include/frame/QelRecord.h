#pragma once
// QelRecord: the host's recorder of user input. At most one main recorder exists; while it
// captures or replays, commands that depend on live window state may refuse to start.
// Owned by the host program (SetMain); GetMain lends it.
#include "QelVar.h"

class QelRecord : public QelBaseUnknown {
 public:
  enum class Mode { Idle, Capture, Replay };
  explicit QelRecord(Mode mode = Mode::Idle) : mode_(mode) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // Borrowed; null when the host runs without a recorder.
  static QelRecord* GetMain();
  // Installs (null: removes) the main recorder, holding it.
  static void SetMain(QelRecord* recorder);

  bool IsCapture() const { return mode_ == Mode::Capture; }
  bool IsReplay() const { return mode_ == Mode::Replay; }
  void SetMode(Mode mode) { mode_ = mode; }

 protected:
  ~QelRecord() override = default;

 private:
  Mode mode_;
};
