#include "QelSettingRepository.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/file.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <random>
#include <sstream>

#include "QelAtomicFile.h"
#include "QelCallbackManager.h"
#include "QelSettingNotif.h"

namespace fs = std::filesystem;

namespace {

std::string ReadFile(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

void WriteFile(const fs::path& path, const std::string& text) {
  std::ofstream out(path, std::ios::binary | std::ios::trunc);
  out << text;
}

class SettingRepositoryTest : public ::testing::Test {
 protected:
  void SetUp() override {
    char pattern[] = "/tmp/qel-settings-XXXXXX";
    ASSERT_NE(::mkdtemp(pattern), nullptr);
    folder_ = pattern;
    liveBefore_ = QelBaseUnknown::LiveObjectCount();
  }
  void TearDown() override {
    QelAtomicFile::SetFaultHookForTesting({});
    QelSettingRepository::ForgetRepositories();
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), liveBefore_);
    fs::remove_all(folder_);
  }

  QelSettingRepository* Repo(const char* name = "QelRovDataFiltering") {
    return QelSettingRepository::GetRepository(name, 0, 1, folder_.c_str());
  }
  fs::path FileOf(const char* name = "QelRovDataFiltering") { return fs::path(folder_) / (std::string(name) + ".json"); }

  // Runs the probe as a new process: what another program sees in the file.
  std::string Probe(const char* key, const char* type, const char* name = "QelRovDataFiltering",
                    const char* save = "") {
    std::string command =
        std::string(QEL_SETTINGS_PROBE) + " " + folder_ + " " + name + " " + key + " " + type + " " + save + " 2>&1";
    FILE* pipe = ::popen(command.c_str(), "r");
    if (!pipe) return "popen failed";
    std::string out;
    char buffer[256];
    while (std::fgets(buffer, sizeof buffer, pipe)) out += buffer;
    ::pclose(pipe);
    if (!out.empty() && out.back() == '\n') out.pop_back();
    return out;
  }

  std::vector<std::string> Temporaries() {
    std::vector<std::string> found;
    for (const auto& entry : fs::directory_iterator(folder_))
      if (entry.path().filename().string().find(".tmp-") != std::string::npos)
        found.push_back(entry.path().filename().string());
    return found;
  }

  std::string folder_;
  int64_t liveBefore_ = 0;
};

TEST_F(SettingRepositoryTest, SavedSettingsAreReadBackByAnotherProcess) {
  QelSettingRepository* repo = Repo();
  ASSERT_NE(repo, nullptr);
  ASSERT_EQ(repo->WriteSetting("DataFilteringPanel_TPSCfg", 1), S_OK);
  ASSERT_EQ(repo->WriteSetting("Tolerance", 0.125), S_OK);
  ASSERT_EQ(repo->WriteSetting("Expanded", true), S_OK);
  ASSERT_EQ(repo->WriteSetting("Label", "Ébauche \"v2\""), S_OK);
  EXPECT_EQ(Probe("DataFilteringPanel_TPSCfg", "int"), "absent") << "nothing reaches the file before a save";

  ASSERT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_FALSE(repo->IsModified());
  EXPECT_EQ(Probe("DataFilteringPanel_TPSCfg", "int"), "1");
  EXPECT_EQ(Probe("Tolerance", "double"), "0.125");
  EXPECT_EQ(Probe("Expanded", "bool"), "true");
  EXPECT_EQ(Probe("Label", "string"), "Ébauche \"v2\"");
  EXPECT_EQ(Probe("Tolerance", "int"), "absent") << "a double is not an int";
  EXPECT_TRUE(fs::directory_iterator(folder_) != fs::directory_iterator());
  for (const auto& entry : fs::directory_iterator(folder_))
    EXPECT_TRUE(entry.path().filename() == "QelRovDataFiltering.json" ||
                entry.path().filename() == "QelRovDataFiltering.json.lock")
        << "no temporary left behind: " << entry.path().filename();
}

