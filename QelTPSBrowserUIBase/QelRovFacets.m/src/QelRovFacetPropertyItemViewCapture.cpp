#include "QelRovFacetPropertyItemViewCapture.h"

#include "QelAssert.h"
#include "QelIAlias.h"
#include "QelRovFacetServices.h"

namespace {
void AppendAliasAfterSlash(QelUnicodeString& label, QelBaseUnknown* source) {
  QelVar<QelIAlias> alias = source;
  if (!alias) return;
  QelUnicodeString text;
  alias->GetAlias(text);
  if (!label.IsEmpty()) label += QelUnicodeString("/");
  label += text;
}
}  // namespace

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
  SetCheckState(QelRovFacetServices::IsDisplayEnabled(viewOrCapture));
  if (!SetIconFrom(viewOrCapture)) QelAssertNullHandler();
}

QelRovFacetPropertyItemViewCapture::~QelRovFacetPropertyItemViewCapture() = default;

HRESULT QelRovFacetPropertyItemViewCapture::UpdateName() {
  QelUnicodeString label;
  QelVar<QelIAlias> alias = GetObject().get();
  if (!alias) {
    QelAssertNullHandler();
    SetName(label);
    return E_UNEXPECTED;
  }
  alias->GetAlias(label);
  AppendAliasAfterSlash(label, ownerObject_.Get().get());
  AppendAliasAfterSlash(label, set_.Get().get());
  SetName(label);
  return S_OK;
}

HRESULT QelRovFacetPropertyItemViewCapture::ApplyCheckState() {
  QelBaseUnknown_var object = GetObject();
  if (!object) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  const QelCheckState state = GetCheckState();
  if (state != Checked && state != Unchecked) {
    QelAssertBool("check state");
    return E_UNEXPECTED;
  }
  return QelRovFacetServices::EnableDisableDisplay(object.get(), state == Checked ? 1 : 0, nullptr);
}
