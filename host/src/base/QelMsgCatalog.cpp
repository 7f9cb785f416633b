#include "QelMsgCatalog.h"

#include <fstream>
#include <map>
#include <set>
#include <string_view>
#include <unordered_map>

#include "QelAssert.h"

#ifndef QEL_RESOURCES_SOURCE_DIR
#define QEL_RESOURCES_SOURCE_DIR ""
#endif

namespace {
constexpr const char* kCatalogExtension = ".qelcat";

struct Catalog {
  bool found = false;
  std::unordered_map<std::string, std::string> texts;
};

// Parsed catalogs by file path, so that pointing QEL_RESOURCES_DIR elsewhere reads the
// other folder's files; each file is still parsed only once.
std::map<std::string, Catalog>& Cache() {
  static std::map<std::string, Catalog> cache;
  return cache;
}

bool IsKeyChar(char c) {
  return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '_' || c == '.' ||
         c == '-';
}

// A catalog name becomes part of a path: anything that could leave the folder is refused.
bool IsCatalogName(const char* name) {
  if (!name || !*name || *name == '.') return false;
  for (const char* p = name; *p; ++p)
    if (!IsKeyChar(*p)) return false;
  return true;
}

void SkipBlanks(std::string_view line, size_t& at) {
  while (at < line.size() && (line[at] == ' ' || line[at] == '\t')) ++at;
}

// Parses one line. Returns true for an entry (key and text filled) or a line with nothing
// to load (key left empty); false with `error` set for a malformed line.
bool ParseLine(std::string_view line, std::string& key, std::string& text, std::string& error) {
  size_t at = 0;
  SkipBlanks(line, at);
  if (at == line.size() || line.substr(at, 2) == "//") return true;
  size_t keyStart = at;
  while (at < line.size() && IsKeyChar(line[at])) ++at;
  if (at == keyStart) {
    error = "expected a key (letters, digits, '_', '.', '-')";
    return false;
  }
  std::string parsedKey(line.substr(keyStart, at - keyStart));
  SkipBlanks(line, at);
  if (at == line.size() || line[at] != '=') {
    error = "expected '=' after the key \"" + parsedKey + "\"";
    return false;
  }
  ++at;
  SkipBlanks(line, at);
  if (at == line.size() || line[at] != '"') {
    error = "expected '\"' to open the text of \"" + parsedKey + "\"";
    return false;
  }
  ++at;
  std::string parsedText;
  for (;;) {
    if (at == line.size()) {
      error = "the text of \"" + parsedKey + "\" has no closing '\"'";
      return false;
    }
    char c = line[at++];
    if (c == '"') break;
    if (c != '\\') {
      parsedText += c;
      continue;
    }
    char escaped = at < line.size() ? line[at++] : '\0';
    switch (escaped) {
      case '"': parsedText += '"'; break;
      case '\\': parsedText += '\\'; break;
      case 'n': parsedText += '\n'; break;
      case 't': parsedText += '\t'; break;
      default:
        error = std::string("unknown escape '\\") + (escaped ? std::string(1, escaped) : std::string()) +
                "' in the text of \"" + parsedKey + "\"";
        return false;
    }
  }
  SkipBlanks(line, at);
  if (at == line.size() || line[at] != ';') {
    error = "expected ';' after the text of \"" + parsedKey + "\"";
    return false;
  }
  ++at;
  SkipBlanks(line, at);
  if (at != line.size() && line.substr(at, 2) != "//") {
    error = "unexpected characters after ';'";
    return false;
  }
  if (!QelUnicodeString::IsValidUtf8(parsedText)) {
    error = "the text of \"" + parsedKey + "\" is not valid UTF-8";
    return false;
  }
  key = std::move(parsedKey);
  text = std::move(parsedText);
  return true;
}

void Warn(const std::string& path, int lineNumber, const std::string& what) {
  std::string message = "qel: catalog " + path + ":" + std::to_string(lineNumber) + ": " + what + "; line skipped\n";
  QelSysLogError(message.c_str());
}

Catalog Load(const std::string& path, const char* name) {
  Catalog catalog;
  std::ifstream file(path, std::ios::binary);
  if (!file) {
    std::string message = std::string("qel: catalog \"") + name + "\" not found (" + path + ")\n";
    QelSysLogError(message.c_str());
    return catalog;
  }
  catalog.found = true;
  std::unordered_map<std::string, int> definedOn;
  std::string line;
  for (int lineNumber = 1; std::getline(file, line); ++lineNumber) {
    std::string_view view(line);
    if (lineNumber == 1 && view.substr(0, 3) == "\xEF\xBB\xBF") view.remove_prefix(3);
    if (!view.empty() && view.back() == '\r') view.remove_suffix(1);
    std::string key, text, error;
    if (!ParseLine(view, key, text, error)) {
      Warn(path, lineNumber, error);
      continue;
    }
    if (key.empty()) continue;
    auto [it, inserted] = definedOn.emplace(key, lineNumber);
    if (!inserted) {
      Warn(path, lineNumber, "the key \"" + key + "\" was already defined on line " + std::to_string(it->second));
      continue;
    }
    catalog.texts.emplace(std::move(key), std::move(text));
  }
  return catalog;
}

const Catalog* Find(const char* name) {
  if (!IsCatalogName(name)) return nullptr;
  std::string path = QelMsgCatalog::CatalogFolder() + "/" + name + kCatalogExtension;
  auto& cache = Cache();
  auto it = cache.find(path);
  if (it == cache.end()) it = cache.emplace(path, Load(path, name)).first;
  return it->second.found ? &it->second : nullptr;
}

// Replaces "/p<n>" by the n-th parameter; the inserted texts are not scanned again.
std::string Substitute(const std::string& text, const std::vector<QelUnicodeString>& params) {
  if (params.empty()) return text;
  std::string out;
  out.reserve(text.size());
  for (size_t at = 0; at < text.size();) {
    if (text.compare(at, 2, "/p") == 0 && at + 2 < text.size() && text[at + 2] >= '0' && text[at + 2] <= '9') {
      size_t end = at + 2;
      size_t index = 0;
      while (end < text.size() && text[end] >= '0' && text[end] <= '9' && index <= params.size())
        index = index * 10 + static_cast<size_t>(text[end++] - '0');
      while (end < text.size() && text[end] >= '0' && text[end] <= '9') ++end;
      if (index >= 1 && index <= params.size()) {
        out += params[index - 1].Utf8();
      } else {
        out.append(text, at, end - at);
      }
      at = end;
      continue;
    }
    out += text[at++];
  }
  return out;
}
}  // namespace

