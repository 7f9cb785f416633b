// Settings files: the input is a repository's file. Reading any key never throws or
// crashes, and a save afterwards keeps what the file held: merged into the new file when
// it was a settings file, else set aside byte for byte as <file>.corrupt-1.
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <sstream>
#include <vector>

#include "QelFuzzTarget.h"
#include "QelSettingRepository.h"

namespace fs = std::filesystem;
using json = nlohmann::json;

namespace {
std::string ReadAll(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

void ReadEveryWay(QelSettingRepository* repo, const std::string& key) {
  const char* k = key.c_str();
  for (const char* type : {"int", "double", "bool", "string", "", "other"}) repo->IsPresent(k, type);
  int i = 0;
  double d = 0;
  bool b = false;
  QelString s;
  int ints[3];
  double doubles[3];
  repo->ReadSetting(k, i);
  repo->ReadSetting(k, d);
  repo->ReadSetting(k, b);
  repo->ReadSetting(k, s);
  for (int count = 1; count <= 3; ++count) {
    repo->ReadSetting(k, ints, count);
    repo->ReadSetting(k, doubles, count);
  }
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string input(reinterpret_cast<const char*>(data), size);
  const std::string folder = QelFuzzScratchFolder() + "/settings";
  std::error_code ec;
  fs::remove_all(folder, ec);
  fs::create_directories(folder);
  const std::string file = folder + "/Fuzz.json";
  std::ofstream(file, std::ios::binary | std::ios::trunc) << input;

  QelSettingRepository* repo = QelSettingRepository::GetRepository("Fuzz", 0, 1, folder.c_str());
  QelFuzzCheck(repo != nullptr, "the repository exists");
  // The keys the file names, as a reader that tolerates anything sees them.
  json seen = json::parse(input, nullptr, false);
  std::vector<std::string> keys = {"keep", "x", "", "a/b"};
  if (seen.is_object())
    for (const auto& item : seen.items())
      if (keys.size() < 64) keys.push_back(item.key());
  for (const auto& key : keys) ReadEveryWay(repo, key);

  const bool unusable = repo->IsFileUnusable();
  QelFuzzCheck(repo->WriteSetting("fuzz.written", 1) == S_OK, "a write is accepted");
  QelFuzzCheck(repo->SaveRepository() == S_OK, "a save to a writable folder succeeds");
  json saved = json::parse(ReadAll(file), nullptr, false);
  QelFuzzCheck(saved.is_object() && saved.value("fuzz.written", 0) == 1, "the saved file holds the write");
  if (unusable) {
    QelFuzzCheck(ReadAll(file + ".corrupt-1") == input, "an unusable file is kept whole");
  } else {
    QelFuzzCheck(!fs::exists(file + ".corrupt-1"), "a settings file is not set aside");
    saved.erase("fuzz.written");
    if (seen.is_object()) seen.erase("fuzz.written");
    QelFuzzCheck(saved == (seen.is_discarded() ? json::object() : seen), "the save keeps every setting of the file");
  }
  QelSettingRepository::ForgetRepositories();
  return 0;
}
