#include "QelRovFacetPropertyGroup.h"

#include "QelAssert.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetPropertyItem.h"

namespace {
// Absence of a state while aggregating; never stored.
constexpr QelCheckState kNoState = E_FAIL;

// Folds one counted child's state into the aggregate; true once the result is partial,
// so a caller may stop looking.
bool Fold(QelCheckState& aggregate, QelCheckState state) {
  if (aggregate == kNoState)
    aggregate = state;
  else if (aggregate != state)
    aggregate = PartiallyChecked;
  return aggregate == PartiallyChecked;
}
}  // namespace

const QelMetaObject& QelRovFacetPropertyGroup::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelRovFacetPropertyGroup", QelMetaKind::Implementation,
                             &QelRovFacetProperty::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetPropertyGroup::GetMetaObject() const { return &MetaObject(); }

QelRovFacetPropertyGroup::QelRovFacetPropertyGroup(const QelUnicodeString& name, const QelUnicodeString& iconName,
                                                   QelBaseUnknown* owner, bool withSelectAll)
    : QelRovFacetProperty(name, iconName, owner) {
  SetExpandedFlag(false);
  if (withSelectAll)
    selectAll_ = QelMakeVar<QelRovFacetPropertyItem>(
        QelMsgCatalog::BuildMessage("QelRovLumFacets", "lblSelectAll"), static_cast<QelBaseUnknown*>(this));
}

QelRovFacetPropertyGroup::~QelRovFacetPropertyGroup() {
  selectAll_ = nullptr;
  children_.RemoveAll();
}

HRESULT QelRovFacetPropertyGroup::AddProperty(QelBaseUnknown* property) {
  if (!property) {
    QelAssertPointer("property");
    return E_UNEXPECTED;
  }
  children_.Append(property);
  return S_OK;
}

HRESULT QelRovFacetPropertyGroup::RemoveAllProperties() {
  children_.RemoveAll();
  return S_OK;
}

QelRovFacetProperty* QelRovFacetPropertyGroup::ChildAt(int position) const {
  QelBaseUnknown* entry = children_[position].get();
  if (!entry) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelRovFacetProperty* child = QelRovFacetProperty::From(entry);
  if (!child) QelAssertPointer("QelRovFacetProperty");
  return child;
}

HRESULT QelRovFacetPropertyGroup::StoreAggregate(QelCheckState aggregate) {
  // A radio group without select-all item keeps no aggregate, so having no counted child
  // (kind groups left empty by a pass) is no fault there.
  if (!selectAll_ && !IsCheckBox()) return S_OK;
  if (aggregate == kNoState) {
    QelAssertBool("no counted child");
    return E_UNEXPECTED;
  }
  if (selectAll_)
    selectAll_->SetCheckState(aggregate);
  else if (IsCheckBox())
    SetCheckState(aggregate);
  return S_OK;
}

HRESULT QelRovFacetPropertyGroup::UpdateSelectAllState() {
  if (!selectAll_) return S_FALSE;
  if (!IsRadio()) {
    QelAssertBool("select-all in a radio group");
    return E_UNEXPECTED;
  }
  if (children_.Size() == 0) return S_OK;
  QelCheckState aggregate = kNoState;
  for (int i = 1; i <= children_.Size(); ++i) {
    QelRovFacetProperty* child = ChildAt(i);
    if (!child) continue;
    if (child->GetCheckState() < 0) {
      QelAssertBool("check state");
      continue;
    }
    if (Fold(aggregate, child->GetCheckState())) break;
  }
  return StoreAggregate(aggregate);
}

HRESULT QelRovFacetPropertyGroup::UpdateCheckStateFromChildren() {
  if (selectAll_ && !IsRadio()) {
    QelAssertBool("select-all in a radio group");
    return E_UNEXPECTED;
  }
  if (IsRadio() && !selectAll_) return S_OK;
  QelCheckState aggregate = kNoState;
  for (int i = children_.Size(); i >= 1; --i) {
    QelRovFacetProperty* child = ChildAt(i);
    if (!child) continue;
    if (child->GetCheckState() < 0) {
      QelAssertBool("check state");
      return E_UNEXPECTED;
    }
    if (Fold(aggregate, child->GetCheckState())) break;
  }
  return StoreAggregate(aggregate);
}

