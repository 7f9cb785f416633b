#include "QelSettingRepository.h"

#include <cerrno>
#include <climits>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <map>
#include <optional>
#include <nlohmann/json.hpp>
#include <sstream>

#include "QelAssert.h"
#include "QelAtomicFile.h"
#include "QelCallbackManager.h"
#include "QelFileLock.h"
#include "QelMetaObject.h"
#include "QelSettingNotif.h"
#include "QelVar.h"

namespace fs = std::filesystem;
using json = nlohmann::json;

namespace {

// Owned references; the map outlives every static destructor on purpose, so a repository
// lent to a late caller never disappears under it before ForgetRepositories.
std::map<std::string, QelSettingRepository*>& Registry() {
  static auto* registry = new std::map<std::string, QelSettingRepository*>;
  return *registry;
}

void LogError(const std::string& text) { QelSysLogError((text + "\n").c_str()); }

std::string JsonPointer(const std::string& key) {
  std::string out = "/";
  for (char c : key) {
    if (c == '~') out += "~0";
    else if (c == '/') out += "~1";
    else out += c;
  }
  return out;
}

bool IsScalar(const json& v) { return v.is_boolean() || v.is_number() || v.is_string(); }

// Empty when `v` is something a setting may hold, else what is wrong with it.
std::string ShapeError(const json& v) {
  if (IsScalar(v)) return {};
  if (v.is_array()) {
    if (v.empty()) return "an array of settings may not be empty";
    for (const auto& element : v)
      if (!element.is_number()) return std::string("an array of settings holds numbers only, not ") + element.type_name();
    return {};
  }
  return std::string("a setting is a number, a boolean, a text or an array of numbers, not ") + v.type_name();
}

bool AsInt(const json& v, int& out) {
  if (v.is_number_unsigned()) {
    auto u = v.get<uint64_t>();
    if (u > static_cast<uint64_t>(INT_MAX)) return false;
    out = static_cast<int>(u);
    return true;
  }
  if (v.is_number_integer()) {
    auto i = v.get<int64_t>();
    if (i < INT_MIN || i > INT_MAX) return false;
    out = static_cast<int>(i);
    return true;
  }
  return false;
}

bool AsDouble(const json& v, double& out) {
  if (!v.is_number()) return false;
  out = v.get<double>();
  return true;
}

enum class FileState { Missing, Settings, Corrupt, Unreadable };

// Reads a settings file into `out` (an object whose values all have a setting's shape).
// Anything else is Corrupt or Unreadable, with `problem` saying what and where.
FileState ReadSettingsFile(const std::string& path, json& out, std::string& problem) {
  out = json::object();
  std::error_code ec;
  if (!fs::exists(path, ec)) {
    if (!ec) return FileState::Missing;
    problem = "cannot be reached (" + ec.message() + ")";
    return FileState::Unreadable;
  }
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  if (!in || in.bad()) {
    problem = std::string("cannot be read (") + std::strerror(errno) + ")";
    return FileState::Unreadable;
  }
  // An empty file is what `touch` leaves; it holds no settings and nothing to keep.
  if (text.str().find_first_not_of(" \t\r\n") == std::string::npos) return FileState::Settings;
  json parsed;
  try {
    parsed = json::parse(text.str());
  } catch (const json::parse_error& e) {
    problem = "is not valid JSON (at byte " + std::to_string(e.byte) + ": " + e.what() + ")";
    return FileState::Corrupt;
  } catch (const json::exception& e) {
    // A number beyond the range of double ("1e400") ends up here, not as a parse error.
    problem = std::string("holds a value that cannot be read (") + e.what() + ")";
    return FileState::Corrupt;
  }
  if (!parsed.is_object()) {
    problem = std::string("is not a settings file: the top level must be a JSON object, not ") + parsed.type_name();
    return FileState::Corrupt;
  }
  for (const auto& [key, value] : parsed.items()) {
    std::string why = ShapeError(value);
    if (!why.empty()) {
      problem = "at " + JsonPointer(key) + ": " + why;
      return FileState::Corrupt;
    }
  }
  out = std::move(parsed);
  return FileState::Settings;
}

// Reads exactly `count` values of a setting (a single value counts as an array of one);
// nothing is written unless all of them convert.
template <class T>
HRESULT ReadValues(const json* v, T* values, int count, bool (*convert)(const json&, T&)) {
  if (!v || !values || count <= 0) return E_FAIL;
  const json single = json::array({*v});
  const json& all = v->is_array() ? *v : single;
  if (static_cast<int>(all.size()) < count) return E_FAIL;
  std::vector<T> read(static_cast<size_t>(count));
  for (int i = 0; i < count; ++i)
    if (!convert(all[static_cast<size_t>(i)], read[static_cast<size_t>(i)])) return E_FAIL;
  std::copy(read.begin(), read.end(), values);
  return S_OK;
}
}  // namespace

