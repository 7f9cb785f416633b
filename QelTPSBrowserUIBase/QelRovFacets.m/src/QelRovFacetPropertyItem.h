#pragma once
// QelRovFacetPropertyItem: a leaf property that stands for one host object (a set, an
// annotation, a view...). The object is held weakly: when the host deletes it, the item
// stays in its group, keeps its state and refuses to apply. A plain item (no object) is
// the select-all row of a property group.
#include "QelRovFacetProperty.h"

class QelRovFacetFilterData;

class QelRovFacetPropertyItem : public QelRovFacetProperty {
 public:
  // The "normal\" prefix of every item icon, built once at load.
  static const QelUnicodeString IconPrefix;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelRovFacetPropertyItem(const QelUnicodeString& name, QelBaseUnknown* owner);

  HRESULT ApplyCheckState() override;
  // Reads IsDisplayEnabled of the object; without an object the state stays as it is.
  HRESULT RefreshCheckState() override;
  int32_t CountItems() override;
  HRESULT GetChildren(QelListValQelBaseUnknown_var& children) override;
  HRESULT UpdateName() override;

  // A counted handle on the object, null when there is none or it is gone.
  QelBaseUnknown_var GetObject() const { return object_.Get(); }

 protected:
  ~QelRovFacetPropertyItem() override;

  void SetObject(QelBaseUnknown* object) { object_ = QelBaseUnknown_WR(object); }
  // Whether the item stands for `object`, which is alive.
  bool StandsFor(QelBaseUnknown* object) const { return object_.RefersTo(object) && object_.IsAlive(); }
  // Stores what IsDisplayEnabled answers for `object` as the check state (S_OK is
  // Checked, S_FALSE Unchecked); a failure (an object of no model) leaves the state as it
  // was. Gives the answer.
  HRESULT ReadStateFromDisplay(QelBaseUnknown* object);
  // Takes the icon from `source` through QelIIcon, prefixed; false (icon left empty)
  // when the source does not answer it.
  bool SetIconFrom(QelBaseUnknown* source);
  // The enable value of the current state: 1 for Checked, 0 for Unchecked; any other
  // state (a group's partial state is never pushed down to items) is reported, false.
  bool EnableOfCheckState(int& enable) const;
  // The display request of an item standing for one object, with `filterData` passed on.
  // A gone object, a missing filter data when `filterRequired`, or a state that cannot be
  // applied is reported and answers E_UNEXPECTED.
  HRESULT ApplyToObject(QelRovFacetFilterData* filterData, bool filterRequired);
  // Appends the alias of `source` to `label`, after `separator` when the label already has
  // text; false when the source has no alias.
  static bool AppendAlias(QelUnicodeString& label, QelBaseUnknown* source, const char* separator);

 private:
  QelBaseUnknown_WR object_;
};
