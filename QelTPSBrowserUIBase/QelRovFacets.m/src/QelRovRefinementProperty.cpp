#include "QelRovRefinementProperty.h"

#include <unordered_map>

#include "QelAssert.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelRovFacetProperty.h"
#include "QelSYP.h"
#include "QelSYPEventFactory.h"
#include "QelToolkitCheck.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidGridConstraints.h"
#include "QelVidLayGrid.h"
#include "QelVidPalette.h"

namespace {
constexpr const char* kSheet = "QelRovRefinementProperty.sypstyle";
// Combo line index -> QelPropertyOperator.
constexpr QelPropertyOperator kLeftOperators[] = {QelPropertyOperatorEqual, QelPropertyOperatorGreater,
                                                  QelPropertyOperatorGreaterOrEqual};
constexpr QelPropertyOperator kRightOperators[] = {QelPropertyOperatorLess, QelPropertyOperatorLessOrEqual};
constexpr const char* kLeftTexts[] = {"=", "<", "<="};
constexpr const char* kRightTexts[] = {"<", "<="};

int IndexOf(const QelPropertyOperator* table, int size, int op) {
  for (int i = 0; i < size; ++i)
    if (table[i] == op) return i;
  return -1;
}
}  // namespace

const QelMetaObject& QelRovRefinementProperty::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovRefinementProperty", QelMetaKind::Implementation, &QelVidCtl::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}
const QelMetaObject* QelRovRefinementProperty::GetMetaObject() const { return &MetaObject(); }

QelRovRefinementProperty::QelRovRefinementProperty() : QelVidCtl(nullptr, QelString()) {}

QelRovRefinementProperty::QelRovRefinementProperty(QelVidWidget* parent, QelString name, QelBaseUnknown* property,
                                                   bool alternate)
    : QelVidCtl(parent, std::move(name)), property_(property), alternate_(alternate) {
  QelBaseUnknown_var hold;
  QelRovFacetProperty* resolved = ResolveProperty(hold);
  if (!resolved) return;
  ReadPropertyFacts(resolved);
  QelListValQelBaseUnknown_var children;
  resolved->GetChildren(children);
  childCount_ = children.Size();
  // Made once: these names are longer than a short string and every row names them.
  static const QelString sheet(kSheet);
  static const QelString singleElement("SingleElementStyle");
  static const QelString expanderStyle("ExpanderStyle");
  static const QelString rangeStyle("RangeStyle");
  static const QelString noVariant;
  const QelString* style = &singleElement;
  kind_ = KindSingleElement;
  if (childCount_ > 0) {
    kind_ = KindExpander;
    style = &expanderStyle;
  } else if (resolved->GetFlags() & QelRovFacetProperty::FlagValueRange) {
    kind_ = KindRange;
    style = &rangeStyle;
  }
  SetCustomStyle(sheet, *style, noVariant);
}

QelRovRefinementProperty::~QelRovRefinementProperty() = default;

bool QelRovRefinementProperty::Renew(QelString name, QelBaseUnknown* property, bool alternate,
                                     QelSYPEventHandler* oldForwarder) {
  // Alive as well: a property made where a gone one lay has its address, not its identity.
  if (kind_ != KindSingleElement || !property || !property_.IsAlive() || !property_.RefersTo(property) ||
      !GetAttributes().empty() || !GetLayoutWhenUnvisibleFlag() || GetStyleName().IsEmpty())
    return false;
  QelBaseUnknown_var hold;
  QelRovFacetProperty* resolved = ResolveProperty(hold);
  if (!resolved || (resolved->GetFlags() & QelRovFacetProperty::FlagValueRange)) return false;
  QelListValQelBaseUnknown_var children;
  resolved->GetChildren(children);
  if (children.Size() > 0 || CountHandlers(SendPropEvent()) != (oldForwarder ? 1 : 0)) return false;
  if (oldForwarder && !RemoveHandler(SendPropEvent(), oldForwarder)) return false;
  if (GetName() != name) SetName(std::move(name));
  ReadPropertyFacts(resolved);
  childCount_ = 0;
  alternate_ = alternate;
  hovered_ = false;
  rangeApplied_ = true;
  DispatchModifyProperty("");
  return true;
}