struct QelSettingRepository::State {
  QelSettingRepository* self;
  QelString name;
  std::string path;
  json values = json::object();
  // What this process wrote (a value) or removed (nullopt) since its last save. A save
  // applies these to the file as it is then, so settings another process saved meanwhile
  // are kept rather than replaced by this process's older copy.
  std::map<std::string, std::optional<json>> changes;
  bool loaded = false;
  bool modified = false;
  // The file exists but its settings could not be read (reported once, at load).
  bool unusable = false;

  void Load();
  const json* Find(const char* key);
  HRESULT Store(const char* key, json value, int silent);
  HRESULT MoveCorruptFileAside();
  HRESULT SaveOwnFile();
};

void QelSettingRepository::State::Load() {
  if (loaded) return;
  loaded = true;
  std::string problem;
  switch (ReadSettingsFile(path, values, problem)) {
    case FileState::Missing:
    case FileState::Settings:
      return;
    case FileState::Corrupt:
      unusable = true;
      LogError("qel: settings file '" + path + "' " + problem +
               "; its settings are ignored and the file will be set aside at the next save");
      return;
    case FileState::Unreadable:
      unusable = true;
      LogError("qel: settings file '" + path + "' " + problem + "; its settings are ignored and it will not be overwritten");
      return;
  }
}

const json* QelSettingRepository::State::Find(const char* key) {
  if (!key || !*key) return nullptr;
  Load();
  auto it = values.find(key);
  return it == values.end() ? nullptr : &*it;
}

HRESULT QelSettingRepository::State::Store(const char* key, json value, int silent) {
  if (!key || !*key) return E_FAIL;
  try {
    // Texts that JSON cannot hold (bad UTF-8) are refused now rather than failing the save.
    (void)json{{key, value}}.dump();
    Load();
    values[key] = value;
    changes[key] = std::move(value);
  } catch (const std::exception&) {
    return E_FAIL;
  }
  modified = true;
  if (!silent) {
    auto notification = QelMakeVar<QelSettingNotif>(QelString(key));
    QelCallbackManager::Get().Dispatch(self, kQelRepositoryModified, notification.get());
  }
  return S_OK;
}

HRESULT QelSettingRepository::State::MoveCorruptFileAside() {
  std::error_code ec;
  for (int n = 1; n < 10000; ++n) {
    std::string aside = path + ".corrupt-" + std::to_string(n);
    if (fs::exists(aside, ec)) continue;
    if (::rename(path.c_str(), aside.c_str()) != 0 && errno != ENOENT) {
      LogError("qel: settings not saved: the corrupt file '" + path + "' could not be moved to '" + aside + "' (" +
               std::strerror(errno) + ")");
      return E_FAIL;
    }
    LogError("qel: the corrupt settings file '" + path + "' was kept as '" + aside + "'");
    return S_OK;
  }
  LogError("qel: settings not saved: too many corrupt copies of '" + path + "'");
  return E_FAIL;
}

const QelMetaObject& QelSettingRepository::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelSettingRepository", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelSettingRepository::QelSettingRepository(const QelString& name, std::string folder)
    : state_(std::make_unique<State>()) {
  state_->self = this;
  state_->name = name;
  state_->path = (fs::path(folder) / (name.Str() + ".json")).string();
}

QelSettingRepository::~QelSettingRepository() = default;

