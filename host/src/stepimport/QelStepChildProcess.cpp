#include "QelStepChildProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstring>

namespace {
// Address-space limits would starve a sanitizer's shadow memory, which reserves terabytes.
#if defined(__SANITIZE_ADDRESS__)
constexpr bool kMayLimitMemory = false;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(memory_sanitizer) || __has_feature(thread_sanitizer)
constexpr bool kMayLimitMemory = false;
#else
constexpr bool kMayLimitMemory = true;
#endif
#else
constexpr bool kMayLimitMemory = true;
#endif

void Limit(int resource, rlim_t soft, rlim_t hard) {
  rlimit current{};
  if (getrlimit(resource, &current) != 0) return;
  if (current.rlim_max != RLIM_INFINITY) {
    soft = std::min(soft, current.rlim_max);
    hard = std::min(hard, current.rlim_max);
  }
  const rlimit wanted{soft, hard};
  setrlimit(resource, &wanted);
}

bool WriteAll(int fd, const std::string& bytes) {
  size_t done = 0;
  while (done < bytes.size()) {
    const ssize_t n = write(fd, bytes.data() + done, bytes.size() - done);
    if (n < 0 && errno == EINTR) continue;
    if (n <= 0) return false;
    done += static_cast<size_t>(n);
  }
  return true;
}

[[noreturn]] void Child(int fd, const std::function<std::string()>& work, const QelStepChildProcess::Limits& limits) {
  // A crash leaves no core file behind, and an exceeded processor time ends the child
  // with SIGXCPU, then SIGKILL a few seconds later should it catch that.
  Limit(RLIMIT_CORE, 0, 0);
  // Everything the person reads comes back through the pipe: whatever the translator, or a
  // sanitizer's report of its crash, would print goes nowhere, rather than between the
  // parent's own lines.
  if (const int null = open("/dev/null", O_WRONLY | O_CLOEXEC); null >= 0) {
    dup2(null, STDOUT_FILENO);
    dup2(null, STDERR_FILENO);
    close(null);
  }
  const auto cpu = static_cast<rlim_t>(limits.cpuSeconds + 0.999);
  Limit(RLIMIT_CPU, cpu, cpu + 5);
  if (kMayLimitMemory && limits.memoryBytes > 0) Limit(RLIMIT_AS, limits.memoryBytes, limits.memoryBytes);
  std::string bytes;
  try {
    bytes = work();
  } catch (...) {
    _exit(3);
  }
  // _exit: the parent's buffered output and its exit handlers are not the child's to run.
  _exit(WriteAll(fd, bytes) ? 0 : 4);
}
}  // namespace

QelStepChildProcess::Outcome QelStepChildProcess::Run(const std::function<std::string()>& work, const Limits& limits) {
  Outcome outcome;
  int fds[2];
  if (pipe2(fds, O_CLOEXEC) != 0) {
    outcome.failure = std::string("cannot make a pipe: ") + std::strerror(errno);
    return outcome;
  }
  const pid_t pid = fork();
  if (pid < 0) {
    outcome.failure = std::string("cannot start a process: ") + std::strerror(errno);
    close(fds[0]);
    close(fds[1]);
    return outcome;
  }
  if (pid == 0) {
    close(fds[0]);
    Child(fds[1], work, limits);
  }
  close(fds[1]);
  // The pipe is drained while the child writes, or a large model would fill it and stall.
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::duration<double>(limits.wallSeconds);
  char buffer[1 << 16];
  for (;;) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - std::chrono::steady_clock::now());
    if (left.count() <= 0) {
      kill(pid, SIGKILL);
      outcome.outOfTime = true;
      break;
    }
    pollfd watch{fds[0], POLLIN, 0};
    const int ready = poll(&watch, 1, static_cast<int>(std::min<long long>(left.count(), 1000)));
    if (ready < 0 && errno != EINTR) break;
    if (ready <= 0) continue;
    const ssize_t n = read(fds[0], buffer, sizeof buffer);
    if (n < 0 && errno == EINTR) continue;
    if (n <= 0) break;
    outcome.bytes.append(buffer, static_cast<size_t>(n));
  }
  close(fds[0]);
  int status = 0;
  while (waitpid(pid, &status, 0) < 0 && errno == EINTR) {
  }
  if (WIFSIGNALED(status)) {
    outcome.signal = WTERMSIG(status);
    if (outcome.signal == SIGXCPU) outcome.outOfTime = true;
  }
  outcome.finished = !outcome.outOfTime && WIFEXITED(status) && WEXITSTATUS(status) == 0;
  return outcome;
}