void* QelRovRefinementProperty::QueryDirect(const QelIID& iid) {
  return iid == ClassIID ? this : QelVidCtl::QueryDirect(iid);
}

QelString QelRovRefinementProperty::GetResourceFilename(int level) const {
  if (level <= 0) return QelString("QelRovRefinementProperty");
  return QelVidCtl::GetResourceFilename(level - 1);
}

QelRovFacetProperty* QelRovRefinementProperty::ResolveProperty(QelBaseUnknown_var& hold) const {
  hold = property_.Get();
  if (!hold) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelRovFacetProperty* property = QelRovFacetProperty::From(hold.get());
  if (!property) QelAssertPointer();
  return property;
}

void QelRovRefinementProperty::ReadPropertyFacts(QelRovFacetProperty* property) {
  property->GetName(propertyName_);
  property->IsChecked(checked_);
  partial_ = property->GetCheckState() == PartiallyChecked;
  radio_ = (property->GetFlags() & QelRovFacetProperty::FlagRadio) != 0;
  icon_ = QelUnicodeString();
  property->GetIconName(icon_);
  factsRead_ = true;
}

bool QelRovRefinementProperty::PropertyFactsStand() const {
  if (factsRead_ && property_.IsAlive()) return true;
  QelBaseUnknown_var hold;
  return ResolveProperty(hold) != nullptr && factsRead_;
}

void QelRovRefinementProperty::OnTemplateApplied() {
  if (kind_ == KindExpander) {
    auto* expander = dynamic_cast<QelVidCtlExpander*>(RetrieveSypNamedObject(QelString("ExpanderProp")));
    if (!expander) {
      QelAssertPointer();
      return;
    }
    expander->SetName(QelString(propertyName_.Utf8() + "_Expander"));
    QelBaseUnknown_var hold;
    QelRovFacetProperty* property = ResolveProperty(hold);
    if (!property) return;
    bool expanded = false;
    property->GetExpandedFlag(expanded);
    expander->SetExpandedState(expanded);
    grid_ = dynamic_cast<QelVidLayGrid*>(RetrieveSypNamedObject(QelString("GridProp")));
  } else if (kind_ == KindRange) {
    leftCombo_ = dynamic_cast<QelVidCtlImageAndLabelCombo*>(RetrieveSypNamedObject(QelString("LeftCombo")));
    if (!leftCombo_) {
      QelAssertPointer();
      return;
    }
    rightCombo_ = dynamic_cast<QelVidCtlImageAndLabelCombo*>(RetrieveSypNamedObject(QelString("RightCombo")));
    if (!rightCombo_) QelAssertPointer();
  }
}

QelVar<QelRovRefinementProperty> QelRovRefinementProperty::RenewOrMake(QelVidWidget* parent, QelString name,
                                                                       QelBaseUnknown* property, bool alternate,
                                                                       QelVidWidget* previous,
                                                                       QelSYPEventHandler* oldForwarder) {
  QelRovRefinementProperty* old = previous ? From(previous) : nullptr;
  if (old && old->Renew(name, property, alternate, oldForwarder)) return QelVar<QelRovRefinementProperty>::Retain(old);
  auto row = QelMakeVar<QelRovRefinementProperty>(parent, std::move(name), property, alternate);
  if (QelFailed(row->BuildContent(old))) {
    QelAssertBool();
    return nullptr;
  }
  return row;
}

bool QelRovRefinementProperty::PlaceRow(QelVidLayGrid* grid, QelRovRefinementProperty* row, int index,
                                        QelBaseUnknown* property) {
  grid->AddWidget(row, QelVidGridConstraints{0, index, 1, 1, 1, 1, 1, 0});
  auto* facetProperty = QelRovFacetProperty::From(property);
  if (!facetProperty || facetProperty->GetVisibleFlag()) return false;
  row->SetVisibleFlag(0);
  row->SetLayoutWhenUnvisibleFlag(0);
  return true;
}

