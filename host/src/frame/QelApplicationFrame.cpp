#include "QelApplicationFrame.h"

#include "QelMetaObject.h"

namespace {
QelApplicationFrame* g_frame = nullptr;  // owns one reference
}  // namespace

const QelMetaObject& QelApplicationFrame::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelApplicationFrame", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelApplicationFrame::QelApplicationFrame(const QelString& workbench)
    : layout_(QelMakeVar<QelFrmLayout>()),
      context_(QelMakeVar<QelFrmContext>(workbench)) {}

QelApplicationFrame* QelApplicationFrame::CreateFrame(const QelString& workbench) {
  if (!g_frame) {
    g_frame = new QelApplicationFrame(workbench);
    g_frame->NoteAdopted();
  }
  return g_frame;
}

void QelApplicationFrame::DestroyFrame() {
  // Cleared first, so code run by the destructors already sees no frame.
  if (QelApplicationFrame* frame = std::exchange(g_frame, nullptr)) frame->Release();
}

QelApplicationFrame* QelApplicationFrame::GetFrame() { return g_frame; }

QelCallbackId QelApplicationFrame::AddCallback(QelBaseUnknown* publisher, std::string_view notification,
                                               QelBaseUnknown* subscriber, QelCallbackFn fn) {
  return QelCallbackManager::Get().AddCallback(publisher, notification, subscriber, std::move(fn));
}

bool QelApplicationFrame::RemoveCallback(QelCallbackId id) { return QelCallbackManager::Get().RemoveCallback(id); }

int QelApplicationFrame::RemoveCallbacksOn(QelBaseUnknown* publisher, QelBaseUnknown* subscriber,
                                           std::string_view notification) {
  return QelCallbackManager::Get().RemoveCallbacksOn(publisher, subscriber, notification);
}
