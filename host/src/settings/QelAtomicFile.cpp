#include "QelAtomicFile.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <vector>

namespace fs = std::filesystem;

namespace {
std::function<int(QelAtomicFile::Step)>& FaultHook() {
  static auto* hook = new std::function<int(QelAtomicFile::Step)>;
  return *hook;
}

// The injected errno for `step`, or 0 to run the real call.
int Injected(QelAtomicFile::Step step) {
  auto& hook = FaultHook();
  return hook ? hook(step) : 0;
}

const char* StepName(QelAtomicFile::Step step) {
  switch (step) {
    case QelAtomicFile::Step::Create: return "creating";
    case QelAtomicFile::Step::Write: return "writing";
    case QelAtomicFile::Step::Sync: return "syncing";
    case QelAtomicFile::Step::Close: return "closing";
    case QelAtomicFile::Step::Rename: return "renaming";
    case QelAtomicFile::Step::SyncFolder: return "syncing the folder of";
  }
  return "?";
}

std::string FolderOf(const std::string& path) {
  std::string folder = fs::path(path).parent_path().string();
  return folder.empty() ? "." : folder;
}

// "<target>.tmp-<pid>-": the pid tells a later save whether the writer is gone.
std::string TemporaryPrefix(const std::string& target) { return target + ".tmp-"; }
}  // namespace

QelAtomicFile::QelAtomicFile(std::string target, std::string temporary, int fd)
    : target_(std::move(target)), temporary_(std::move(temporary)), fd_(fd) {}

QelAtomicFile::QelAtomicFile(QelAtomicFile&& other) noexcept
    : target_(std::move(other.target_)), temporary_(std::move(other.temporary_)), fd_(other.fd_) {
  other.temporary_.clear();
  other.fd_ = -1;
}

QelAtomicFile::~QelAtomicFile() { Discard(); }

std::optional<QelAtomicFile> QelAtomicFile::Create(const std::string& target, std::string& error) {
  std::string name = TemporaryPrefix(target) + std::to_string(::getpid()) + "-XXXXXX";
  std::vector<char> pattern(name.begin(), name.end());
  pattern.push_back('\0');
  int code = Injected(Step::Create);
  int fd = code ? -1 : ::mkostemp(pattern.data(), O_CLOEXEC);
  if (fd < 0) {
    if (!code) code = errno;
    error = std::string(StepName(Step::Create)) + " a temporary next to '" + target + "' failed (" +
            std::strerror(code) + ")";
    return std::nullopt;
  }
  // mkostemp makes the file 0600; settings are as readable as any file the user makes.
  mode_t mask = ::umask(0);
  ::umask(mask);
  ::fchmod(fd, 0666 & ~mask);
  return QelAtomicFile(target, pattern.data(), fd);
}

bool QelAtomicFile::Fail(Step step, int code, std::string& error) {
  error = std::string(StepName(step)) + " '" + (step == Step::SyncFolder ? target_ : temporary_) + "' failed (" +
          std::strerror(code) + ")";
  if (step != Step::SyncFolder) Discard();
  return false;
}

bool QelAtomicFile::Write(std::string_view bytes, std::string& error) {
  if (fd_ < 0) return Fail(Step::Write, EBADF, error);
  if (int code = Injected(Step::Write)) return Fail(Step::Write, code, error);
  while (!bytes.empty()) {
    ssize_t n = ::write(fd_, bytes.data(), bytes.size());
    if (n < 0) {
      if (errno == EINTR) continue;
      return Fail(Step::Write, errno, error);
    }
    bytes.remove_prefix(static_cast<size_t>(n));
  }
  return true;
}

bool QelAtomicFile::Keep(std::string& error) {
  if (fd_ < 0) return Fail(Step::Close, EBADF, error);
  int code = Injected(Step::Sync);
  if (code || ::fsync(fd_) != 0) return Fail(Step::Sync, code ? code : errno, error);
  code = Injected(Step::Close);
  int closed = ::close(fd_);
  fd_ = -1;  // closed even when close reports an error: never close it twice
  if (code || closed != 0) return Fail(Step::Close, code ? code : errno, error);
  code = Injected(Step::Rename);
  if (code || ::rename(temporary_.c_str(), target_.c_str()) != 0) return Fail(Step::Rename, code ? code : errno, error);
  temporary_.clear();
  // Without syncing the folder the rename itself could be lost in a power cut.
  code = Injected(Step::SyncFolder);
  int folder = code ? -1 : ::open(FolderOf(target_).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (folder < 0) return Fail(Step::SyncFolder, code ? code : errno, error);
  int synced = ::fsync(folder);
  code = errno;
  ::close(folder);
  if (synced != 0) return Fail(Step::SyncFolder, code, error);
  return true;
}

void QelAtomicFile::Discard() {
  if (fd_ >= 0) ::close(fd_);
  fd_ = -1;
  if (!temporary_.empty()) ::unlink(temporary_.c_str());
  temporary_.clear();
}

void QelAtomicFile::RemoveStaleTemporaries(const std::string& target) {
  const std::string prefix = fs::path(TemporaryPrefix(target)).filename().string();
  std::error_code ec;
  for (fs::directory_iterator it(FolderOf(target), ec), end; !ec && it != end; it.increment(ec)) {
    const std::string name = it->path().filename().string();
    if (name.compare(0, prefix.size(), prefix) != 0) continue;
    char* rest = nullptr;
    long pid = std::strtol(name.c_str() + prefix.size(), &rest, 10);
    if (pid <= 0 || *rest != '-') continue;
    // This process saves one file at a time, so a temporary of its own is a leftover too.
    if (pid != ::getpid() && (::kill(static_cast<pid_t>(pid), 0) == 0 || errno != ESRCH)) continue;
    std::error_code ignored;
    fs::remove(it->path(), ignored);
  }
}

void QelAtomicFile::SetFaultHookForTesting(std::function<int(Step)> hook) { FaultHook() = std::move(hook); }
