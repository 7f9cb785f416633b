#include "QelFrmLayout.h"

#include "QelApplicationFrame.h"
#include "QelCallbackManager.h"
#include "QelMetaObject.h"

const QelMetaObject& QelFrmLayout::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelFrmLayout", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelFrmLayout* QelFrmLayout::GetCurrentLayout() {
  QelApplicationFrame* frame = QelApplicationFrame::GetFrame();
  return frame ? frame->GetLayout() : nullptr;
}

QelListValQelBaseUnknown_var QelFrmLayout::GetWindowList(QelFrmEditor* editor, const char* kind) const {
  QelListValQelBaseUnknown_var list;
  for (const auto& entry : windows_) {
    auto* window = QelSysDynamicCast<QelFrmWindow>(entry.get());
    if (!window) continue;
    if (editor && !editor->IsEqual(window->GetEditor())) continue;
    if (kind && *kind && !window->IsAKindOf(kind)) continue;
    list.Append(entry);
  }
  return list;
}

HRESULT QelFrmLayout::AddWindow(QelFrmWindow* window) {
  if (!window) return E_FAIL;
  if (windows_.Locate(window)) return S_FALSE;
  windows_.Append(window);
  return S_OK;
}

HRESULT QelFrmLayout::RemoveWindow(QelFrmWindow* window) {
  if (!window) return E_FAIL;
  // Held across the removal: the list may hold the last reference.
  QelVar<QelFrmWindow> keep = QelVar<QelFrmWindow>::Retain(window);
  if (!windows_.RemoveValue(window)) return S_FALSE;
  if (current_.get() == window) {
    current_ = nullptr;
    ActivateAfterRemoval();
  }
  return S_OK;
}

HRESULT QelFrmLayout::SetCurrentWindow(QelFrmWindow* window) {
  if (window && !windows_.Locate(window)) return E_FAIL;
  if (current_.get() == window) return S_FALSE;
  current_ = QelVar<QelFrmWindow>::Retain(window);
  if (window) {
    QelVar<QelFrmLayout> keep = QelVar<QelFrmLayout>::Retain(this);
    QelCallbackManager::Get().Dispatch(this, kQelWindowActivated, window);
  }
  return S_OK;
}

HRESULT QelFrmLayout::CloseEditor(QelFrmEditor* editor) {
  if (!editor) return E_FAIL;
  if (editor->closed_) return S_FALSE;
  QelVar<QelFrmEditor> keepEditor = QelVar<QelFrmEditor>::Retain(editor);
  QelVar<QelFrmLayout> keepLayout = QelVar<QelFrmLayout>::Retain(this);
  bool currentWent = false;
  for (const auto& entry : GetWindowList(editor)) {
    if (entry.get() == current_.get()) currentWent = true;
    windows_.RemoveValue(entry.get());
  }
  if (currentWent) current_ = nullptr;
  editor->closed_ = true;
  QelCallbackManager::Get().Dispatch(this, kQelEditorCloseEnded, editor);
  // A subscriber may have activated a window already.
  if (currentWent && !current_) ActivateAfterRemoval();
  return S_OK;
}

void QelFrmLayout::ActivateAfterRemoval() {
  if (windows_.Size() == 0) return;
  SetCurrentWindow(QelSysDynamicCast<QelFrmWindow>(windows_[windows_.Size()].get()));
}