std::string QelSettingRepository::SettingsFolder() {
  if (std::string dir = QelGetEnv("QEL_SETTINGS_DIR"); !dir.empty()) return dir;
  // A relative XDG_CONFIG_HOME is invalid by the base-directory convention, so it is ignored.
  if (std::string xdg = QelGetEnv("XDG_CONFIG_HOME"); !xdg.empty() && xdg[0] == '/') return xdg + "/qelrovfacets";
  if (std::string home = QelGetEnv("HOME"); !home.empty()) return home + "/.config/qelrovfacets";
  return "qelrovfacets";
}

QelSettingRepository* QelSettingRepository::GetRepository(const char* name, int reserved, int create,
                                                          const char* folder) {
  (void)reserved;
  if (!name || !*name) return nullptr;
  std::string_view n(name);
  if (n.find('/') != std::string_view::npos || n == "." || n == "..") {
    LogError(std::string("qel: '") + name + "' is not a settings repository name (it would leave the settings folder)");
    return nullptr;
  }
  try {
    std::string dir = folder && *folder ? folder : SettingsFolder();
    std::string id = dir + '\n' + name;
    auto& registry = Registry();
    if (auto it = registry.find(id); it != registry.end()) return it->second;
    std::error_code ec;
    if (!create && !fs::exists(fs::path(dir) / (std::string(name) + ".json"), ec)) return nullptr;
    auto* repository = new QelSettingRepository(QelString(name), dir);
    repository->NoteAdopted();  // the registry owns it
    registry.emplace(id, repository);
    return repository;
  } catch (const std::exception&) {
    return nullptr;
  }
}

void QelSettingRepository::ForgetRepositories() {
  auto registry = std::move(Registry());
  Registry().clear();
  for (auto& [id, repository] : registry) repository->Release();
}

const QelString& QelSettingRepository::GetName() const { return state_->name; }
const std::string& QelSettingRepository::GetFilePath() const { return state_->path; }
bool QelSettingRepository::IsModified() const { return state_->modified; }

bool QelSettingRepository::IsFileUnusable() {
  state_->Load();
  return state_->unusable;
}

int QelSettingRepository::IsPresent(const char* key, const char* type) {
  const json* v = state_->Find(key);
  if (!v) return 0;
  std::string_view t = type ? type : "";
  if (t.empty()) return 1;
  if (t == "bool") return v->is_boolean();
  if (t == "string") return v->is_string();
  if (t != "int" && t != "double") return 0;
  const json single = json::array({*v});
  for (const auto& element : v->is_array() ? *v : single) {
    int i;
    if (t == "int" ? !AsInt(element, i) : !element.is_number()) return 0;
  }
  return 1;
}

HRESULT QelSettingRepository::ReadSetting(const char* key, int& value) {
  const json* v = state_->Find(key);
  if (!v) return E_FAIL;
  return AsInt(v->is_array() ? v->front() : *v, value) ? S_OK : E_FAIL;
}

HRESULT QelSettingRepository::ReadSetting(const char* key, double& value) {
  const json* v = state_->Find(key);
  if (!v) return E_FAIL;
  return AsDouble(v->is_array() ? v->front() : *v, value) ? S_OK : E_FAIL;
}

HRESULT QelSettingRepository::ReadSetting(const char* key, bool& value) {
  const json* v = state_->Find(key);
  if (!v || !v->is_boolean()) return E_FAIL;
  value = v->get<bool>();
  return S_OK;
}

HRESULT QelSettingRepository::ReadSetting(const char* key, QelString& value) {
  const json* v = state_->Find(key);
  if (!v || !v->is_string()) return E_FAIL;
  value = QelString(v->get<std::string>());
  return S_OK;
}

HRESULT QelSettingRepository::ReadSetting(const char* key, int* values, int count) {
  return ReadValues(state_->Find(key), values, count, &AsInt);
}

