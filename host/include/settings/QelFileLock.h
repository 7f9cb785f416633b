#pragma once
// QelFileLock: an advisory lock, held by one process at a time, on a lock file beside the
// file it guards ("<file>.lock", made if missing and never removed, since removing it would
// let two processes lock two different files). Held from a successful Acquire until the
// object goes; a process that dies lets go of it by itself.
//
//   std::string error;
//   auto lock = QelFileLock::Acquire("/x/Prefs.json", std::chrono::seconds(5), error);
//   if (!lock) report(error);  // read, merge and write /x/Prefs.json while `lock` lives
#include <chrono>
#include <optional>
#include <string>

class QelFileLock {
 public:
  // Waits up to `patience` for the lock; nullopt with `error` when it is not had by then or
  // the lock file cannot be made.
  static std::optional<QelFileLock> Acquire(const std::string& guarded, std::chrono::milliseconds patience,
                                            std::string& error);
  QelFileLock(QelFileLock&& other) noexcept;
  QelFileLock& operator=(QelFileLock&&) = delete;
  ~QelFileLock();

  static std::string LockPathOf(const std::string& guarded) { return guarded + ".lock"; }

 private:
  explicit QelFileLock(int fd) : fd_(fd) {}
  int fd_ = -1;
};
