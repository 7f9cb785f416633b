#include "QelRovFacetPropertyItemViewCapture.h"

#include "QelAssert.h"
#include "QelIAlias.h"

const QelMetaObject& QelRovFacetPropertyItemViewCapture::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyItemViewCapture", QelMetaKind::Implementation,
                             &QelRovFacetPropertyItem::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyItemViewCapture::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyItemViewCapture::QelRovFacetPropertyItemViewCapture(QelBaseUnknown* viewOrCapture,
                                                                       QelBaseUnknown* ownerObject,
                                                                       QelBaseUnknown* set, QelBaseUnknown* group)
    : QelRovFacetPropertyItem(QelUnicodeString(), group), ownerObject_(ownerObject), set_(set) {
  SetObject(viewOrCapture);
  ReadStateFromDisplay(viewOrCapture);
  if (!SetIconFrom(viewOrCapture)) QelAssertNullHandler();
}

QelRovFacetPropertyItemViewCapture::~QelRovFacetPropertyItemViewCapture() = default;

HRESULT QelRovFacetPropertyItemViewCapture::UpdateName() {
  QelUnicodeString label;
  QelVar<QelIAlias> alias(GetObject().get());
  if (!alias) {
    QelAssertNullHandler();
    SetName(label);
    return E_UNEXPECTED;
  }
  alias->GetAlias(label);
  AppendAlias(label, ownerObject_.Get().get(), "/");
  AppendAlias(label, set_.Get().get(), "/");
  SetName(label);
  return S_OK;
}

HRESULT QelRovFacetPropertyItemViewCapture::ApplyCheckState() { return ApplyToObject(nullptr, false); }
