#include "QelDbrBrowserContext.h"

#include "QelFrmEditor.h"
#include "QelMetaObject.h"

const QelMetaObject& QelDbrBrowserContext::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelDbrBrowserContext", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelReviewFramework");
  return meta;
}

HRESULT QelDbrBrowserContext::SetBrowser(int browserType, QelBaseUnknown* browser) {
  for (auto& [type, weak] : browsers_)
    if (type == browserType) {
      weak = QelBaseUnknown_WR(browser);
      return S_OK;
    }
  browsers_.emplace_back(browserType, QelBaseUnknown_WR(browser));
  return S_OK;
}

QelBaseUnknown_var QelDbrBrowserContext::GetBrowser(int browserType) const {
  for (const auto& [type, weak] : browsers_)
    if (type == browserType) return weak.Get();
  return nullptr;
}

QelBaseUnknown_var QelDbrBrowserContext::GetUIActiveObject() const {
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  return editor ? editor->GetUIActivePath()->GetLeaf() : nullptr;
}
