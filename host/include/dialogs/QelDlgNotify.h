#pragma once
// QelDlgNotify: the host's modal question with a confirming and a refusing answer. The
// one who asks makes it, calls DisplayBlocked and then RequestDelayedDestruction; the
// answer comes from the process's answer queue first (a script's or a test's answers
// given ahead), else from the installed asker (a person at a terminal). With neither,
// the question is refused and the refusal is reported: a question is never confirmed
// by default.
#include <functional>
#include <string>

#include "QelVar.h"
#include "QelMetaObject.h"
#include "QelString.h"
#include "QelUnicodeString.h"

class QelDlgNotify : public QelBaseUnknown {
 public:
  // Answers DisplayBlocked gives.
  static constexpr int AnswerNone = 0;  // nobody answered: refused
  static constexpr int AnswerYes = 3;   // the confirming answer
  static constexpr int AnswerNo = 4;
  // Style bits; the confirmation question uses 0x800200 (yes/no buttons, modal).
  static constexpr int StyleYesNo = 0x200;
  static constexpr int StyleModal = 0x800000;

  // Asks a person: AnswerYes, AnswerNo, or AnswerNone when no answer can be had (end of
  // input, say).
  using Asker = std::function<int(const QelDlgNotify& dialog, const QelUnicodeString& message,
                                  const QelUnicodeString& title)>;
  // Told of each refused question, with a text from the host's catalog.
  using RefusalReporter = std::function<void(const QelUnicodeString& report)>;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  QelDlgNotify(QelBaseUnknown* parent, const char* name, int style);

  // Blocks until answered; the answer as above. A dialog answers once; asking again
  // gives the first answer.
  int DisplayBlocked(const QelUnicodeString& message, const QelUnicodeString& title);
  void RequestDelayedDestruction();

  const QelString& GetName() const { return name_; }
  int GetStyle() const { return style_; }
  QelBaseUnknown* GetParent() const { return parent_.get(); }

  // Answers given ahead, consumed in order by the next questions.
  static void QueueAnswer(int answer);
  static int PendingAnswers();
  static void ClearAnswers();
  // Null: no person to ask. Both hooks are process-wide; each setter gives the old one.
  static Asker SetAsker(Asker asker);
  static RefusalReporter SetRefusalReporter(RefusalReporter reporter);
  // How many questions this process refused for want of an answer.
  static int RefusedCount();

 protected:
  ~QelDlgNotify() override = default;

 private:
  QelBaseUnknown_var parent_;
  QelString name_;
  int style_;
  int answer_ = -1;  // not asked yet
};