HRESULT QelSettingRepository::ReadSetting(const char* key, double* values, int count) {
  return ReadValues(state_->Find(key), values, count, &AsDouble);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, int value, int silent) {
  return state_->Store(key, json(value), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, double value, int silent) {
  // JSON has no infinity or NaN: stored, they would come back as null and spoil the file.
  if (!std::isfinite(value)) return E_FAIL;
  return state_->Store(key, json(value), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, bool value, int silent) {
  return state_->Store(key, json(value), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, const char* value, int silent) {
  if (!value) return E_FAIL;
  return state_->Store(key, json(std::string(value)), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, const QelString& value, int silent) {
  return state_->Store(key, json(value.Str()), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, const int* values, int count, int silent) {
  if (!values || count <= 0) return E_FAIL;
  if (count == 1) return WriteSetting(key, values[0], silent);
  return state_->Store(key, json(std::vector<int>(values, values + count)), silent);
}

HRESULT QelSettingRepository::WriteSetting(const char* key, const double* values, int count, int silent) {
  if (!values || count <= 0) return E_FAIL;
  for (int i = 0; i < count; ++i)
    if (!std::isfinite(values[i])) return E_FAIL;
  if (count == 1) return WriteSetting(key, values[0], silent);
  return state_->Store(key, json(std::vector<double>(values, values + count)), silent);
}

HRESULT QelSettingRepository::RemoveSetting(const char* key, int silent) {
  if (!state_->Find(key)) return S_FALSE;
  state_->values.erase(key);
  state_->changes[key] = std::nullopt;
  state_->modified = true;
  if (!silent) {
    auto notification = QelMakeVar<QelSettingNotif>(QelString(key));
    QelCallbackManager::Get().Dispatch(this, kQelRepositoryModified, notification.get());
  }
  return S_OK;
}

namespace {
// Writes `text` over `target` in one step; false with the reason logged.
bool WriteAtomically(const std::string& target, const std::string& text) {
  std::error_code ec;
  fs::path folder = fs::path(target).parent_path();
  if (!folder.empty()) fs::create_directories(folder, ec);
  if (ec) {
    LogError("qel: settings not saved: the folder '" + folder.string() + "' cannot be made (" + ec.message() + ")");
    return false;
  }
  QelAtomicFile::RemoveStaleTemporaries(target);
  std::string error;
  auto file = QelAtomicFile::Create(target, error);
  if (!file || !file->Write(text, error) || !file->Keep(error)) {
    LogError("qel: settings not saved to '" + target + "': " + error);
    return false;
  }
  return true;
}
}  // namespace

namespace {
constexpr std::chrono::milliseconds kLockPatience{5000};
std::chrono::milliseconds lockPatience = kLockPatience;
}  // namespace

void QelSettingRepository::SetLockPatienceForTesting(std::chrono::milliseconds patience) {
  lockPatience = patience.count() > 0 ? patience : kLockPatience;
}

HRESULT QelSettingRepository::State::SaveOwnFile() {
  std::error_code ec;
  if (fs::path folder = fs::path(path).parent_path(); !folder.empty()) fs::create_directories(folder, ec);
  std::string error;
  // Without the lock two processes would each merge into the file as it was before the
  // other's rename, and the last rename would drop the other's settings.
  const auto lock = QelFileLock::Acquire(path, lockPatience, error);
  if (!lock) {
    LogError("qel: settings not saved to '" + path + "': " + error + "; they are kept for the next save");
    return E_FAIL;
  }
  json current;
  std::string problem;
  switch (ReadSettingsFile(path, current, problem)) {
    case FileState::Unreadable:
      LogError("qel: settings not saved: '" + path + "' " + problem + ", and saving would replace it");
      return E_FAIL;
    case FileState::Corrupt:
      if (!unusable) LogError("qel: settings file '" + path + "' " + problem);
      if (MoveCorruptFileAside() != S_OK) return E_FAIL;
      break;
    case FileState::Missing:
    case FileState::Settings:
      break;
  }
  for (const auto& [key, value] : changes) {
    if (value) current[key] = *value;
    else current.erase(key);
  }
  if (!WriteAtomically(path, current.dump(2) + "\n")) return E_FAIL;
  values = std::move(current);
  changes.clear();
  modified = false;
  unusable = false;
  return S_OK;
}

HRESULT QelSettingRepository::SaveRepository(const char* path) {
  State& s = *state_;
  try {
    s.Load();
    const std::string target = path && *path ? std::string(path) : s.path;
    if (target == s.path) return s.modified ? s.SaveOwnFile() : S_OK;
    return WriteAtomically(target, s.values.dump(2) + "\n") ? S_OK : E_FAIL;
  } catch (const std::exception& e) {
    LogError("qel: settings not saved to '" + s.path + "': " + e.what());
    return E_FAIL;
  }
}
