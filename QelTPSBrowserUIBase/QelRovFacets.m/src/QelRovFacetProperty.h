#pragma once
// QelRovFacetProperty: one row of a facet, either a leaf item standing for something the
// user shows or hides, or a group of further properties. A property is held by its
// facet's list or by its group's children and holds its owner (facet or group) weakly;
// every change is told to that owner through QelIRovFacetPropertyObserver.
#include <cstdint>
#include <utility>

#include "QelBaseUnknown_WR.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMetaObject.h"
#include "QelPropertyOperator.h"
#include "QelUnicodeString.h"

class QelRovFacetFilterData;

class QelRovFacetProperty : public virtual QelBaseUnknown {
 public:
  // Presentation flags. 0x04 and 0x800 are set by the facets but tested nowhere.
  static constexpr int32_t FlagCheckBox = 0x10;
  static constexpr int32_t FlagRadio = 0x20;
  static constexpr int32_t FlagValueRange = 0x200;
  static constexpr int32_t FlagsCheckBox = 0x14;
  static constexpr int32_t FlagsRadio = 0x24;
  static constexpr int32_t FlagsCheckBoxRange = 0xA14;
  // The range operations need one of the range mode's two low bits.
  static constexpr int32_t RangeModeMask = 3;

  // Answered by every property's own QueryDirect, so that groups walking their children
  // reach the property behind a handle without a dynamic_cast through the virtual base.
  // A subclass overriding QueryDirect must defer to this class's.
  static constexpr QelIID ClassIID = QelIID::Parse("{3B7D52C4-0E8A-4F61-A2D9-71C5E48B0F36}");
  // The property behind `object` (a tie resolves to its implementation), borrowed; null
  // for null or for an object that is no property.
  static QelRovFacetProperty* From(QelBaseUnknown* object) {
    QelBaseUnknown* impl = object ? object->GetImpl() : nullptr;
    return impl ? static_cast<QelRovFacetProperty*>(impl->FindOwnInterface(ClassIID)) : nullptr;
  }

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // Makes the display follow the current state.
  virtual HRESULT ApplyCheckState() = 0;
  // Reads the state back from the display. S_OK: the property counts in its group's
  // state; S_FALSE: it is left out.
  virtual HRESULT RefreshCheckState() = 0;
  // Leaf items the property stands for; 0 hides it from its group's children.
  virtual int32_t CountItems() = 0;
  // Appends the sub-properties to show; E_NOTIMPL when there are none.
  virtual HRESULT GetChildren(QelListValQelBaseUnknown_var& children);
  // Recomputes the name just before it is read.
  virtual HRESULT UpdateName();

  HRESULT GetName(QelUnicodeString& name);
  // E_NOTIMPL and an empty text when the property has no icon.
  HRESULT GetIconName(QelUnicodeString& iconName) const;
  // PartiallyChecked reads as not checked.
  HRESULT IsChecked(bool& checked) const;
  // Storing a state applies nothing and tells nobody.
  QelCheckState GetCheckState() const { return checkState_; }
  void SetCheckState(QelCheckState state) { checkState_ = state; }
  int32_t GetFlags() const { return flags_; }
  void SetFlags(int32_t flags) { flags_ = flags; }
  int32_t GetRangeMode() const { return rangeMode_; }
  void SetRangeMode(int32_t mode) { rangeMode_ = mode; }
  HRESULT GetExpandedFlag(bool& expanded) const;
  HRESULT SetExpandedFlag(bool expanded);
  bool GetVisibleFlag() const { return visible_; }
  void SetVisibleFlag(bool visible) { visible_ = visible; }

  // The user's click: radio rule, same-state rule, the owner's veto, store, apply, tell
  // the owner. S_FALSE when nothing changed, E_FAIL when vetoed.
  HRESULT SetCheck(bool checked);

  // The tolerance range of the facet group's filter data, for a top-level property with
  // flag 0x200. Values are handed through exactly as the filter data takes and gives them.
  HRESULT GetToleranceValues(QelPropertyOperator& leftOp, double*& leftValue, QelPropertyOperator& rightOp,
                             double*& rightValue);
  HRESULT SetToleranceValues(QelPropertyOperator leftOp, const double* leftValue, QelPropertyOperator rightOp,
                             const double* rightValue);

  // A counted handle on the owner, null once it is gone.
  QelBaseUnknown_var GetOwner() const { return owner_.Get(); }

 protected:
  QelRovFacetProperty(const QelUnicodeString& name, const QelUnicodeString& iconName, QelBaseUnknown* owner);
  ~QelRovFacetProperty() override;
  void* QueryDirect(const QelIID& iid) override;

  void SetName(QelUnicodeString name) { name_ = std::move(name); }
  void SetIconName(QelUnicodeString iconName) { iconName_ = std::move(iconName); }
  // The stored texts, without the copy or the name update of the getters.
  const QelUnicodeString& StoredName() const { return name_; }
  const QelUnicodeString& StoredIconName() const { return iconName_; }
  // Back to the presentation a new property has: expanded and visible flags, range mode.
  void ResetPresentation(int32_t flags) {
    flags_ = flags;
    rangeMode_ = 5;
    expanded_ = false;
    visible_ = true;
  }

  // Resolves the owner's observer interface, reporting a null handler when it has none.
  QelVar<QelIRovFacetPropertyObserver> ResolveOwnerObserver() const;

 private:
  // The filter data of the facet group above the owning facet, for the range operations;
  // E_UNEXPECTED (after an assertion) when the chain is broken anywhere.
  HRESULT ResolveFilterData(QelVar<QelRovFacetFilterData>& filterData) const;

  QelBaseUnknown_WR owner_;
  QelUnicodeString name_;
  QelUnicodeString iconName_;
  QelCheckState checkState_ = Unchecked;
  int32_t flags_ = FlagsCheckBox;
  int32_t rangeMode_ = 5;
  bool expanded_ = false;
  bool visible_ = true;
};
