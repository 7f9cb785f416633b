#include "QelFrmEditor.h"

#include "QelCallbackManager.h"
#include "QelFrmLayout.h"
#include "QelFrmWindow.h"
#include "QelMetaObject.h"

const QelMetaObject& QelFrmEditor::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelFrmEditor", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

QelFrmEditor::QelFrmEditor(QelBaseUnknown* root)
    : root_(root),
      cso_(QelMakeVar<QelCSO>()),
      uiActivePath_(QelMakeVar<QelPathElement>()) {}

QelFrmEditor* QelFrmEditor::GetCurrentEditor() {
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  QelFrmWindow* window = layout ? layout->GetCurrentWindow() : nullptr;
  return window ? window->GetEditor() : nullptr;
}

void QelFrmEditor::SetUIActivePath(QelPathElement* path) {
  QelVar<QelPathElement> fresh = path ? path->Copy() : QelMakeVar<QelPathElement>();
  if (fresh->IsSamePath(uiActivePath_.get())) return;
  uiActivePath_ = std::move(fresh);
  // The editor may lose its last outside reference inside a subscriber.
  QelVar<QelFrmEditor> keep = QelVar<QelFrmEditor>::Retain(this);
  QelCallbackManager::Get().Dispatch(this, kQelUIActiveObjectChanged);
  if (QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout())
    QelCallbackManager::Get().Dispatch(layout, kQelUIActiveObjectChanged, this);
}
