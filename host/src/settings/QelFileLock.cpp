#include "QelFileLock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <thread>

std::optional<QelFileLock> QelFileLock::Acquire(const std::string& guarded, std::chrono::milliseconds patience,
                                                std::string& error) {
  const std::string path = LockPathOf(guarded);
  const int fd = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0644);
  if (fd < 0) {
    error = "the lock file '" + path + "' cannot be opened (" + std::strerror(errno) + ")";
    return std::nullopt;
  }
  const auto deadline = std::chrono::steady_clock::now() + patience;
  // Polled rather than blocking, so that the wait has an end; saves take milliseconds, so a
  // short pause between tries costs little.
  for (auto pause = std::chrono::milliseconds(1);; pause = std::min(pause * 2, std::chrono::milliseconds(50))) {
    if (::flock(fd, LOCK_EX | LOCK_NB) == 0) return QelFileLock(fd);
    if (errno != EWOULDBLOCK && errno != EINTR) {
      error = "the lock file '" + path + "' cannot be locked (" + std::strerror(errno) + ")";
      break;
    }
    if (std::chrono::steady_clock::now() >= deadline) {
      error = "another process held the lock '" + path + "' for longer than " +
              std::to_string(patience.count()) + " ms";
      break;
    }
    std::this_thread::sleep_for(pause);
  }
  ::close(fd);
  return std::nullopt;
}

QelFileLock::QelFileLock(QelFileLock&& other) noexcept : fd_(other.fd_) { other.fd_ = -1; }

QelFileLock::~QelFileLock() {
  // Closing the only descriptor of the open file lets go of the lock.
  if (fd_ >= 0) ::close(fd_);
}