HRESULT QelRovFacetPropertyGroup::ApplyCheckState() {
  if (!IsRadio() && !IsCheckBox()) {
    QelAssertBool("check-box or radio group");
    return E_UNEXPECTED;
  }
  const QelCheckState state = GetCheckState();
  const bool twoState = state == Checked || state == Unchecked;
  if (IsRadio() ? !twoState : !(twoState || state == PartiallyChecked)) {
    QelAssertBool("group check state");
    return E_UNEXPECTED;
  }
  // A partial check-box group only re-applies its children's own states.
  const bool pushDown = IsCheckBox() && state != PartiallyChecked;
  for (int i = children_.Size(); i >= 1; --i) {
    QelRovFacetProperty* child = ChildAt(i);
    if (!child) continue;
    if (pushDown) child->SetCheckState(state);
    child->ApplyCheckState();
  }
  return S_OK;
}

HRESULT QelRovFacetPropertyGroup::RefreshCheckState() {
  if (selectAll_ && !IsRadio()) {
    QelAssertBool("select-all in a radio group");
    return E_UNEXPECTED;
  }
  if (children_.Size() == 0) return S_FALSE;
  // Every child is refreshed, even past the first difference, so that each row shows
  // what the display holds; only the comparison stops there.
  QelCheckState aggregate = kNoState;
  bool partial = false;
  for (int i = 1; i <= children_.Size(); ++i) {
    QelRovFacetProperty* child = ChildAt(i);
    if (!child) continue;
    const HRESULT counted = child->RefreshCheckState();
    if (counted < 0) {
      QelAssertBool("RefreshCheckState");
      continue;
    }
    if (counted == S_FALSE) continue;
    if (child->GetCheckState() < 0) {
      QelAssertBool("check state");
      return E_UNEXPECTED;
    }
    if (!partial) partial = Fold(aggregate, child->GetCheckState());
  }
  return StoreAggregate(aggregate);
}

int32_t QelRovFacetPropertyGroup::CountItems() {
  int32_t count = 0;
  for (int i = children_.Size(); i >= 1; --i)
    if (QelRovFacetProperty* child = ChildAt(i)) count += child->CountItems();
  return count;
}

HRESULT QelRovFacetPropertyGroup::GetChildren(QelListValQelBaseUnknown_var& children) {
  if (children.Size() != 0) {
    QelAssertBool("empty list");
    return E_UNEXPECTED;
  }
  if (selectAll_ && (GetFlags() & FlagCheckBox)) QelAssertBool("select-all in a check-box group");
  if (!ResolveOwnerObserver()) return E_UNEXPECTED;
  if (selectAll_ && children_.Size() > 1) children.Append(static_cast<QelBaseUnknown*>(selectAll_.get()));
  for (int i = 1; i <= children_.Size(); ++i) {
    QelRovFacetProperty* child = ChildAt(i);
    if (child && child->CountItems() != 0) children.Append(children_[i]);
  }
  return S_OK;
}

HRESULT QelRovFacetPropertyGroup::CanChangeCheckState(QelBaseUnknown*, QelCheckState) { return S_OK; }

HRESULT QelRovFacetPropertyGroup::OnPropertyChanged(QelBaseUnknown* property) {
  if (!property) {
    QelAssertPointer("property");
    return E_UNEXPECTED;
  }
  // The owner may rebuild its properties, dropping this group, while it reacts.
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  if (selectAll_ && selectAll_->IsEqual(property)) {
    SetCheckState(Checked);
    const QelCheckState state = selectAll_->GetCheckState();
    if (state != Checked && state != Unchecked) {
      QelAssertBool("select-all check state");
      return E_UNEXPECTED;
    }
    for (int i = children_.Size(); i >= 1; --i) {
      QelRovFacetProperty* child = ChildAt(i);
      if (!child) continue;
      child->SetCheckState(state);
      child->ApplyCheckState();
    }
  } else if (IsRadio()) {
    // Choosing anything inside a radio group chooses the group.
    if (GetCheckState() != Checked && ApplyCheckState() != S_OK) QelAssertBool("ApplyCheckState");
    SetCheckState(Checked);
  }
  UpdateCheckStateFromChildren();
  QelVar<QelIRovFacetPropertyObserver> owner = ResolveOwnerObserver();
  if (!owner) return E_UNEXPECTED;
  owner->OnPropertyChanged(this);
  return S_OK;
}
