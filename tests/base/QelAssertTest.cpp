#include "QelAssert.h"

#include <gtest/gtest.h>

#include <climits>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace {
// The exact text: the fixed frame, the line right-aligned in four places, and kind, detail
// and file cut at 32, 40 and 128 characters, so that the longest text fits the 287-byte
// buffer.
TEST(QelAssertText, IsTheFixedFrameWithEachFieldCutAtItsPrecision) {
  EXPECT_EQ(QelFormatAssertion(kQelAssertKindPointer, kQelAssertNullHandler, "QelRovFacet.cpp", 42),
            ">> ASSERTION FAILED ON POINTER : NULL handler [File: QelRovFacet.cpp:  42].<<\n");
  EXPECT_EQ(QelFormatAssertion(nullptr, nullptr, nullptr, 7), ">> ASSERTION FAILED :  [File: :   7].<<\n");
  const std::string kind(40, 'K'), detail(50, 'D'), file(200, 'F');
  std::string text = QelFormatAssertion(kind.c_str(), detail.c_str(), file.c_str(), INT_MIN);
  EXPECT_EQ(text, ">> ASSERTION FAILED " + std::string(32, 'K') + ": " + std::string(40, 'D') + " [File: " +
                      std::string(128, 'F') + ":-2147483648].<<\n");
}

TEST(QelAssertCapture, RecordsKindDetailBaseNameAndCallerLine) {
  QelAssertionCapture capture;
  QelAssertNullHandler();
  const int line = __LINE__ - 1;
  QelAssertPointer();
  QelAssertBool("QelTPS.SubNode.Notes");
  ASSERT_EQ(capture.Count(), 3);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 2);
  EXPECT_EQ(capture.Count(kQelAssertKindPointer, kQelAssertNullHandler), 1);
  EXPECT_EQ(capture.Count(kQelAssertKindBool, "QelTPS.SubNode.Notes"), 1);
  const QelAssertionReport& first = capture.Reports()[0];
  EXPECT_EQ(first.file, "QelAssertTest.cpp");
  EXPECT_EQ(first.line, line);
  EXPECT_EQ(first.text, QelFormatAssertion(kQelAssertKindPointer, kQelAssertNullHandler, "QelAssertTest.cpp", line));
}

TEST(QelAssertCapture, InnermostCaptureRecordsAndOuterResumesAfterIt) {
  QelAssertionCapture outer;
  {
    QelAssertionCapture inner;
    QelAssertBool();
    EXPECT_EQ(inner.Count(), 1);
  }
  EXPECT_EQ(outer.Count(), 0);
  QelAssertBool();
  EXPECT_EQ(outer.Count(kQelAssertKindBool), 1);
}

TEST(QelAssertRoutine, OutsideDevelopmentLogsTheTextAndGoesOn) {
  QelSetDevelopmentStage(false);
  testing::internal::CaptureStderr();
  QelAssertBool("x");
  const int line = __LINE__ - 1;
  std::string logged = testing::internal::GetCapturedStderr();
  EXPECT_EQ(logged, QelFormatAssertion(kQelAssertKindBool, "x", "QelAssertTest.cpp", line));
}

// A log file gets the reports appended (its folder made on the way), a report repeated
// at once as a count, and is made again when removed meanwhile; one that cannot be
// written loses nothing: the report goes to standard error instead.
TEST(QelAssertRoutine, LogFileCollectsReportsAndAnUnwritableOneFallsBackToStandardError) {
  QelSetDevelopmentStage(false);
  const std::filesystem::path dir = std::filesystem::path(testing::TempDir()) / "qel-assert-log";
  std::filesystem::remove_all(dir);
  const std::string path = (dir / "nested" / "host.log").string();
  const int before = QelSysLogCount();
  QelSetSysLogFile(path);
  testing::internal::CaptureStderr();
  for (int i = 0; i < 3; ++i) QelAssertBool("first");  // the same report again: counted, not written
  QelAssertBool("second");
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
  std::stringstream logged;
  logged << std::ifstream(path).rdbuf();
  const size_t first = logged.str().find("first");
  EXPECT_NE(first, std::string::npos);
  EXPECT_EQ(logged.str().find("first", first + 1), std::string::npos);
  EXPECT_LT(logged.str().find("(the report above 2 more times)"), logged.str().find("second"));

  // Removed while the run goes on (a person clearing the log): the next report makes it again.
  std::filesystem::remove(path);
  QelAssertBool("after removal");
  std::stringstream again;
  again << std::ifstream(path).rdbuf();
  EXPECT_NE(again.str().find("after removal"), std::string::npos);

  QelSetSysLogFile(dir.string());  // a folder: cannot be opened as a file
  testing::internal::CaptureStderr();
  QelAssertBool("third");
  EXPECT_NE(testing::internal::GetCapturedStderr().find("third"), std::string::npos);
  QelSetSysLogFile("");
  EXPECT_EQ(QelSysLogCount(), before + 6);
  std::filesystem::remove_all(dir);
}

TEST(QelAssertRoutineDeathTest, DevelopmentRunAbortsWithTheTextPrintedOnce) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(
      {
        QelSetDevelopmentStage(true);
        QelAssertPointer("boom");
      },
      "^qel: abnormal end: >> ASSERTION FAILED ON POINTER : boom [^\n]*\n$");
  QelSetDevelopmentStage(false);
}
}  // namespace
