#include "QelAssert.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace {
TEST(QelAssertText, IsTheFixedFrameAroundKindDetailFileAndLine) {
  EXPECT_EQ(QelFormatAssertion(kQelAssertKindPointer, kQelAssertNullHandler, "QelRovFacet.cpp", 42),
            ">> ASSERTION FAILED ON POINTER : NULL handler [File: QelRovFacet.cpp:  42].<<\n");
  EXPECT_EQ(QelFormatAssertion(kQelAssertKindBool, "", "a.cpp", 12345),
            ">> ASSERTION FAILED BOOL IS FALSE:  [File: a.cpp:12345].<<\n");
  EXPECT_EQ(QelFormatAssertion(nullptr, nullptr, nullptr, 7), ">> ASSERTION FAILED :  [File: :   7].<<\n");
}

TEST(QelAssertText, CutsKindDetailAndFileAt32And40And128Characters) {
  const std::string kind(40, 'K'), detail(50, 'D'), file(200, 'F');
  EXPECT_EQ(QelFormatAssertion(kind.c_str(), detail.c_str(), file.c_str(), 1),
            ">> ASSERTION FAILED " + std::string(32, 'K') + ": " + std::string(40, 'D') + " [File: " +
                std::string(128, 'F') + ":   1].<<\n");
}

TEST(QelAssertText, LongestPossibleTextFitsThe287CharacterBuffer) {
  const std::string kind(32, 'K'), detail(40, 'D'), file(128, 'F');
  std::string text = QelFormatAssertion(kind.c_str(), detail.c_str(), file.c_str(), INT_MIN);
  EXPECT_EQ(text, ">> ASSERTION FAILED " + kind + ": " + detail + " [File: " + file + ":-2147483648].<<\n");
  EXPECT_EQ(text.size(), 247u);  // the widest line number still leaves the buffer unfilled
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

TEST(QelAssertRoutineDeathTest, DevelopmentRunAbortsWithTheText) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(
      {
        QelSetDevelopmentStage(true);
        QelAssertPointer("boom");
      },
      "ASSERTION FAILED ON POINTER : boom");
  QelSetDevelopmentStage(false);
}
}  // namespace
