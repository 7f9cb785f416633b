// qel_settings_probe <folder> <repository> <key> <int|double|bool|string> [<int to save>]
// Prints the setting as this process reads it from the file, or "absent" (exit status 1).
// With a value, first writes it as an int and saves ("not saved", exit status 3, on failure).
#include <cstdio>
#include <cstdlib>
#include <string>

#include "QelSettingRepository.h"

int main(int argc, char** argv) {
  if (argc != 5 && argc != 6) {
    std::fprintf(stderr, "usage: qel_settings_probe <folder> <repository> <key> <type> [<int to save>]\n");
    return 2;
  }
  QelSettingRepository* repository = QelSettingRepository::GetRepository(argv[2], 0, 1, argv[1]);
  const std::string type = argv[4];
  if (argc == 6 && (!repository || repository->WriteSetting(argv[3], std::atoi(argv[5])) != S_OK ||
                    repository->SaveRepository() != S_OK)) {
    std::printf("not saved\n");
    return 3;
  }
  if (!repository || !repository->IsPresent(argv[3], argv[4])) {
    std::printf("absent\n");
    return 1;
  }
  if (type == "int") {
    int value = 0;
    repository->ReadSetting(argv[3], value);
    std::printf("%d\n", value);
  } else if (type == "double") {
    double value = 0;
    repository->ReadSetting(argv[3], value);
    std::printf("%.17g\n", value);
  } else if (type == "bool") {
    bool value = false;
    repository->ReadSetting(argv[3], value);
    std::printf("%s\n", value ? "true" : "false");
  } else {
    QelString value;
    repository->ReadSetting(argv[3], value);
    std::printf("%s\n", value.CastToCharPtr());
  }
  return 0;
}