HRESULT QelRovRefinementProperty::BuildContent(QelRovRefinementProperty* previous) {
  QelBaseUnknown_var hold;
  QelRovFacetProperty* property = ResolveProperty(hold);
  if (!property) return E_UNEXPECTED;
  if (kind_ == KindExpander) return BuildSubPropertyWidgets(property, previous);
  if (kind_ == KindRange) return BuildRange(property);
  return S_OK;
}

HRESULT QelRovRefinementProperty::BuildSubPropertyWidgets(QelRovFacetProperty* property,
                                                          QelRovRefinementProperty* previous) {
  if (!grid_) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  QelListValQelBaseUnknown_var children;
  property->GetChildren(children);
  // The rows of the same property's previous expander, in order: a group of 10k
  // annotations is then renewed after a click instead of made again.
  std::vector<QelVar<QelVidWidget>> retired;
  if (previous && previous != this && previous->kind_ == KindExpander && previous->grid_ &&
      previous->property_.IsAlive() && previous->property_.RefersTo(property))
    retired = previous->grid_->TakeWidgets();
  // Each retired row is offered to the new row of its own property, wherever that row now
  // stands: removing items from the middle of a group then renews every row after them
  // instead of making them again.
  std::unordered_map<QelBaseUnknown*, QelVidWidget*> retiredByProperty;
  retiredByProperty.reserve(retired.size());
  for (const QelVar<QelVidWidget>& row : retired)
    if (QelRovRefinementProperty* old = From(row.get()))
      if (QelBaseUnknown* of = old->property_.GetRaw()) retiredByProperty.emplace(of, row.get());
  grid_->Reserve(static_cast<size_t>(children.Size()));
  const std::string baseName = propertyName_.Utf8() + "_Property";
  int hidden = 0;
  for (int i = 1; i <= children.Size(); ++i) {
    QelBaseUnknown* child = children[i].get();
    const bool alternate = (i - hidden) % 2 == 0;
    QelVidWidget* old = nullptr;
    if (child)
      if (auto found = retiredByProperty.find(child->GetImpl()); found != retiredByProperty.end()) {
        old = found->second;
        retiredByProperty.erase(found);
      }
    QelVar<QelRovRefinementProperty> widget =
        RenewOrMake(this, QelString(baseName + std::to_string(i - 1)), child, alternate, old, nullptr);
    if (widget && PlaceRow(grid_, widget.get(), i - 1, child)) ++hidden;
  }
  return S_OK;
}

HRESULT QelRovRefinementProperty::BuildRange(QelRovFacetProperty* property) {
  if (!leftCombo_ || !rightCombo_) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  leftCombo_->ClearLines();
  for (const char* text : kLeftTexts) leftCombo_->SetLine(QelUnicodeString(text), nullptr, -1, 0);
  rightCombo_->ClearLines();
  for (const char* text : kRightTexts) rightCombo_->SetLine(QelUnicodeString(text), nullptr, -1, 0);

  // Operators outside both tables, so a range that cannot be read is refused below.
  auto leftOp = static_cast<QelPropertyOperator>(-1);
  auto rightOp = static_cast<QelPropertyOperator>(-1);
  double* left = nullptr;
  double* right = nullptr;
  property->GetToleranceValues(leftOp, left, rightOp, right);
  if (left) leftValue_ = *left;
  if (right) rightValue_ = *right;
  QelSYPNotifyPropertyChange(this, "LeftValue");
  QelSYPNotifyPropertyChange(this, "RightValue");

  const int leftIndex = IndexOf(kLeftOperators, 3, leftOp);
  const int rightIndex = IndexOf(kRightOperators, 2, rightOp);
  if (leftIndex < 0 || rightIndex < 0) {
    QelAssertBool();
    return E_UNEXPECTED;
  }
  leftOperatorIndex_ = leftIndex;
  rightOperatorIndex_ = rightIndex;
  leftCombo_->SetSelectedIndex(leftIndex);
  rightCombo_->SetSelectedIndex(rightIndex);
  rangeApplied_ = true;
  QelSYP::LoadResources(this);
  return S_OK;
}