TEST_F(SettingRepositoryTest, SaveCreatesAMissingFolderAndWritesOnlyWhenModified) {
  std::string nested = folder_ + "/a/b";
  QelSettingRepository* repo = QelSettingRepository::GetRepository("Prefs", 0, 1, nested.c_str());
  ASSERT_NE(repo, nullptr);
  EXPECT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_FALSE(fs::exists(nested)) << "an unchanged repository writes nothing";
  repo->WriteSetting("k", 3);
  EXPECT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_EQ(nlohmann::json::parse(ReadFile(nested + "/Prefs.json"))["k"], 3);
}

TEST_F(SettingRepositoryTest, OneRepositoryPerNameAndCreateZeroFindsOnlyExistingOnes) {
  EXPECT_EQ(QelSettingRepository::GetRepository("Absent", 0, 0, folder_.c_str()), nullptr);
  QelSettingRepository* repo = Repo();
  EXPECT_EQ(Repo(), repo);
  EXPECT_NE(Repo("Other"), repo);
  EXPECT_EQ(QelSettingRepository::GetRepository("QelRovDataFiltering", 0, 0, folder_.c_str()), repo);
  EXPECT_EQ(QelSettingRepository::GetRepository("", 0, 1, folder_.c_str()), nullptr);
  testing::internal::CaptureStderr();
  EXPECT_EQ(QelSettingRepository::GetRepository("../escape", 0, 1, folder_.c_str()), nullptr);
  EXPECT_NE(testing::internal::GetCapturedStderr().find("../escape"), std::string::npos);
}

TEST_F(SettingRepositoryTest, ReadsCheckTheTypeAndLeaveTheValueAloneOnFailure) {
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("n", 7);
  repo->WriteSetting("x", 2.5);
  repo->WriteSetting("s", QelString("text"));
  const int pair[] = {4, 5};
  repo->WriteSetting("pair", pair, 2);

  EXPECT_TRUE(repo->IsPresent("n", "int"));
  EXPECT_TRUE(repo->IsPresent("n", "double")) << "an int reads as a double";
  EXPECT_FALSE(repo->IsPresent("x", "int"));
  EXPECT_FALSE(repo->IsPresent("s", "bool"));
  EXPECT_FALSE(repo->IsPresent("n", "float")) << "unknown type names match nothing";
  EXPECT_TRUE(repo->IsPresent("s", nullptr));
  EXPECT_FALSE(repo->IsPresent("missing", "int"));

  int value = -1;
  EXPECT_EQ(repo->ReadSetting("x", value), E_FAIL);
  EXPECT_EQ(repo->ReadSetting("missing", value), E_FAIL);
  EXPECT_EQ(value, -1);
  double real = 0;
  EXPECT_EQ(repo->ReadSetting("n", real), S_OK);
  EXPECT_EQ(real, 7.0);
  QelString text;
  EXPECT_EQ(repo->ReadSetting("n", text), E_FAIL);
  EXPECT_EQ(repo->ReadSetting("s", text), S_OK);
  EXPECT_EQ(text, QelString("text"));

  int got[3] = {0, 0, 0};
  EXPECT_EQ(repo->ReadSetting("pair", got, 2), S_OK);
  EXPECT_EQ(got[0], 4);
  EXPECT_EQ(got[1], 5);
  EXPECT_EQ(repo->ReadSetting("pair", got, 3), E_FAIL) << "fewer values than asked";
  EXPECT_EQ(repo->ReadSetting("n", got, 1), S_OK) << "a single value is an array of one";
  EXPECT_EQ(got[0], 7);
}

TEST_F(SettingRepositoryTest, ValuesJsonCannotHoldAreRefusedSoTheFileStaysLoadable) {
  QelSettingRepository* repo = Repo();
  EXPECT_EQ(repo->WriteSetting("inf", 1.0 / 0.0), E_FAIL);
  const double withNan[] = {1.0, std::nan("")};
  EXPECT_EQ(repo->WriteSetting("nan", withNan, 2), E_FAIL);
  EXPECT_EQ(repo->WriteSetting("bad", "\xff\xfe"), E_FAIL);
  EXPECT_EQ(repo->WriteSetting("", 1), E_FAIL);
  EXPECT_EQ(repo->WriteSetting(nullptr, 1), E_FAIL);
  EXPECT_FALSE(repo->IsModified());
}