std::string QelMsgCatalog::CatalogFolder() {
  std::string resources = QelGetEnv("QEL_RESOURCES_DIR");
  if (resources.empty()) resources = QEL_RESOURCES_SOURCE_DIR;
  return resources + "/catalogs";
}

void QelMsgCatalog::ForgetCatalogs() { Cache().clear(); }

QelUnicodeString QelMsgCatalog::BuildMessage(const char* catalog, const char* key,
                                             const std::vector<QelUnicodeString>& params,
                                             const QelUnicodeString& defaultText) {
  try {
    const Catalog* found = Find(catalog);
    if (!found || !key) return defaultText;
    auto it = found->texts.find(key);
    if (it == found->texts.end()) return defaultText;
    return QelUnicodeString(Substitute(it->second, params));
  } catch (...) {
    // Out of memory while reading a file: the caller still gets a text and no exception.
    return defaultText;
  }
}

std::vector<QelString> QelMsgCatalog::ListKeys(const char* catalog) {
  std::vector<QelString> keys;
  try {
    const Catalog* found = Find(catalog);
    if (!found) return keys;
    std::set<std::string> sorted;
    for (const auto& entry : found->texts) sorted.insert(entry.first);
    for (const auto& key : sorted) keys.emplace_back(key);
  } catch (...) {
    keys.clear();
  }
  return keys;
}
