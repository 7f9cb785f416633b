// The child process the translation runs in: its bytes come back whole, and a crash, a
// loop without end or a runaway allocation ends the child alone, told apart.
#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <new>
#include <vector>

#include "QelStepChildProcess.h"

TEST(QelStepChildProcessTest, BytesComeBackWholeAndEveryWayOfDyingIsToldApart) {
  QelStepChildProcess::Limits limits;
  limits.cpuSeconds = 1.0;
  limits.wallSeconds = 20.0;
  // More than a pipe holds at once: the caller drains while the child writes.
  QelStepChildProcess::Outcome outcome = QelStepChildProcess::Run([] { return std::string(3 << 20, 'x'); }, limits);
  EXPECT_TRUE(outcome.finished);
  EXPECT_EQ(outcome.bytes.size(), size_t(3) << 20);

  // A sanitizer's own handler would turn the signal into an exit status: the default one.
  outcome = QelStepChildProcess::Run([]() -> std::string {
    std::signal(SIGSEGV, SIG_DFL);
    std::raise(SIGSEGV);
    return "never";
  }, limits);
  EXPECT_FALSE(outcome.finished);
  EXPECT_EQ(outcome.signal, SIGSEGV);
  EXPECT_TRUE(outcome.bytes.empty());

  outcome = QelStepChildProcess::Run([]() -> std::string {
    volatile unsigned long spins = 0;
    for (;;) spins = spins + 1;
  }, limits);
  EXPECT_FALSE(outcome.finished);
  EXPECT_TRUE(outcome.outOfTime);

  // What the work throws ends the child without an answer.
  outcome = QelStepChildProcess::Run([]() -> std::string { throw std::bad_alloc(); }, limits);
  EXPECT_FALSE(outcome.finished);
  EXPECT_EQ(outcome.signal, 0);
}