TEST_F(SettingRepositoryTest, HugeIntegersInAHandEditedFileDoNotReadAsInt) {
  WriteFile(FileOf(), R"({"big": 9999999999, "neg": -3})");
  QelSettingRepository* repo = Repo();
  int value = 0;
  EXPECT_FALSE(repo->IsPresent("big", "int"));
  EXPECT_EQ(repo->ReadSetting("big", value), E_FAIL);
  EXPECT_EQ(repo->ReadSetting("neg", value), S_OK);
  EXPECT_EQ(value, -3);
}

TEST_F(SettingRepositoryTest, EveryFailingStepOfASaveIsReportedWithItsOwnReasonAndLeavesNoTemporary) {
  using Step = QelAtomicFile::Step;
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("v", 1);
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  const std::string before = ReadFile(FileOf());
  for (Step failing : {Step::Create, Step::Write, Step::Sync, Step::Close, Step::Rename, Step::SyncFolder}) {
    SCOPED_TRACE(static_cast<int>(failing));
    repo->WriteSetting("v", 2);
    QelAtomicFile::SetFaultHookForTesting([failing](Step step) { return step == failing ? EIO : 0; });
    testing::internal::CaptureStderr();
    EXPECT_EQ(repo->SaveRepository(), E_FAIL);
    const std::string report = testing::internal::GetCapturedStderr();
    EXPECT_NE(report.find(std::strerror(EIO)), std::string::npos) << report;
    EXPECT_EQ(report.find("Success"), std::string::npos) << report;
    EXPECT_TRUE(repo->IsModified()) << "the change is still pending";
    EXPECT_TRUE(Temporaries().empty());
    if (failing != Step::SyncFolder) {
      EXPECT_EQ(ReadFile(FileOf()), before) << "the old file is untouched";
    }
    QelAtomicFile::SetFaultHookForTesting({});
    ASSERT_EQ(repo->WriteSetting("v", 1), S_OK);
    ASSERT_EQ(repo->SaveRepository(), S_OK) << "the next save goes through";
  }
}

TEST_F(SettingRepositoryTest, ProcessKilledBeforeRenameLeavesTheOldFileIntactAndTheNextSaveClearsItsTemporary) {
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("v", 1);
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  const std::string before = ReadFile(FileOf());

  for (int crash = 0; crash < 2; ++crash) {
    pid_t child = ::fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
      QelAtomicFile::SetFaultHookForTesting([](QelAtomicFile::Step step) {
        if (step == QelAtomicFile::Step::Rename) ::_exit(42);
        return 0;
      });
      repo->WriteSetting("v", 2, 1);
      repo->SaveRepository();
      ::_exit(0);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 42) << "the child died inside the save";
  }
  EXPECT_EQ(ReadFile(FileOf()), before);
  EXPECT_EQ(Probe("v", "int"), "1");
  EXPECT_EQ(Temporaries().size(), 1u) << "the second save cleared the first crash's temporary";

  // A temporary of a process that still runs may be a save in progress: it stays.
  const std::string live = FileOf().string() + ".tmp-" + std::to_string(::getppid()) + "-abcdef";
  WriteFile(live, "{}");
  repo->WriteSetting("v", 3);
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_EQ(Temporaries(), std::vector<std::string>{fs::path(live).filename().string()});
  EXPECT_EQ(Probe("v", "int"), "3");
}

