#include "QelMsgCatalog.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <map>

#include <unistd.h>

namespace {
namespace fs = std::filesystem;

// Points QEL_RESOURCES_DIR at a fresh folder for one test and restores it afterwards.
// Each test gets its own folder, so the process-wide cache never serves a stale file.
class QelMsgCatalogFolder : public testing::Test {
 protected:
  void SetUp() override {
    const char* previous = std::getenv("QEL_RESOURCES_DIR");
    hadPrevious_ = previous != nullptr;
    if (previous) previous_ = previous;
    const auto* info = testing::UnitTest::GetInstance()->current_test_info();
    root_ = fs::path(testing::TempDir()) / (std::string("qelcat_") + info->name() + "_" + std::to_string(::getpid()));
    fs::remove_all(root_);
    fs::create_directories(root_ / "catalogs");
    setenv("QEL_RESOURCES_DIR", root_.c_str(), 1);
  }
  void TearDown() override {
    if (hadPrevious_) setenv("QEL_RESOURCES_DIR", previous_.c_str(), 1);
    else unsetenv("QEL_RESOURCES_DIR");
    fs::remove_all(root_);
  }
  std::string Write(const std::string& catalog, const std::string& content) {
    fs::path path = root_ / "catalogs" / (catalog + ".qelcat");
    std::ofstream(path, std::ios::binary) << content;
    return path.string();
  }

  fs::path root_;

