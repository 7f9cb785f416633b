#include "QelHostModelFiles.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <vector>

#include "QelModelJsonWriter.h"
#include "QelModelLoader.h"
#include "QelStepImporter.h"

namespace {
// Smaller files import in well under a second: no progress line for them.
constexpr off_t kProgressFromBytes = 1 << 20;

QelStepImportOptions ProgressOptions(const std::string& path) {
  QelStepImportOptions options;
  struct stat info {};
  if (!isatty(STDERR_FILENO) || ::stat(path.c_str(), &info) != 0 || info.st_size < kProgressFromBytes) return options;
  options.progress = [path](const char* stage, double done) {
    const bool finished = std::string(stage) == "done";
    std::fprintf(stderr, "\rimporting %s: %-12s %3d%%%s", path.c_str(), finished ? "" : stage,
                 static_cast<int>(done * 100.0 + 0.5), finished ? "\n" : "");
    std::fflush(stderr);
  };
  return options;
}
}  // namespace

HRESULT QelHostModelFiles::Load(const std::string& path, QelBaseUnknown_var& root, std::string& error,
                                std::ostream& notes) {
  if (!QelStepImporter::IsStepFile(path)) return QelModelLoader::LoadFile(path, root, error);
  std::vector<std::string> lines;
  const HRESULT imported = QelStepImporter::ImportFile(path, root, error, lines, ProgressOptions(path));
  for (const std::string& line : lines) notes << line << '\n';
  return imported;
}

bool QelHostModelFiles::ExportJson(QelBaseUnknown* root, const std::string& path, std::string& error) {
  return QelModelJsonWriter::WriteFile(root, path, error);
}