TEST_F(SettingRepositoryTest, ProcessKilledAtRandomMomentsOfSavesAlwaysLeavesAWholeFile) {
  const std::string pad(16 * 1024, 'p');  // long enough for a kill to land inside the write
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("n", 0);
  repo->WriteSetting("pad", pad.c_str());
  // Kills are spread over about three saves, however long a save takes in this build.
  const auto start = std::chrono::steady_clock::now();
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  const auto saveMicroseconds =
      std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::steady_clock::now() - start).count();
  std::mt19937 random(20261206);
  int lastSeen = 0;
  size_t mostTemporaries = 0;
  // At least 50 rounds, and more (up to 300) until a kill has landed inside a save: how
  // long a save takes varies with the build and the machine's load.
  for (int round = 0; round < 300 && (round < 50 || mostTemporaries == 0); ++round) {
    int ready[2];
    ASSERT_EQ(::pipe(ready), 0);
    pid_t child = ::fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
      ::close(ready[0]);
      for (int n = lastSeen + 1;; ++n) {
        repo->WriteSetting("n", n, 1);
        repo->SaveRepository();
        // Ready once one save is whole, so every kill falls among the saves that follow.
        if (n == lastSeen + 1) ::write(ready[1], "r", 1);
      }
    }
    ::close(ready[1]);
    char byte;
    ASSERT_EQ(::read(ready[0], &byte, 1), 1);
    ::close(ready[0]);
    ::usleep(static_cast<useconds_t>(random() % (3 * saveMicroseconds + 1)));
    ::kill(child, SIGKILL);
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    nlohmann::json saved = nlohmann::json::parse(ReadFile(FileOf()), nullptr, false);
    ASSERT_TRUE(saved.is_object()) << "round " << round << ": " << ReadFile(FileOf()).substr(0, 200);
    ASSERT_EQ(saved.value("pad", ""), pad) << "round " << round;
    ASSERT_GE(saved.value("n", -1), lastSeen) << "round " << round;
    lastSeen = saved.value("n", -1);
    mostTemporaries = std::max(mostTemporaries, Temporaries().size());
  }
  EXPECT_GT(lastSeen, 0) << "the children did save";
  EXPECT_GT(mostTemporaries, 0u) << "some kills landed inside a save";
  QelSettingRepository::ForgetRepositories();
  Repo()->WriteSetting("after", 1);
  ASSERT_EQ(Repo()->SaveRepository(), S_OK);
  EXPECT_TRUE(Temporaries().empty()) << "up to " << mostTemporaries << " temporaries were left by the kills";
  EXPECT_EQ(Probe("n", "int"), std::to_string(lastSeen));
}

TEST_F(SettingRepositoryTest, SaveKeepsWhatAnotherProcessSavedMeanwhile) {
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("gone", 1);
  repo->WriteSetting("mine", 1);
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_EQ(Probe("theirs", "int", "QelRovDataFiltering", "7"), "7");
  repo->WriteSetting("mine", 2);
  repo->RemoveSetting("gone");
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_EQ(Probe("theirs", "int"), "7");
  EXPECT_EQ(Probe("mine", "int"), "2");
  EXPECT_EQ(Probe("gone", "int"), "absent");
  int theirs = 0;
  EXPECT_EQ(repo->ReadSetting("theirs", theirs), S_OK) << "the save also refreshed this process's copy";
  EXPECT_EQ(theirs, 7);
}

TEST_F(SettingRepositoryTest, ProcessesSavingAtOnceKeepEachOthersSettings) {
  // Eight processes started together per round, each saving a key of its own: without the
  // lock the last rename of a round drops what the others merged.
  constexpr int kProcesses = 8, kRounds = 6;
  for (int round = 0; round < kRounds; ++round) {
    std::string command = "for i in 0 1 2 3 4 5 6 7; do " + std::string(QEL_SETTINGS_PROBE) + " " + folder_ +
                          " QelRovDataFiltering k_" + std::to_string(round) +
                          "_$i int $i >/dev/null 2>&1 & done; wait";
    ASSERT_EQ(std::system(command.c_str()), 0);
  }
  nlohmann::json saved = nlohmann::json::parse(ReadFile(FileOf()), nullptr, false);
  ASSERT_TRUE(saved.is_object());
  for (int round = 0; round < kRounds; ++round)
    for (int i = 0; i < kProcesses; ++i) {
      const std::string key = "k_" + std::to_string(round) + "_" + std::to_string(i);
      EXPECT_EQ(saved.value(key, -1), i) << key << " was lost";
    }
  EXPECT_TRUE(fs::exists(FileOf().string() + ".lock")) << "the lock file stays, so every saver locks the same file";
}

