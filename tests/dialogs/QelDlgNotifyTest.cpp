// The host's question: answers given ahead come first, then the person asked; with
// neither the question is refused and reported; the dialog goes at the next idle time.
#include <gtest/gtest.h>

#include "QelDelayedDestruction.h"
#include "QelDlgNotify.h"

namespace {

struct Hooks {
  Hooks() {
    oldAsker = QelDlgNotify::SetAsker(nullptr);
    oldReporter = QelDlgNotify::SetRefusalReporter([this](const QelUnicodeString& text) { reports.push_back(text.Utf8()); });
  }
  ~Hooks() {
    QelDlgNotify::ClearAnswers();
    QelDlgNotify::SetAsker(oldAsker);
    QelDlgNotify::SetRefusalReporter(oldReporter);
  }
  QelDlgNotify::Asker oldAsker;
  QelDlgNotify::RefusalReporter oldReporter;
  std::vector<std::string> reports;
};

int Ask() {
  auto dialog = QelMakeVar<QelDlgNotify>(nullptr, "Q", 0x800200);
  const int answer = dialog->DisplayBlocked(QelUnicodeString("Go on?"), QelUnicodeString("Question"));
  dialog->RequestDelayedDestruction();
  return answer;
}

TEST(QelDlgNotify, QueuedAnswersComeBeforeThePersonAsked) {
  Hooks hooks;
  std::vector<std::string> asked;
  QelDlgNotify::SetAsker([&](const QelDlgNotify& dialog, const QelUnicodeString& message, const QelUnicodeString& title) {
    asked.push_back(dialog.GetName().Str() + ":" + title.Utf8() + ":" + message.Utf8());
    return QelDlgNotify::AnswerNo;
  });
  QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
  EXPECT_EQ(Ask(), QelDlgNotify::AnswerYes);
  EXPECT_TRUE(asked.empty());
  EXPECT_EQ(Ask(), QelDlgNotify::AnswerNo);
  EXPECT_EQ(asked, (std::vector<std::string>{"Q:Question:Go on?"}));
  EXPECT_TRUE(hooks.reports.empty());
}

TEST(QelDlgNotify, WithoutAnswerTheQuestionIsRefusedAndReported) {
  Hooks hooks;
  const int before = QelDlgNotify::RefusedCount();
  EXPECT_EQ(Ask(), QelDlgNotify::AnswerNone);
  // A person who gives up (end of input) refuses too; an answer out of range is none.
  QelDlgNotify::SetAsker([](const QelDlgNotify&, const QelUnicodeString&, const QelUnicodeString&) { return 7; });
  EXPECT_EQ(Ask(), QelDlgNotify::AnswerNone);
  EXPECT_EQ(QelDlgNotify::RefusedCount(), before + 2);
  ASSERT_EQ(hooks.reports.size(), 2u);
  EXPECT_EQ(hooks.reports[0], "No answer to the question \"Question\": refused.");
}

TEST(QelDlgNotify, AnsweredDialogLivesUntilTheNextIdleTime) {
  Hooks hooks;
  QelDelayedDestruction::FlushIdle();
  QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
  auto dialog = QelMakeVar<QelDlgNotify>(nullptr, "Q", 0x800200);
  EXPECT_EQ(dialog->DisplayBlocked(QelUnicodeString("m"), QelUnicodeString("t")), QelDlgNotify::AnswerYes);
  EXPECT_EQ(dialog->DisplayBlocked(QelUnicodeString("m"), QelUnicodeString("t")), QelDlgNotify::AnswerYes);
  dialog->RequestDelayedDestruction();
  QelDlgNotify* raw = dialog.get();
  dialog = nullptr;
  EXPECT_EQ(QelDelayedDestruction::PendingCount(), 1);
  EXPECT_EQ(raw->GetStyle(), 0x800200);  // still alive: the queue holds it
  EXPECT_EQ(QelDelayedDestruction::FlushIdle(), 1);
}

}  // namespace
