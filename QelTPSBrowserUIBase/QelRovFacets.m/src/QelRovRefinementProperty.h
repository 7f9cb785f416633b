#pragma once
// QelRovRefinementProperty: one row of a facet section, showing one facet property as a
// check box or radio row, a range row (operators and values of the tolerance range) or
// an expander over its sub-properties. The widget holds its property weakly; every state
// it shows lives in the model, so the rows rebuilt after a click show the model again.
// It is held by its parent grid and raises SendPropEvent after every check change.
#include "QelBaseUnknown_WR.h"
#include "QelSYPEventArgs.h"
#include "QelUnicodeString.h"
#include "QelVidColor.h"
#include "QelVidCtl.h"

class QelRovFacetProperty;
class QelVidCtlImageAndLabelCombo;
class QelVidLayGrid;

class QelRovRefinementProperty : public QelVidCtl {
 public:
  enum Kind : int { KindNone = -1, KindSingleElement = 0, KindExpander = 1, KindRange = 2 };

  // Answered by the row's own QueryDirect: its introspection getters, run for every
  // binding of every row, reach the row without a dynamic_cast.
  static constexpr QelIID ClassIID = QelIID::Parse("{9D2E6B71-4A0F-4C83-B5E1-2F7A90C3D648}");
  static QelRovRefinementProperty* From(QelBaseUnknown* object) {
    QelBaseUnknown* impl = object ? object->GetImpl() : nullptr;
    return impl ? static_cast<QelRovRefinementProperty*>(impl->FindOwnInterface(ClassIID)) : nullptr;
  }

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // For the introspection meta class: nothing set, no style.
  QelRovRefinementProperty();
  QelRovRefinementProperty(QelVidWidget* parent, QelString name, QelBaseUnknown* property, bool alternate);

  // Fills the kind's parts: the sub-property rows, or the range combos and values.
  // `previous`, a row of the section this one replaces, lends its sub-property rows: those
  // a new row would make alike are renewed in place.
  HRESULT BuildContent(QelRovRefinementProperty* previous = nullptr);
  // Makes this check box or radio row what a new row named `name` over `property` would
  // be, for a section rebuilt after a change: texts, check state and colours read again,
  // not hovered, and `oldForwarder` (its one SendPropEvent handler) disconnected; a
  // sub-property row has no such handler and is renewed with a null one. False,
  // and the row left as it was, when a new row would differ otherwise (another property
  // or kind, attributes or handlers set on the row since it was made).
  bool Renew(QelString name, QelBaseUnknown* property, bool alternate, QelSYPEventHandler* oldForwarder);
  // The row for `property` at one place of a section or group, as a rebuild makes it:
  // `previous` (the widget that stood there, or null) renewed when a new row would be
  // alike, else a new row under `parent` whose content takes over `previous`'s nested rows.
  // Null, after a report, when the new row's content cannot be built.
  static QelVar<QelRovRefinementProperty> RenewOrMake(QelVidWidget* parent, QelString name, QelBaseUnknown* property,
                                                      bool alternate, QelVidWidget* previous,
                                                      QelSYPEventHandler* oldForwarder);
  // Puts `row` in `grid` at `index`, hidden and taking no room when `property` is hidden;
  // true then, so the caller's alternation skips it.
  static bool PlaceRow(QelVidLayGrid* grid, QelRovRefinementProperty* row, int index, QelBaseUnknown* property);
  // Stores a pending valid range first, asks the property to change its check, then
  // raises SendPropEvent whatever the property answered.
  void SetChecked(int value);
  static QelSYPEvent* SendPropEvent();

  QelString GetResourceFilename(int level) const override;

  // Introspectable properties.
  QelVidColor GetLineColor() const;
  QelVidColor GetBorderColor() const;
  int GetIconVisibility() const;
  // 2 for a group whose items differ: its box shows the mix rather than reading off.
  int GetCheckState() const { return checked_ ? 1 : partial_ ? 2 : 0; }
  int GetExpandedFlag() const;
  int GetCheckBoxVisibility() const;
  int GetRadioVisibility() const;
  int GetRightPartEnableFlag() const { return leftOperatorIndex_ != 0 ? 1 : 0; }
  int GetRangeButtonEnableFlag() const;
  QelUnicodeString GetPropertyName() const { return propertyName_; }
  QelUnicodeString GetIcon() const;
  QelUnicodeString GetLeftValue() const;
  QelUnicodeString GetRightValue() const;

  // Event handlers: (origin, arguments).
  void OnClick(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnExpanderExpanded(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnExpanderCollapsed(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnMouseEnter(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnMouseLeave(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void LeftEditorEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void LeftComboSelectedEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void RightComboSelectedEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void RightEditorEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnRangeUpdate(QelBaseUnknown* origin, QelSYPEventArgs* args);

  // State a test or a renderer may read.
  int GetKind() const { return kind_; }
  bool IsAlternate() const { return alternate_; }
  bool IsHovered() const { return hovered_; }
  bool IsRangeApplied() const { return rangeApplied_; }
  int GetSubPropertyCount() const { return childCount_; }
  double GetLeftNumber() const { return leftValue_; }
  double GetRightNumber() const { return rightValue_; }
  int GetLeftOperatorIndex() const { return leftOperatorIndex_; }
  int GetRightOperatorIndex() const { return rightOperatorIndex_; }
  QelVidLayGrid* GetGrid() const { return grid_; }

 protected:
  void* QueryDirect(const QelIID& iid) override;
  ~QelRovRefinementProperty() override;
  void OnTemplateApplied() override;

 private:
  // The property, held for the caller; null after an assertion when it is gone
  // ("NULL handler") or no property.
  QelRovFacetProperty* ResolveProperty(QelBaseUnknown_var& hold) const;
  // Whether the facts read from the property (`radio_`, `icon_`) stand; when the
  // property is gone, reports it as ResolveProperty does.
  bool PropertyFactsStand() const;
  void ReadPropertyFacts(QelRovFacetProperty* property);
  HRESULT BuildSubPropertyWidgets(QelRovFacetProperty* property, QelRovRefinementProperty* previous);
  HRESULT BuildRange(QelRovFacetProperty* property);
  void ReadEditor(QelSYPEventArgs* args, double& value);

  QelBaseUnknown_WR property_;
  int childCount_ = 0;
  QelUnicodeString propertyName_;
  // Read once per row: every binding of the row's template asks for them.
  QelUnicodeString icon_;
  bool radio_ = false;
  bool partial_ = false;
  bool factsRead_ = false;
  QelVidLayGrid* grid_ = nullptr;
  bool alternate_ = false;
  bool hovered_ = false;
  bool checked_ = false;
  bool rangeApplied_ = true;
  QelVidCtlImageAndLabelCombo* leftCombo_ = nullptr;
  QelVidCtlImageAndLabelCombo* rightCombo_ = nullptr;
  double leftValue_ = 0.0;
  double rightValue_ = 0.0;
  int rightOperatorIndex_ = -1;
  int leftOperatorIndex_ = -1;
  int kind_ = KindNone;
};