void QelRovRefinementProperty::SetChecked(int value) {
  if (kind_ == KindRange && !rangeApplied_ && leftValue_ > 0.0 &&
      (leftOperatorIndex_ == 0 || (rightValue_ > 0.0 && rightValue_ >= leftValue_)))
    OnRangeUpdate(nullptr, nullptr);
  QelBaseUnknown_var hold;
  QelRovFacetProperty* property = ResolveProperty(hold);
  if (!property) return;
  property->SetCheck(value == 1);
  QelVar<QelSYPEventArgs> args = QelMakeVar<QelSYPEventArgs>(SendPropEvent());
  args->SetOrigin(this);
  if (!Dispatch(args.get())) QelAssertBool();
}

QelSYPEvent* QelRovRefinementProperty::SendPropEvent() {
  static QelSYPEvent* event = nullptr;
  if (!event) {
    QelSYPEventFactory* pEventFactory = QelVidWidget::GetEventFactory();
    if (!QelTkCheckPointer(pEventFactory, "pEventFactory")) return nullptr;
    event = pEventFactory->NewEvent("SendPropEvent", QelSYPEvent::Ancestors, "QelSYPEventArgs", &MetaObject());
  }
  return event;
}

// The palette's roles are fixed, so the blends every row shows are made once.
QelVidColor QelRovRefinementProperty::GetLineColor() const {
  if (hovered_) return QelVidColor(106, 158, 190, 100);
  static const QelVidColor plain(0.0, 150, QelVidPalette::ColorRole(1), QelVidPalette::ColorRole(2));
  static const QelVidColor shaded(0.1, 150, QelVidPalette::ColorRole(1), QelVidPalette::ColorRole(2));
  return alternate_ ? shaded : plain;
}

QelVidColor QelRovRefinementProperty::GetBorderColor() const {
  if (hovered_) return QelVidColor(33, 110, 159, 120);
  static const QelVidColor border(0.0, 0, QelVidPalette::ColorRole(1), QelVidPalette::ColorRole(2));
  return border;
}

int QelRovRefinementProperty::GetIconVisibility() const { return PropertyFactsStand() && !icon_.IsEmpty() ? 1 : 0; }

int QelRovRefinementProperty::GetExpandedFlag() const {
  QelBaseUnknown_var hold;
  QelRovFacetProperty* property = ResolveProperty(hold);
  bool expanded = false;
  if (property) property->GetExpandedFlag(expanded);
  return expanded ? 1 : 0;
}

int QelRovRefinementProperty::GetCheckBoxVisibility() const { return PropertyFactsStand() && !radio_ ? 1 : 0; }

int QelRovRefinementProperty::GetRadioVisibility() const { return PropertyFactsStand() && radio_ ? 1 : 0; }

int QelRovRefinementProperty::GetRangeButtonEnableFlag() const {
  return checked_ && !rangeApplied_ && (leftOperatorIndex_ == 0 || rightValue_ >= leftValue_) ? 1 : 0;
}

QelUnicodeString QelRovRefinementProperty::GetIcon() const {
  return PropertyFactsStand() ? icon_ : QelUnicodeString();
}

QelUnicodeString QelRovRefinementProperty::GetLeftValue() const {
  QelUnicodeString text;
  text.BuildFromNum(leftValue_, "%g");
  return text;
}

QelUnicodeString QelRovRefinementProperty::GetRightValue() const {
  QelUnicodeString text;
  text.BuildFromNum(rightValue_, "%g");
  return text;
}

void QelRovRefinementProperty::OnClick(QelBaseUnknown*, QelSYPEventArgs*) {
  // A click on a mixed group ticks it, which ticks every item under it.
  checked_ = !checked_;
  partial_ = false;
  SetChecked(checked_ ? 1 : 0);
}

