#pragma once
// QelRovFacetPropertyGroup: a property holding further properties. A check-box group
// (flag 0x10) takes the aggregate state of its children and pushes a click down to them;
// a radio group (flag 0x20) is one exclusive choice of its facet whose children keep
// their own states, optionally under a select-all item. The group holds its children and
// its select-all item; each of them holds the group weakly as its owner.
#include "QelRovFacetProperty.h"

class QelRovFacetPropertyItem;

class QelRovFacetPropertyGroup : public QelRovFacetProperty {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelRovFacetPropertyGroup(const QelUnicodeString& name, const QelUnicodeString& iconName, QelBaseUnknown* owner,
                           bool withSelectAll);

  HRESULT AddProperty(QelBaseUnknown* property);
  QelListValQelBaseUnknown_var& GetPropertyList() { return children_; }
  HRESULT RemoveAllProperties();
  // Null when the group was made without one.
  QelRovFacetPropertyItem* GetSelectAllItem() const { return selectAll_.get(); }

  // Sets the select-all item's state from the children's stored states. S_FALSE when the
  // group has no select-all item.
  HRESULT UpdateSelectAllState();
  // Sets the group's (or its select-all item's) state from the children's stored states,
  // without reading the display.
  HRESULT UpdateCheckStateFromChildren();

  HRESULT ApplyCheckState() override;
  // Refreshes every child, then aggregates those that count. S_FALSE for a group without
  // children, which its parent then leaves out.
  HRESULT RefreshCheckState() override;
  int32_t CountItems() override;
  // The select-all item first (only with more than one child), then the children that
  // stand for at least one item.
  HRESULT GetChildren(QelListValQelBaseUnknown_var& children) override;

  // Observer operations, forwarded by the group's tie. A group never vetoes.
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState);
  HRESULT OnPropertyChanged(QelBaseUnknown* property);

 protected:
  ~QelRovFacetPropertyGroup() override;

 private:
  bool IsRadio() const { return (GetFlags() & FlagRadio) != 0; }
  bool IsCheckBox() const { return !IsRadio() && (GetFlags() & FlagCheckBox) != 0; }
  // The child at `position` as a property, reporting a null handle or a non-property.
  QelRovFacetProperty* ChildAt(int position) const;
  // Puts an aggregate where it belongs: the select-all item, the check-box group itself,
  // or nowhere for a radio group without select-all item. E_FAIL (no counted child) is
  // reported and gives E_UNEXPECTED.
  HRESULT StoreAggregate(QelCheckState aggregate);

  QelListValQelBaseUnknown_var children_;
  QelVar<QelRovFacetPropertyItem> selectAll_;
};
