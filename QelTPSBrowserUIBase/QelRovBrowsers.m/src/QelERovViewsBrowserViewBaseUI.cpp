#include "QelERovViewsBrowserViewBaseUI.h"

#include "Qel3DViewer.h"
#include "QelAssert.h"
#include "QelCommandHeader.h"
#include "QelIAlias.h"
#include "QelIContextualMenu.h"
#include "QelIDbrBrowser.h"
#include "QelIDbrBrowserView.h"
#include "QelIIcon.h"
#include "QelILumCapture.h"
#include "QelMetaObject.h"
#include "QelRovBrowserViewToolbox.h"
#include "QelToolkitCheck.h"

const QelMetaObject& QelERovViewsBrowserViewBaseUI::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelERovViewsBrowserViewBaseUI", QelMetaKind::DataExtension, &QelAdapterVIABaseUI::MetaObject(),
      "QelTPSBrowserUIBase", {"QelTPSLightView", "QelTPSLightCapture"});
  return meta;
}

const QelMetaObject* QelERovViewsBrowserViewBaseUI::GetMetaObject() const { return &MetaObject(); }

QelBaseUnknown* QelERovViewsBrowserViewBaseUI::Create(QelBaseUnknown* extended) {
  return new QelERovViewsBrowserViewBaseUI(extended);
}

QelERovViewsBrowserViewBaseUI::~QelERovViewsBrowserViewBaseUI() = default;

HRESULT QelERovViewsBrowserViewBaseUI::SetBrowserView(QelBaseUnknown_var browserView) {
  browserView_ = QelBaseUnknown_WR(browserView.get());
  return S_OK;
}

void QelERovViewsBrowserViewBaseUI::SetRootPath(QelPathElement* path) {
  // The item path was built under the old root path. It also holds the item itself (and
  // the root path the model's root), so a browser that lets its items go with a null root
  // path must be able to break that loop here.
  if (path != rootPath_.get()) itemPath_ = nullptr;
  rootPath_ = QelVar<QelPathElement>::Retain(path);
}

HRESULT QelERovViewsBrowserViewBaseUI::RefreshItem() {
  if (!browserView_) return S_OK;
  QelISYPIntrospectable* raw = nullptr;
  const HRESULT hr = GetIntrospectable(&raw);
  QelVar<QelISYPIntrospectable> intros = QelVar<QelISYPIntrospectable>::Adopt(raw);
  if (!QelTkCheckCondition(QelSucceeded(hr), "SUCCEEDED(GetIntrospectable( &pIntros ))")) return E_FAIL;
  if (!QelTkCheckHandler(intros, "pIntros")) return E_FAIL;
  QelVar<QelIAfrListItem> row{intros.get()};
  intros = nullptr;
  if (!row) return S_FALSE;
  row->SetShadingColor(row->GetShadingColor());
  return S_OK;
}

HRESULT QelERovViewsBrowserViewBaseUI::RefreshItemProperty(QelString, bool) { return RefreshItem(); }

QelUnicodeString QelERovViewsBrowserViewBaseUI::GetDescription() {
  QelBaseUnknown_var item = item_.Get();
  return QelRovBrowserViewToolbox::GetThumbnailDescription(item);
}

HRESULT QelERovViewsBrowserViewBaseUI::GetPropertyValue(const QelString& column, QelUnicodeString& value) {
  QelBaseUnknown_var item = item_.Get();
  if (column == "NAME") {
    QelVar<QelIAlias> named{item.get()};
    if (!named) {
      QelAssertNullHandler();
      return E_UNEXPECTED;
    }
    named->GetAlias(value);
    return S_OK;
  }
  if (column == "ASSOCIATED_FILTER") {
    value = QelRovBrowserViewToolbox::GetThumbnailDescription(item);
    return S_OK;
  }
  return E_FAIL;
}

HRESULT QelERovViewsBrowserViewBaseUI::GetPropertyIcon(const QelString& column, QelUnicodeString& icon) {
  if (column != "NAME") return E_FAIL;
  QelVar<QelIIcon> iconed{item_.Get().get()};
  if (!iconed) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  iconed->GetIconName(icon);
  return S_OK;
}

