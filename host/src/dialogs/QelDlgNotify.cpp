#include "QelDlgNotify.h"

#include <deque>
#include <utility>

#include "QelAssert.h"
#include "QelDelayedDestruction.h"
#include "QelMsgCatalog.h"

namespace {
struct AnswerSources {
  std::deque<int> queue;
  QelDlgNotify::Asker asker;
  QelDlgNotify::RefusalReporter reporter;
  int refused = 0;
};

AnswerSources& Sources() {
  static AnswerSources sources;
  return sources;
}
}  // namespace

const QelMetaObject& QelDlgNotify::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelDlgNotify", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelDlgNotify::QelDlgNotify(QelBaseUnknown* parent, const char* name, int style)
    : parent_(parent), name_(name), style_(style) {}

int QelDlgNotify::DisplayBlocked(const QelUnicodeString& message, const QelUnicodeString& title) {
  if (answer_ >= 0) return answer_;
  AnswerSources& sources = Sources();
  int answer = AnswerNone;
  if (!sources.queue.empty()) {
    answer = sources.queue.front();
    sources.queue.pop_front();
  } else if (sources.asker) {
    answer = sources.asker(*this, message, title);
  }
  if (answer != AnswerYes && answer != AnswerNo) {
    answer = AnswerNone;
    ++sources.refused;
    const QelUnicodeString report = QelMsgCatalog::BuildMessage("QelDlgNotify", "Refused", {title});
    if (sources.reporter)
      sources.reporter(report);
    else
      QelSysLogError((report.Utf8() + "\n").c_str());
  }
  answer_ = answer;
  return answer;
}

void QelDlgNotify::RequestDelayedDestruction() { QelDelayedDestruction::Request(this); }

void QelDlgNotify::QueueAnswer(int answer) { Sources().queue.push_back(answer); }
int QelDlgNotify::PendingAnswers() { return static_cast<int>(Sources().queue.size()); }
void QelDlgNotify::ClearAnswers() { Sources().queue.clear(); }

QelDlgNotify::Asker QelDlgNotify::SetAsker(Asker asker) { return std::exchange(Sources().asker, std::move(asker)); }

QelDlgNotify::RefusalReporter QelDlgNotify::SetRefusalReporter(RefusalReporter reporter) {
  return std::exchange(Sources().reporter, std::move(reporter));
}

int QelDlgNotify::RefusedCount() { return Sources().refused; }
