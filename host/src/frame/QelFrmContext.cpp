#include "QelFrmContext.h"

#include "QelApplicationFrame.h"
#include "QelCallbackManager.h"
#include "QelMetaObject.h"

const QelMetaObject& QelFrmContext::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelFrmContext", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelFrmContext* QelFrmContext::GetContext() {
  QelApplicationFrame* frame = QelApplicationFrame::GetFrame();
  return frame ? frame->GetContext() : nullptr;
}

HRESULT QelFrmContext::SwitchWorkbench(const QelString& workbench) {
  if (workbench == current_) return S_FALSE;
  QelVar<QelFrmContext> keep = QelVar<QelFrmContext>::Retain(this);
  next_ = workbench;
  if (QelApplicationFrame* frame = QelApplicationFrame::GetFrame())
    QelCallbackManager::Get().Dispatch(frame->GetDispatcher(), kQelAfrAccessChanged, this);
  // A subscriber may have switched again; the last switch wins.
  current_ = next_;
  return S_OK;
}
