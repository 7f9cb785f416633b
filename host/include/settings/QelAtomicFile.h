#pragma once
// QelAtomicFile: replaces one file in a single step. Create makes a uniquely named temporary
// next to the target; Write fills it; Keep syncs it, renames it over the target and syncs the
// folder; Discard (or the destructor) removes it. Whoever decides what to write owns one of
// these for the length of one save; a process killed in between leaves the old file whole
// and a temporary that RemoveStaleTemporaries clears later.
//
//   std::string error;
//   auto file = QelAtomicFile::Create("/x/Prefs.json", error);
//   if (!file || !file->Write(text, error) || !file->Keep(error)) report(error);
#include <functional>
#include <optional>
#include <string>
#include <string_view>

class QelAtomicFile {
 public:
  // The steps a save goes through, for the fault hook.
  enum class Step { Create, Write, Sync, Close, Rename, SyncFolder };

  static std::optional<QelAtomicFile> Create(const std::string& target, std::string& error);
  QelAtomicFile(QelAtomicFile&& other) noexcept;
  QelAtomicFile& operator=(QelAtomicFile&&) = delete;
  ~QelAtomicFile();

  bool Write(std::string_view bytes, std::string& error);
  // False with `error` when any step fails. A failure before the rename leaves the target
  // as it was; a failed folder sync after it leaves the new file in place but not durable,
  // and is still a failure.
  bool Keep(std::string& error);
  void Discard();

  const std::string& TemporaryPath() const { return temporary_; }

  // Removes the temporaries of `target` whose process no longer runs (a crash mid-save).
  // Temporaries of live processes are left alone: they may be saving right now.
  static void RemoveStaleTemporaries(const std::string& target);

  // For tests: called before each step; a non-zero errno makes the step fail with it as if
  // the system call had. Runs before Rename too, so a hook may end the process there. An
  // empty function removes the hook.
  static void SetFaultHookForTesting(std::function<int(Step)> hook);

 private:
  QelAtomicFile(std::string target, std::string temporary, int fd);
  bool Fail(Step step, int code, std::string& error);

  std::string target_;
  std::string temporary_;
  int fd_ = -1;
};
