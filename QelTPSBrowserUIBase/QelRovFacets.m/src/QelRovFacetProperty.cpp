#include "QelRovFacetProperty.h"

#include "QelAssert.h"
#include "QelRovFacet.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetGroup.h"

const QelMetaObject& QelRovFacetProperty::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovFacetProperty", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetProperty::GetMetaObject() const { return &MetaObject(); }

QelRovFacetProperty::QelRovFacetProperty(const QelUnicodeString& name, const QelUnicodeString& iconName,
                                         QelBaseUnknown* owner)
    : owner_(owner), name_(name), iconName_(iconName) {}

QelRovFacetProperty::~QelRovFacetProperty() = default;

void* QelRovFacetProperty::QueryDirect(const QelIID& iid) {
  return iid == ClassIID ? this : QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelRovFacetProperty::GetChildren(QelListValQelBaseUnknown_var&) { return E_NOTIMPL; }

HRESULT QelRovFacetProperty::UpdateName() { return S_OK; }

HRESULT QelRovFacetProperty::GetName(QelUnicodeString& name) {
  UpdateName();
  name = name_;
  return S_OK;
}

HRESULT QelRovFacetProperty::GetIconName(QelUnicodeString& iconName) const {
  iconName = iconName_;
  return iconName_.IsEmpty() ? E_NOTIMPL : S_OK;
}

HRESULT QelRovFacetProperty::IsChecked(bool& checked) const {
  checked = checkState_ == Checked;
  return S_OK;
}

HRESULT QelRovFacetProperty::GetExpandedFlag(bool& expanded) const {
  expanded = expanded_;
  return S_OK;
}

HRESULT QelRovFacetProperty::SetExpandedFlag(bool expanded) {
  expanded_ = expanded;
  return S_OK;
}

QelVar<QelIRovFacetPropertyObserver> QelRovFacetProperty::ResolveOwnerObserver() const {
  QelVar<QelIRovFacetPropertyObserver> observer(owner_.Get().get());
  if (!observer) QelAssertNullHandler();
  return observer;
}

HRESULT QelRovFacetProperty::SetCheck(bool checked) {
  const QelCheckState newState = checked ? Checked : Unchecked;
  // A radio choice is left only by choosing another one.
  if ((flags_ & FlagRadio) && newState == Unchecked) return S_FALSE;
  if (newState == checkState_) return S_FALSE;

  // The owner may drop its last reference on us while it is asked (a modal question runs
  // the host's loop) or while it reacts: stay alive until done.
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  QelVar<QelIRovFacetPropertyObserver> owner = ResolveOwnerObserver();
  if (!owner) return E_UNEXPECTED;
  if (owner->CanChangeCheckState(this, newState) != S_OK) return E_FAIL;

  checkState_ = newState;
  if (ApplyCheckState() != S_OK) QelAssertBool("ApplyCheckState");
  owner->OnPropertyChanged(this);
  return S_OK;
}

HRESULT QelRovFacetProperty::ResolveFilterData(QelVar<QelRovFacetFilterData>& filterData) const {
  filterData = nullptr;
  if (!(flags_ & FlagValueRange) || !(rangeMode_ & RangeModeMask)) {
    QelAssertBool("range property");
    return E_UNEXPECTED;
  }
  QelVar<QelIRovFacetPropertyObserver> owner = ResolveOwnerObserver();
  if (!owner) return E_UNEXPECTED;
  QelVar<QelRovFacet> facet(owner.get());
  if (!facet) {
    QelAssertPointer("QelRovFacet");
    return E_UNEXPECTED;
  }
  QelVar<QelRovFacetGroup> group = facet->GetFacetGroup();
  if (!group) {
    QelAssertPointer("QelRovFacetGroup");
    return E_UNEXPECTED;
  }
  filterData = QelVar<QelRovFacetFilterData>::Retain(group->GetFilterData());
  if (!filterData) {
    QelAssertPointer("QelRovFacetFilterData");
    return E_UNEXPECTED;
  }
  return S_OK;
}

HRESULT QelRovFacetProperty::GetToleranceValues(QelPropertyOperator& leftOp, double*& leftValue,
                                                QelPropertyOperator& rightOp, double*& rightValue) {
  QelVar<QelRovFacetFilterData> filterData;
  if (ResolveFilterData(filterData) != S_OK) return E_UNEXPECTED;
  filterData->GetToleranceValues(leftOp, leftValue, rightOp, rightValue);
  return S_OK;
}

HRESULT QelRovFacetProperty::SetToleranceValues(QelPropertyOperator leftOp, const double* leftValue,
                                                QelPropertyOperator rightOp, const double* rightValue) {
  QelVar<QelRovFacetFilterData> filterData;
  if (ResolveFilterData(filterData) != S_OK) return E_UNEXPECTED;
  filterData->SetToleranceValues(leftOp, leftValue, rightOp, rightValue);
  if (QelVar<QelIRovFacetPropertyObserver> owner = ResolveOwnerObserver()) owner->OnPropertyChanged(this);
  return S_OK;
}