TEST_F(SettingRepositoryTest, ALockHeldTooLongFailsTheSaveInTimeAndKeepsTheChangesForTheNext) {
  QelSettingRepository* repo = Repo();
  repo->WriteSetting("before", 1);
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  QelSettingRepository::SetLockPatienceForTesting(std::chrono::milliseconds(200));
  {
    // Another holder of the lock: a second open file description conflicts even in this process.
    const int holder = ::open((FileOf().string() + ".lock").c_str(), O_RDWR);
    ASSERT_GE(holder, 0);
    ASSERT_EQ(::flock(holder, LOCK_EX), 0);
    repo->WriteSetting("pending", 2);
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(repo->SaveRepository(), E_FAIL);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(3)) << "the wait has an end";
    EXPECT_TRUE(repo->IsModified());
    EXPECT_EQ(Probe("pending", "int"), "absent");
    EXPECT_EQ(Probe("before", "int"), "1") << "the file is as it was";
    ::close(holder);
  }
  QelSettingRepository::SetLockPatienceForTesting({});
  EXPECT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_EQ(Probe("pending", "int"), "2");
}

TEST_F(SettingRepositoryTest, NumberOutOfRangeMakesTheFileCorruptAndItIsSetAsideWhole) {
  const std::string original = R"({"keep": 5, "x": 1e400})";
  WriteFile(FileOf(), original);
  testing::internal::CaptureStderr();
  QelSettingRepository* repo = Repo();
  int value = -1;
  EXPECT_FALSE(repo->IsPresent("keep", "int"));
  EXPECT_EQ(repo->ReadSetting("keep", value), E_FAIL);
  EXPECT_TRUE(repo->IsFileUnusable());
  const std::string report = testing::internal::GetCapturedStderr();
  EXPECT_NE(report.find(FileOf().string()), std::string::npos) << report;
  EXPECT_NE(Probe("keep", "int").find("absent"), std::string::npos) << "another process does not abort on it either";

  repo->WriteSetting("new", 1);
  testing::internal::CaptureStderr();
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  EXPECT_NE(testing::internal::GetCapturedStderr().find(".corrupt-1"), std::string::npos);
  EXPECT_EQ(ReadFile(FileOf().string() + ".corrupt-1"), original) << "the user's settings can be recovered";
  EXPECT_EQ(Probe("new", "int"), "1");
  EXPECT_FALSE(repo->IsFileUnusable());
}

TEST_F(SettingRepositoryTest, CorruptFileIsReportedReadsEmptyAndIsSetAsideNotOverwritten) {
  const std::string garbage = "{\n  \"DataFilteringPanel_TPSCfg\": 1,\n  oops\n}\n";
  WriteFile(FileOf(), garbage);
  testing::internal::CaptureStderr();
  QelSettingRepository* repo = Repo();
  EXPECT_FALSE(repo->IsPresent("DataFilteringPanel_TPSCfg", "int"));
  EXPECT_FALSE(repo->IsPresent("anything"));
  const std::string report = testing::internal::GetCapturedStderr();
  EXPECT_NE(report.find(FileOf().string()), std::string::npos) << report;
  EXPECT_NE(report.find("byte"), std::string::npos) << report;
  EXPECT_EQ(std::count(report.begin(), report.end(), '\n'), 1) << "one warning, not one per read: " << report;
  EXPECT_EQ(ReadFile(FileOf()), garbage) << "reading never touches the file";

  repo->WriteSetting("DataFilteringPanel_TPSCfg", 0);
  testing::internal::CaptureStderr();
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  testing::internal::GetCapturedStderr();
  EXPECT_EQ(ReadFile(FileOf().string() + ".corrupt-1"), garbage);
  EXPECT_EQ(Probe("DataFilteringPanel_TPSCfg", "int"), "0");
}

