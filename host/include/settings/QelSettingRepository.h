#pragma once
// QelSettingRepository: a named store of user settings (int, double, bool or text values,
// or arrays of one of them), kept as the JSON file <folder>/<name>.json. One repository
// object exists per name and folder for the whole process; GetRepository lends it (no
// reference for the caller). The file is read on first use and written only by
// SaveRepository, atomically, so a crash never leaves a half-written file behind.
//
//   QelSettingRepository* repo = QelSettingRepository::GetRepository("QelRovDataFiltering");
//   int on = 0;
//   if (repo && repo->IsPresent("DataFilteringPanel_TPSCfg", "int")) repo->ReadSetting("DataFilteringPanel_TPSCfg", on);
#include <chrono>
#include <memory>
#include <string>

#include "QelBaseUnknown.h"
#include "QelString.h"

// Published by a repository after each WriteSetting; the payload is a QelSettingNotif.
inline constexpr const char* kQelRepositoryModified = "Repository_Modified";

class QelSettingRepository : public QelBaseUnknown {
 public:
  // The repository `name` in `folder` (null: the user's settings folder, see SettingsFolder).
  // `reserved` is unused and must be 0. With `create` 0 the answer is null when the
  // repository was not requested before and its file does not exist. Null for an empty name.
  static QelSettingRepository* GetRepository(const char* name, int reserved = 0, int create = 1,
                                             const char* folder = nullptr);
  // $QEL_SETTINGS_DIR, else $XDG_CONFIG_HOME/qelrovfacets, else $HOME/.config/qelrovfacets.
  static std::string SettingsFolder();
  // Drops every repository; unsaved changes are lost and pointers lent before dangle. For a
  // host that shuts down, and for tests that need a fresh read of the files.
  static void ForgetRepositories();

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  const QelString& GetName() const;
  // The file the repository reads and saves.
  const std::string& GetFilePath() const;

  // Non-zero when `key` holds a value of `type` ("int", "double", "bool" or "string";
  // null or empty for any type). An int also reads as a double.
  int IsPresent(const char* key, const char* type = nullptr);

  // S_OK when found with a fitting type; E_FAIL when absent or of another type (the value
  // is then untouched). An array answers with its first element.
  HRESULT ReadSetting(const char* key, int& value);
  HRESULT ReadSetting(const char* key, double& value);
  HRESULT ReadSetting(const char* key, bool& value);
  HRESULT ReadSetting(const char* key, QelString& value);
  // Reads exactly `count` values (a single value counts as an array of one); E_FAIL and
  // nothing written when the setting has fewer, or another type.
  HRESULT ReadSetting(const char* key, int* values, int count);
  HRESULT ReadSetting(const char* key, double* values, int count);

  // Stores the value in memory, marks the repository modified and, unless `silent` is
  // non-zero, publishes kQelRepositoryModified with the key's name.
  HRESULT WriteSetting(const char* key, int value, int silent = 0);
  HRESULT WriteSetting(const char* key, double value, int silent = 0);
  HRESULT WriteSetting(const char* key, bool value, int silent = 0);
  HRESULT WriteSetting(const char* key, const char* value, int silent = 0);
  HRESULT WriteSetting(const char* key, const QelString& value, int silent = 0);
  // `count` values; a count of 1 stores a single value.
  HRESULT WriteSetting(const char* key, const int* values, int count, int silent = 0);
  HRESULT WriteSetting(const char* key, const double* values, int count, int silent = 0);

  HRESULT RemoveSetting(const char* key, int silent = 0);

  // Writes the settings to `path` (null: the repository's own file) when they were changed
  // since the last save; S_OK also when there was nothing to write. The own file is read
  // again first and only this process's changes are applied to it, so settings another
  // process saved meanwhile are kept; a file that is then corrupt is moved aside to
  // <file>.corrupt-<n>, one that cannot be read is left alone and the save fails. E_FAIL,
  // with a logged reason, whenever any step of the write fails (the old file is then left
  // as it was, except after a failed folder sync, when the new file is in place but may
  // not survive a power cut). Temporaries left by a process killed mid-save are removed.
  // Saving the own file holds its lock (<file>.lock) from the read to the rename, so that
  // processes saving at once each keep the others' settings; a lock not had within five
  // seconds fails the save, and the changes stay in memory for the next one.
  HRESULT SaveRepository(const char* path = nullptr);
  // For tests: how long a save waits for the lock (zero or less: the five seconds again).
  static void SetLockPatienceForTesting(std::chrono::milliseconds patience);
  bool IsModified() const;
  // True when the file exists but its settings could not be read (not a settings file, or
  // not readable): reads then answer as for an empty repository. Reported once, at load.
  bool IsFileUnusable();

 protected:
  QelSettingRepository(const QelString& name, std::string folder);
  ~QelSettingRepository() override;

 private:
  struct State;
  std::unique_ptr<State> state_;
};
