#include "QelStepFileHeader.h"

#include <sys/stat.h>

#include <algorithm>
#include <cctype>
#include <fstream>

namespace {
// The header section of real files is a few hundred bytes; anything this long without a
// schema is not a file we can read.
constexpr size_t kHeadBytes = 64 * 1024;
constexpr size_t kTailBytes = 256;

std::string Upper(std::string_view text) {
  std::string out(text);
  std::transform(out.begin(), out.end(), out.begin(), [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
  return out;
}

std::string_view TrimFront(std::string_view text) {
  if (text.substr(0, 3) == "\xEF\xBB\xBF") text.remove_prefix(3);
  while (!text.empty() && std::isspace(static_cast<unsigned char>(text.front()))) text.remove_prefix(1);
  return text;
}

std::string_view TrimBack(std::string_view text) {
  while (!text.empty() && (std::isspace(static_cast<unsigned char>(text.back())) || text.back() == '\0')) text.remove_suffix(1);
  return text;
}
}  // namespace

bool QelStepFileHeader::IsAP242() const {
  for (const std::string& schema : schemas) {
    const std::string name = Upper(schema);
    // The object identifier { 1 0 10303 442 ... } names the protocol where the text does not.
    if (name.find("AP242") != std::string::npos || name.find("10303 442") != std::string::npos) return true;
  }
  return false;
}

QelStepFileHeader QelStepFileHeader::Parse(std::string_view head, std::string_view tail) {
  QelStepFileHeader header;
  head = TrimFront(head);
  header.isStep = head.substr(0, 13) == "ISO-10303-21;";
  header.complete = Upper(TrimBack(tail)).ends_with("END-ISO-10303-21;");
  if (!header.isStep) return header;
  const std::string upper = Upper(head);
  size_t at = upper.find("FILE_SCHEMA");
  if (at == std::string::npos) return header;
  const size_t end = upper.find(");", at);
  const std::string_view list = head.substr(at, end == std::string::npos ? std::string_view::npos : end - at);
  // Schema names are the quoted strings of the list ('' inside a string is a quote).
  for (size_t i = 0; i < list.size(); ++i) {
    if (list[i] != '\'') continue;
    std::string name;
    for (++i; i < list.size(); ++i) {
      if (list[i] == '\'' && i + 1 < list.size() && list[i + 1] == '\'') {
        name += '\'';
        ++i;
      } else if (list[i] == '\'') {
        break;
      } else {
        name += list[i];
      }
    }
    header.schemas.push_back(name);
  }
  return header;
}

bool QelStepFileHeader::Read(const std::string& path, QelStepFileHeader& header, std::string& error) {
  struct stat info {};
  if (::stat(path.c_str(), &info) != 0) {
    error = path + ": cannot open the file";
    return false;
  }
  if (!S_ISREG(info.st_mode)) {
    error = path + ": not a regular file (a model is read from a regular file)";
    return false;
  }
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    error = path + ": cannot open the file";
    return false;
  }
  const auto size = static_cast<size_t>(info.st_size);
  if (size == 0) {
    error = path + ": the file is empty";
    return false;
  }
  std::string head(std::min(size, kHeadBytes), '\0');
  in.read(head.data(), static_cast<std::streamsize>(head.size()));
  std::string tail(std::min(size, kTailBytes), '\0');
  in.seekg(static_cast<std::streamoff>(size - tail.size()));
  in.read(tail.data(), static_cast<std::streamsize>(tail.size()));
  if (!in) {
    error = path + ": cannot read the file";
    return false;
  }
  header = Parse(head, tail);
  return true;
}
