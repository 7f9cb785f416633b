#include "QelRovFacet.h"

#include "QelAssert.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetProperty.h"
#include "QelRovFacetPropertyGroup.h"

const QelMetaObject& QelRovFacet::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelRovFacet", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacet::GetMetaObject() const { return &MetaObject(); }

QelRovFacet::QelRovFacet(QelBaseUnknown* group) : group_(group) {}

QelRovFacet::~QelRovFacet() = default;

HRESULT QelRovFacet::GetProperties(QelListValQelBaseUnknown_var& properties) {
  if (properties.Size() != 0) {
    QelAssertBool("empty list");
    return E_UNEXPECTED;
  }
  properties.Append(properties_);
  return S_OK;
}

QelVar<QelRovFacetGroup> QelRovFacet::GetFacetGroup() const {
  QelBaseUnknown_var group = group_.Get();
  if (!group) {
    QelAssertNullHandler();
    return nullptr;
  }
  return QelVar<QelRovFacetGroup>(group.get());
}

QelRovFacetProperty* QelRovFacet::PropertyAt(int position) const {
  QelRovFacetProperty* property = QelSysDynamicCast<QelRovFacetProperty>(properties_[position].get());
  if (!property) QelAssertPointer("QelRovFacetProperty");
  return property;
}

QelRovFacetPropertyGroup* QelRovFacet::PropertyGroupAt(int position) const {
  auto* group = QelSysDynamicCast<QelRovFacetPropertyGroup>(properties_[position].get());
  if (!group) QelAssertPointer("QelRovFacetPropertyGroup");
  return group;
}

HRESULT QelRovFacet::GetFacetName(QelUnicodeString& name) const {
  name = name_;
  return name_.IsEmpty() ? E_FAIL : S_OK;
}

HRESULT QelRovFacet::GetExpandedFlag(bool& expanded) const {
  expanded = expanded_;
  return S_OK;
}

HRESULT QelRovFacet::SetExpandedFlag(bool expanded) {
  expanded_ = expanded;
  return S_OK;
}

HRESULT QelRovFacet::CanChangeCheckState(QelBaseUnknown*, QelCheckState) { return S_OK; }

HRESULT QelRovFacet::OnPropertyChanged(QelBaseUnknown* property) {
  QelRovFacetProperty* changed = QelSysDynamicCast<QelRovFacetProperty>(property);
  if (!changed) {
    QelAssertPointer("QelRovFacetProperty");
    return E_UNEXPECTED;
  }
  // The group may drop this facet while it refreshes the dependent facets.
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  if (changed->GetFlags() & QelRovFacetProperty::FlagRadio) {
    for (int i = properties_.Size(); i >= 1; --i) {
      QelRovFacetProperty* other = QelSysDynamicCast<QelRovFacetProperty>(properties_[i].get());
      if (!other) {
        QelAssertPointer("QelRovFacetProperty");
        continue;
      }
      if (!other->IsEqual(property) && (other->GetFlags() & QelRovFacetProperty::FlagRadio))
        other->SetCheckState(Unchecked);
    }
  }
  if (ApplyPropertyChange(property) == S_OK) {
    QelVar<QelIRovFacetPropertyObserver> group(group_.Get().get());
    if (!group) {
      QelAssertNullHandler();
      return E_UNEXPECTED;
    }
    group->OnPropertyChanged(this);
  }
  return S_OK;
}
