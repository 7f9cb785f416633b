#include "QelLumCapture.h"

#include "QelLumAnnotationSet.h"
#include "QelMetaObject.h"

const QelMetaObject& QelLumCapture::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumCapture", QelMetaKind::Implementation,
                                                            &QelModelObject::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumCapture::GetMetaObject() const { return &MetaObject(); }
const char* QelLumCapture::GetLateType() const { return light_ ? "QelTPSLightCapture" : "QelLumCapture"; }

QelLumCapture::QelLumCapture(QelLumAnnotationSet* set, std::string alias, std::string icon, QelBaseUnknown* view,
                             QelICamera* camera, bool shown)
    : QelModelObject(std::move(alias), std::move(icon), shown),
      set_(set ? set->GetImpl() : nullptr),
      view_(view),
      camera_(QelVar<QelICamera>::Retain(camera)),
      light_(set && set->IsLight()) {}
QelLumCapture::~QelLumCapture() = default;

void* QelLumCapture::QueryDirect(const QelIID& iid) {
  if (iid == QelITPSLight::IID) return light_ ? static_cast<QelITPSLight*>(this) : nullptr;
  if (void* mine = QelQueryDirect<QelILumCapture, QelISetMember>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelLumAnnotationSet* QelLumCapture::Set() const { return QelSysDynamicCast<QelLumAnnotationSet>(set_.GetRaw()); }

HRESULT QelLumCapture::GetSet(QelBaseUnknown_var& set) {
  set = set_.Get();
  return set ? S_OK : E_FAIL;
}

HRESULT QelLumCapture::GetOwner(QelBaseUnknown_var& set) { return GetSet(set); }

HRESULT QelLumCapture::IsLinkedToView(bool& linked) {
  linked = view_.IsAlive();
  return S_OK;
}

HRESULT QelLumCapture::GetLinkedView(QelBaseUnknown_var& view) {
  view = view_.Get();
  return view ? S_OK : E_FAIL;
}

HRESULT QelLumCapture::GetCamera(QelVar<QelICamera>& camera) {
  camera = camera_;
  return camera ? S_OK : S_FALSE;
}
