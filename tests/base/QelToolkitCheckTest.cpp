#include "QelToolkitCheck.h"

#include <gtest/gtest.h>

#include "QelAssert.h"
#include "QelVar.h"

namespace {
TEST(QelToolkitCheck, FailedChecksAreCapturedUnderTheirOwnKinds) {
  QelAssertionCapture capture;
  int value = 0;
  QelBaseUnknown_var none;
  EXPECT_TRUE(QelTkCheckPointer(&value, "pArgs"));
  EXPECT_FALSE(QelTkCheckPointer(static_cast<int*>(nullptr), "pArgs"));
  EXPECT_FALSE(QelTkCheckHandler(none, "spIntros"));
  EXPECT_TRUE(QelTkCheckCondition(true, "never reported"));
  EXPECT_FALSE(QelTkCheckCondition(false, "SUCCEEDED(GetIntrospectable( &pIntros ))"));
  QelTkReportMissingHandler("pIntros");

  EXPECT_EQ(capture.Count(), 4);
  EXPECT_EQ(capture.Count(kQelTkCheckKindPointer, "pArgs"), 1);
  EXPECT_EQ(capture.Count(kQelTkCheckKindHandler), 2);
  EXPECT_EQ(capture.Count(kQelTkCheckKindHandler, "spIntros"), 1);
  EXPECT_EQ(capture.Count(kQelTkCheckKindCondition, "SUCCEEDED(GetIntrospectable( &pIntros ))"), 1);
  // Toolkit checks are not assertions: a test counting assertions does not see them.
  EXPECT_EQ(capture.Count(kQelAssertKindPointer), 0);
  EXPECT_EQ(capture.Reports()[0].file, "QelToolkitCheckTest.cpp");
}

TEST(QelToolkitCheck, TextCarriesTheOptionalMessage) {
  EXPECT_EQ(QelFormatToolkitCheck(kQelTkCheckKindCondition, "i_pObj->GetImpl() == i_pObj",
                                  "i_pObj may be an extension; referencing an extension with a weak-ref is not possible.",
                                  "W.cpp", 9),
            ">> CHECK FAILED CONDITION FAILED: i_pObj->GetImpl() == i_pObj: i_pObj may be an extension; referencing "
            "an extension with a weak-ref is not possible. [File: W.cpp:   9].<<\n");
  EXPECT_EQ(QelFormatToolkitCheck(kQelTkCheckKindPointer, "i_pSupport", nullptr, "W.cpp", 10),
            ">> CHECK FAILED NULL POINTER: i_pSupport [File: W.cpp:  10].<<\n");
}

TEST(QelToolkitCheck, DevelopmentRunLogsAndGoesOnInsteadOfAborting) {
  QelSetDevelopmentStage(true);
  testing::internal::CaptureStderr();
  bool held = QelTkCheckPointer(static_cast<void*>(nullptr), "pEventFactory");
  std::string logged = testing::internal::GetCapturedStderr();
  QelSetDevelopmentStage(false);
  EXPECT_FALSE(held);
  EXPECT_NE(logged.find(">> CHECK FAILED NULL POINTER: pEventFactory [File: QelToolkitCheckTest.cpp:"),
            std::string::npos);
}
}  // namespace