void QelRovRefinementProperty::OnExpanderExpanded(QelBaseUnknown*, QelSYPEventArgs*) {
  QelBaseUnknown_var hold;
  if (QelRovFacetProperty* property = ResolveProperty(hold)) property->SetExpandedFlag(true);
}

void QelRovRefinementProperty::OnExpanderCollapsed(QelBaseUnknown*, QelSYPEventArgs*) {
  QelBaseUnknown_var hold;
  if (QelRovFacetProperty* property = ResolveProperty(hold)) property->SetExpandedFlag(false);
}

void QelRovRefinementProperty::OnMouseEnter(QelBaseUnknown*, QelSYPEventArgs*) {
  hovered_ = true;
  QelSYPNotifyPropertyChange(this, "LineColor");
  QelSYPNotifyPropertyChange(this, "BorderColor");
}

void QelRovRefinementProperty::OnMouseLeave(QelBaseUnknown*, QelSYPEventArgs*) {
  hovered_ = false;
  QelSYPNotifyPropertyChange(this, "LineColor");
  QelSYPNotifyPropertyChange(this, "BorderColor");
}

void QelRovRefinementProperty::ReadEditor(QelSYPEventArgs* args, double& value) {
  if (!args) {
    QelAssertPointer();
    return;
  }
  auto* editor = QelSysDynamicCast<QelVidCtlLineEditor>(args->GetOrigin());
  if (!editor) {
    QelAssertPointer();
    return;
  }
  // A text that is not a number leaves the value as it was.
  editor->GetText().ConvertToNum(&value, "%le");
  rangeApplied_ = false;
  QelSYPNotifyPropertyChange(this, "RangeButtonEnableFlag");
}

void QelRovRefinementProperty::LeftEditorEvent(QelBaseUnknown*, QelSYPEventArgs* args) { ReadEditor(args, leftValue_); }

void QelRovRefinementProperty::RightEditorEvent(QelBaseUnknown*, QelSYPEventArgs* args) {
  ReadEditor(args, rightValue_);
}

void QelRovRefinementProperty::LeftComboSelectedEvent(QelBaseUnknown*, QelSYPEventArgs*) {
  if (!leftCombo_) {
    QelAssertPointer();
    return;
  }
  leftOperatorIndex_ = leftCombo_->GetSelectedIndex();
  rangeApplied_ = false;
  QelSYPNotifyPropertyChange(this, "RightPartEnableFlag");
  QelSYPNotifyPropertyChange(this, "RangeButtonEnableFlag");
}

void QelRovRefinementProperty::RightComboSelectedEvent(QelBaseUnknown*, QelSYPEventArgs*) {
  if (!rightCombo_) {
    QelAssertPointer();
    return;
  }
  rightOperatorIndex_ = rightCombo_->GetSelectedIndex();
  rangeApplied_ = false;
  QelSYPNotifyPropertyChange(this, "RangeButtonEnableFlag");
}

void QelRovRefinementProperty::OnRangeUpdate(QelBaseUnknown*, QelSYPEventArgs*) {
  // An index outside the combo tables (no range was ever read) would name no operator.
  if (leftOperatorIndex_ < 0 || leftOperatorIndex_ > 2 || rightOperatorIndex_ < 0 || rightOperatorIndex_ > 1) {
    QelAssertBool();
    return;
  }
  const QelPropertyOperator leftOp = kLeftOperators[leftOperatorIndex_];
  const QelPropertyOperator rightOp = kRightOperators[rightOperatorIndex_];
  const double left = leftValue_;
  const double upper = leftOperatorIndex_ == 0 ? leftValue_ : rightValue_;
  QelBaseUnknown_var hold;
  QelRovFacetProperty* property = ResolveProperty(hold);
  if (!property) return;
  property->SetToleranceValues(leftOp, &left, rightOp, &upper);
  rangeApplied_ = true;
  QelSYPNotifyPropertyChange(this, "RangeButtonEnableFlag");
}