TEST_F(SettingRepositoryTest, WrongShapeNamesTheJsonPathAndASecondCorruptionGetsTheNextNumber) {
  WriteFile(FileOf().string() + ".corrupt-1", "older");
  WriteFile(FileOf(), R"({"ok": 1, "a/b": {"nested": true}})");
  testing::internal::CaptureStderr();
  QelSettingRepository* repo = Repo();
  EXPECT_FALSE(repo->IsPresent("ok"));
  const std::string report = testing::internal::GetCapturedStderr();
  EXPECT_NE(report.find("/a~1b"), std::string::npos) << report;

  repo->WriteSetting("ok", 2);
  testing::internal::CaptureStderr();
  ASSERT_EQ(repo->SaveRepository(), S_OK);
  testing::internal::GetCapturedStderr();
  EXPECT_EQ(ReadFile(FileOf().string() + ".corrupt-1"), "older");
  EXPECT_NE(ReadFile(FileOf().string() + ".corrupt-2").find("nested"), std::string::npos);
}

TEST_F(SettingRepositoryTest, TopLevelThatIsNotAnObjectIsCorruptButAnEmptyFileIsNot) {
  WriteFile(FileOf("List"), "[1, 2]");
  WriteFile(FileOf("Empty"), "\n");
  testing::internal::CaptureStderr();
  EXPECT_FALSE(Repo("List")->IsPresent("x"));
  EXPECT_FALSE(Repo("Empty")->IsPresent("x"));
  const std::string report = testing::internal::GetCapturedStderr();
  EXPECT_NE(report.find("List.json"), std::string::npos) << report;
  EXPECT_EQ(report.find("Empty.json"), std::string::npos) << report;
}

TEST_F(SettingRepositoryTest, RepositoryModifiedCarriesTheSettingName) {
  QelSettingRepository* repo = Repo();
  std::vector<std::string> names;
  QelBaseUnknown* publisherSeen = nullptr;
  QelCallbackId id = QelCallbackManager::Get().AddCallback(
      repo, kQelRepositoryModified, nullptr, [&](QelBaseUnknown* publisher, QelBaseUnknown* notification) {
        publisherSeen = publisher;
        QelVar<QelSettingNotif> notif(notification);
        names.push_back(notif ? notif->GetName().Str() : "<not a QelSettingNotif>");
        int value = -1;
        // Subscribers see the new value already stored.
        if (notif) static_cast<QelSettingRepository*>(publisher)->ReadSetting(notif->GetName().CastToCharPtr(), value);
        names.back() += "=" + std::to_string(value);
      });
  const int zero = 0;
  repo->WriteSetting("DataFilteringPanel_TPSCfg", &zero, 1, 0);
  repo->WriteSetting("Quiet", 5, 1);
  repo->RemoveSetting("DataFilteringPanel_TPSCfg");
  EXPECT_EQ(publisherSeen, repo);
  EXPECT_EQ(names, (std::vector<std::string>{"DataFilteringPanel_TPSCfg=0", "DataFilteringPanel_TPSCfg=-1"}));
  QelCallbackManager::Get().RemoveCallback(id);
}

TEST(SettingsFolderTest, FollowsTheEnvironmentInOrder) {
  auto keep = [](const char* name) -> std::optional<std::string> {
    const char* v = std::getenv(name);
    return v ? std::optional<std::string>(v) : std::nullopt;
  };
  auto restore = [](const char* name, const std::optional<std::string>& v) {
    if (v) ::setenv(name, v->c_str(), 1);
    else ::unsetenv(name);
  };
  auto dir = keep("QEL_SETTINGS_DIR"), xdg = keep("XDG_CONFIG_HOME"), home = keep("HOME");
  ::setenv("QEL_SETTINGS_DIR", "/s", 1);
  ::setenv("XDG_CONFIG_HOME", "/x", 1);
  ::setenv("HOME", "/h", 1);
  EXPECT_EQ(QelSettingRepository::SettingsFolder(), "/s");
  ::unsetenv("QEL_SETTINGS_DIR");
  EXPECT_EQ(QelSettingRepository::SettingsFolder(), "/x/qelrovfacets");
  ::setenv("XDG_CONFIG_HOME", "relative", 1);
  EXPECT_EQ(QelSettingRepository::SettingsFolder(), "/h/.config/qelrovfacets");
  restore("QEL_SETTINGS_DIR", dir);
  restore("XDG_CONFIG_HOME", xdg);
  restore("HOME", home);
}

}  // namespace