HRESULT QelERovViewsBrowserViewBaseUI::GetItemTitle(QelUnicodeString& title) {
  GetPropertyValue("NAME", title);
  return S_OK;
}

HRESULT QelERovViewsBrowserViewBaseUI::GetThumbnail(QelPixelImage** image) {
  if (!image) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  if (!thumbnail_) thumbnail_ = QelVar<QelPixelImage>::Adopt(RenderThumbnail());
  *image = thumbnail_.get();
  if (*image) (*image)->AddRef();
  return S_OK;
}

QelPixelImage* QelERovViewsBrowserViewBaseUI::RenderThumbnail() {
  QelVar<QelIDbrBrowserView> view{browserView_.Get().get()};
  if (!view) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelBaseUnknown_var viewerObject = view->GetPreviewViewer(0);
  auto* viewer = QelSysDynamicCast<Qel3DViewer>(viewerObject.get());
  view->BeginPreview();
  QelPixelImage* image = nullptr;
  QelBaseUnknown_var item = item_.Get();
  if (item && viewer && rootPath_)
    image = QelRovBrowserViewToolbox::GetThumbnailPreview(item, viewer, rootPath_.get());
  view->EndPreview();
  return image;
}

QelPathElement* QelERovViewsBrowserViewBaseUI::GetPathElement() {
  if (!itemPath_) {
    if (!rootPath_) {
      QelAssertPointer();
      return nullptr;
    }
    QelVar<QelPathElement> copy = rootPath_->Copy();
    QelBaseUnknown_var item = item_.Get();
    if (!copy || !item) {
      QelAssertPointer();
      return nullptr;
    }
    copy->AddChildElement(item.get());
    itemPath_ = copy;
  }
  itemPath_->AddRef();
  return itemPath_.get();
}

HRESULT QelERovViewsBrowserViewBaseUI::GetIntrospectable(QelISYPIntrospectable** introspectable) {
  if (!introspectable) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  *introspectable = nullptr;
  if (!intros_) {
    if (QelBaseUnknown_var item = item_.Get()) {
      introsCreation_ = QelMakeVar<QelDbrBrowserViewItemIntros>(item.get());
      intros_ = QelBaseUnknown_WR(introsCreation_.get());
    }
  }
  QelBaseUnknown_var row = intros_.Get();
  if (!QelTkCheckHandler(row, "spIntros")) return E_FAIL;
  void* out = nullptr;
  row->QueryInterface(QelISYPIntrospectable::IID, &out);
  *introspectable = static_cast<QelISYPIntrospectable*>(out);
  return S_OK;
}

HRESULT QelERovViewsBrowserViewBaseUI::GetContextualMenu(QelBaseUnknown_var& menu) {
  QelVar<QelIContextualMenu> contextual{item_.Get().get()};
  if (!contextual) return E_FAIL;
  QelVar<QelIContextualMenuContainer> container;
  const HRESULT status = contextual->GetMenuContainer(container);
  if (QelSucceeded(status) && container) menu = container->GetMenu(0, 0);
  return status;
}

HRESULT QelERovViewsBrowserViewBaseUI::ActivateItem() {
  if (!QelVar<QelILumCapture>(item_.Get().get())) {
    QelAssertNullHandler();
    return S_OK;
  }
  QelCommandHeader* header = QelCommandHeader::GetHeaderFromList("QelTPSDisplayCaptureHdr", 0);
  if (!header) {
    QelAssertPointer();
    return S_OK;
  }
  header->StartCommand();
  return S_OK;
}

HRESULT QelERovViewsBrowserViewBaseUI::NotifyBrowser() {
  QelVar<QelIDbrBrowser> browser{browserView_.Get().get()};
  if (!browser) {
    QelAssertNullHandler();
    return S_OK;
  }
  browser->OnContextObjectChanged();
  return S_OK;
}