 private:
  bool hadPrevious_ = false;
  std::string previous_;
};

std::string Message(const char* catalog, const char* key, const std::vector<QelUnicodeString>& params = {},
                    const char* defaultText = "") {
  return QelMsgCatalog::BuildMessage(catalog, key, params, defaultText).Utf8();
}

TEST_F(QelMsgCatalogFolder, MalformedLinesAreReportedOnceByFileAndLineAndSkipped) {
  std::string path = Write("Test",
                           "// labels\n"
                           "First = \"one\";\n"
                           "Broken \"no equals\";\n"
                           "\n"
                           "Open = \"never closed;\n"
                           "Second = \"two\" ; // trailing comment\n"
                           "Second = \"again\";\n"
                           "Bad.Escape = \"\\q\";\n"
                           "Third=\"three\";extra\n"
                           "Last = \"last\";");
  testing::internal::CaptureStderr();
  EXPECT_EQ(Message("Test", "First"), "one");
  EXPECT_EQ(Message("Test", "Second"), "two");
  EXPECT_EQ(Message("Test", "Last"), "last");
  EXPECT_EQ(Message("Test", "Open", {}, "default"), "default");
  std::string warnings = testing::internal::GetCapturedStderr();

  for (int line : {3, 5, 7, 8, 9})
    EXPECT_NE(warnings.find(path + ":" + std::to_string(line) + ": "), std::string::npos) << line;
  EXPECT_NE(warnings.find("expected '=' after the key \"Broken\""), std::string::npos);
  EXPECT_NE(warnings.find("already defined on line 6"), std::string::npos);
  EXPECT_EQ(std::count(warnings.begin(), warnings.end(), '\n'), 5);  // parsed once, not per look-up
  std::vector<QelString> keys = QelMsgCatalog::ListKeys("Test");
  ASSERT_EQ(keys.size(), 3u);
  EXPECT_EQ(keys[0], QelString("First"));
}

TEST_F(QelMsgCatalogFolder, MissingKeyOrCatalogGivesTheDefaultText) {
  Write("Test", "Known = \"known\";\n");
  EXPECT_EQ(Message("Test", "Unknown", {}, "fallback"), "fallback");
  EXPECT_EQ(Message("Test", "Unknown"), "");
  EXPECT_EQ(Message("Test", nullptr, {}, "fallback"), "fallback");
  testing::internal::CaptureStderr();
  EXPECT_EQ(Message("NoSuchCatalog", "Known", {}, "fallback"), "fallback");
  EXPECT_NE(testing::internal::GetCapturedStderr().find("\"NoSuchCatalog\" not found"), std::string::npos);
  EXPECT_TRUE(QelMsgCatalog::ListKeys("NoSuchCatalog").empty());
  // A name that would leave the catalog folder is never opened.
  EXPECT_EQ(Message("../catalogs/Test", "Known", {}, "fallback"), "fallback");
  EXPECT_EQ(Message(nullptr, "Known", {}, "fallback"), "fallback");
}

TEST_F(QelMsgCatalogFolder, ParametersEscapesAndLineEndingsAreHonoured) {
  Write("Test",
        "\xEF\xBB\xBF"
        "Count = \"/p2 of /p1 sets, /p3 left\";\r\n"
        "Ten = \"/p10/p1\";\r\n"
        "Quote = \"say \\\"hi\\\"\\n\\tnow \\\\ \xC3\xA9t\xC3\xA9\";\n");
  EXPECT_EQ(Message("Test", "Count", {"12", "3"}), "3 of 12 sets, /p3 left");
  EXPECT_EQ(Message("Test", "Count"), "/p2 of /p1 sets, /p3 left");
  EXPECT_EQ(Message("Test", "Ten", {"/p1"}), "/p10/p1");  // no /p10; a parameter is not rescanned
  EXPECT_EQ(Message("Test", "Quote"), "say \"hi\"\n\tnow \\ \xC3\xA9t\xC3\xA9");
}

TEST_F(QelMsgCatalogFolder, InvalidUtf8TextIsReportedAndSkipped) {
  std::string path = Write("Test", "Bad = \"\xFF\";\nGood = \"fine\";\n");
  testing::internal::CaptureStderr();
  EXPECT_EQ(Message("Test", "Good"), "fine");
  EXPECT_EQ(Message("Test", "Bad", {}, "default"), "default");
  EXPECT_NE(testing::internal::GetCapturedStderr().find(path + ":1: the text of \"Bad\" is not valid UTF-8"),
            std::string::npos);
}

TEST(QelMsgCatalogShipped, EveryKeyTheModuleReadsHasAText) {
  const char* previous = std::getenv("QEL_RESOURCES_DIR");
  std::string saved = previous ? previous : "";
  unsetenv("QEL_RESOURCES_DIR");
  const std::map<std::string, std::vector<std::string>> expected = {
      {"QelRovLumFacets",
       {"lblSelectAll", "Annotation", "Annotation.All", "Annotation.Type", "Annotation.Custom",
        "Annotation.DefaultAnnot", "Annotation.TolAnnot", "AnnotationSet", "AnnotationSet.All",
        "AnnotationSet.Root", "AnnotationSet.Custom", "AnnotationSet.None", "AnnotationSet.AllDlg.Message",
        "AnnotationSet.AllDlg.Title", "AnnotationView", "AnnotationView.All", "AnnotationView.Custom"}},
      {"QelTPSLightBase",
       {"QelTPS.SubNode.Datums", "QelTPS.SubNode.GeomTolerances", "QelTPS.SubNode.Dimensions",
        "QelTPS.SubNode.Roughness", "QelTPS.SubNode.Welds", "QelTPS.SubNode.Notes", "QelTPS.SubNode.Geometries"}},
      {"QelRovRefinementCmd", {"Title"}},
      {"QelDbrBrowserViewDlg", {"Title_CaptureBrowser", "NameHeader", "SupportHeader"}},
  };
  testing::internal::CaptureStderr();
  for (const auto& [catalog, keys] : expected) {
    std::vector<QelString> shipped = QelMsgCatalog::ListKeys(catalog.c_str());
    EXPECT_EQ(shipped.size(), keys.size()) << catalog;
    for (const std::string& key : keys) {
      EXPECT_NE(std::find(shipped.begin(), shipped.end(), QelString(key)), shipped.end()) << catalog << " " << key;
      EXPECT_FALSE(QelMsgCatalog::BuildMessage(catalog.c_str(), key.c_str()).IsEmpty()) << catalog << " " << key;
    }
  }
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "");  // the shipped files parse cleanly
  if (previous) setenv("QEL_RESOURCES_DIR", saved.c_str(), 1);
}
}  // namespace
