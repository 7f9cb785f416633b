#include "QelRovRefinementFacet.h"

#include <algorithm>
#include <vector>

#include "QelAssert.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelRovFacet.h"
#include "QelRovFacetProperty.h"
#include "QelRovRefinementProperty.h"
#include "QelSYPEventFactory.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelToolkitCheck.h"
#include "QelVidCtlExpander.h"
#include "QelVidGridConstraints.h"
#include "QelVidLayGrid.h"
#include "QelVidSpacer.h"

namespace {
// Sections built inside a parent, by facet, held weakly: the last one over each facet.
struct BuiltSection {
  QelBaseUnknown_WR facet;
  QelBaseUnknown_WR section;
};
std::vector<BuiltSection>& BuiltSections() {
  static std::vector<BuiltSection> sections;
  return sections;
}
}  // namespace

const QelMetaObject& QelRovRefinementFacet::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovRefinementFacet", QelMetaKind::Implementation, &QelVidCtl::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}
const QelMetaObject* QelRovRefinementFacet::GetMetaObject() const { return &MetaObject(); }

QelRovRefinementFacet::QelRovRefinementFacet() : QelVidCtl(nullptr, QelString()) {}

QelRovRefinementFacet::QelRovRefinementFacet(QelVidWidget* parent, const QelString& name, QelBaseUnknown* facet)
    : QelVidCtl(parent, name), facet_(facet) {
  QelBaseUnknown_var hold;
  QelRovFacet* resolved = ResolveFacet(hold);
  if (!resolved) return;
  resolved->GetFacetName(facetName_);
  SetCustomStyle(QelString("QelRovRefinementFacet.sypstyle"), QelString("Default"), QelString(""));
}

QelRovRefinementFacet::~QelRovRefinementFacet() = default;

QelString QelRovRefinementFacet::GetResourceFilename(int level) const {
  if (level <= 0) return QelString("QelRovRefinementFacet");
  return QelVidCtl::GetResourceFilename(level - 1);
}

QelRovFacet* QelRovRefinementFacet::ResolveFacet(QelBaseUnknown_var& hold) const {
  hold = facet_.Get();
  if (!hold) {
    QelAssertNullHandler();
    return nullptr;
  }
  auto* facet = QelSysDynamicCast<QelRovFacet>(hold.get());
  if (!facet) QelAssertPointer();
  return facet;
}

void QelRovRefinementFacet::OnTemplateApplied() {
  auto* expander = dynamic_cast<QelVidCtlExpander*>(RetrieveSypNamedObject(QelString("ExpanderFacet")));
  if (!expander) {
    QelAssertPointer();
    return;
  }
  expander->SetName(QelString(facetName_.Utf8()));
  QelBaseUnknown_var hold;
  QelRovFacet* facet = ResolveFacet(hold);
  if (!facet) return;
  bool expanded = false;
  facet->GetExpandedFlag(expanded);
  expander->SetExpandedState(expanded);
  grid_ = dynamic_cast<QelVidLayGrid*>(RetrieveSypNamedObject(QelString("GridFacet")));
}

HRESULT QelRovRefinementFacet::BuildPropertyWidgets() {
  QelBaseUnknown_var hold;
  QelRovFacet* facet = ResolveFacet(hold);
  if (!facet) return E_UNEXPECTED;
  if (!grid_) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  QelListValQelBaseUnknown_var properties;
  facet->GetProperties(properties);
  const int n = properties.Size();
  std::string rowName = facetName_.Utf8() + "_Property";
  const size_t baseLength = rowName.size();
  // One forwarder serves every row: it only needs this section, which it holds weakly.
  QelSYPEvent* propEvent = QelRovRefinementProperty::SendPropEvent();
  auto forwarder = QelMakeVar<QelSYPWRefMethEventHandler<QelRovRefinementFacet>>(
      this, &QelRovRefinementFacet::ForwardPropertyEvent);
  forwarder_ = QelVar<QelSYPEventHandler>::Retain(forwarder.get());
  QelVar<QelSYPEventHandler> oldForwarder;
  std::vector<QelVar<QelVidWidget>> retired = TakeRetiredRows(hold.get(), oldForwarder);
  grid_->Reserve(static_cast<size_t>(grid_->GetChildCount()) + static_cast<size_t>(n) + 1);  // the rows and the spacer
  int hidden = 0;
  for (int i = 1; i <= n; ++i) {
    QelBaseUnknown* property = properties[i].get();
    // Hidden rows do not break the alternation of the rows shown.
    const bool alternate = (i - hidden) % 2 == 0;
    rowName.resize(baseLength);
    rowName += std::to_string(i - 1);
    QelVidWidget* previous =
        static_cast<size_t>(i - 1) < retired.size() ? retired[static_cast<size_t>(i - 1)].get() : nullptr;
    QelVar<QelRovRefinementProperty> widget = QelRovRefinementProperty::RenewOrMake(
        this, QelString(rowName), property, alternate, previous, oldForwarder.get());
    if (!widget) continue;
    if (QelTkCheckPointer(propEvent, "i_pEvent")) widget->AddHandler(propEvent, forwarder_.get(), 0);
    if (QelRovRefinementProperty::PlaceRow(grid_, widget.get(), i - 1, property)) ++hidden;
  }
  // The spacer shares the last property's row. Without properties there is no such row:
  // the grid refuses row -1 and stays empty.
  QelVar<QelVidSpacer> spacer = QelMakeVar<QelVidSpacer>(this, QelString("Spacer"));
  grid_->AddWidget(spacer.get(), QelVidGridConstraints{0, n - 1, 1, 1, 1, 1, 1, 1});
  grid_->SetRowWeight(n - 1, 1.0);
  return S_OK;
}

std::vector<QelVar<QelVidWidget>> QelRovRefinementFacet::TakeRetiredRows(QelBaseUnknown* facet,
                                                                         QelVar<QelSYPEventHandler>& forwarder) {
  std::vector<BuiltSection>& sections = BuiltSections();
  std::erase_if(sections, [](const BuiltSection& s) { return !s.facet.IsAlive() || !s.section.IsAlive(); });
  auto mine = std::find_if(sections.begin(), sections.end(), [&](const BuiltSection& s) { return s.facet.RefersTo(facet); });
  std::vector<QelVar<QelVidWidget>> rows;
  if (mine != sections.end()) {
    QelBaseUnknown_var held = mine->section.Get();
    auto* previous = QelSysDynamicCast<QelRovRefinementFacet>(held.get());
    if (previous && previous != this && !previous->GetParent() && previous->grid_) {
      rows = previous->grid_->TakeWidgets();
      forwarder = previous->forwarder_;
    }
  }
  // A section made without a parent is never retired, so nothing is taken from it.
  if (GetParent()) {
    if (mine == sections.end()) mine = sections.insert(sections.end(), {QelBaseUnknown_WR(facet), {}});
    mine->section = QelBaseUnknown_WR(static_cast<QelBaseUnknown*>(this));
  }
  return rows;
}

QelSYPEvent* QelRovRefinementFacet::SendFacetEvent() {
  static QelSYPEvent* event = nullptr;
  if (!event) {
    QelSYPEventFactory* pEventFactory = QelVidWidget::GetEventFactory();
    if (!QelTkCheckPointer(pEventFactory, "pEventFactory")) return nullptr;
    event = pEventFactory->NewEvent("SendFacetEvent", QelSYPEvent::Ancestors, "QelSYPEventArgs", &MetaObject());
  }
  return event;
}

void QelRovRefinementFacet::ForwardPropertyEvent(QelBaseUnknown*, QelSYPEventArgs*) {
  QelVar<QelSYPEventArgs> args = QelMakeVar<QelSYPEventArgs>(SendFacetEvent());
  args->SetOrigin(this);
  if (!Dispatch(args.get())) QelAssertBool();
}

int QelRovRefinementFacet::GetExpandedFlag() const {
  QelBaseUnknown_var hold = facet_.Get();
  auto* facet = QelSysDynamicCast<QelRovFacet>(hold.get());
  bool expanded = false;
  if (facet) facet->GetExpandedFlag(expanded);
  return expanded ? 1 : 0;
}

void QelRovRefinementFacet::OnExpanderExpanded(QelBaseUnknown*, QelSYPEventArgs*) {
  QelBaseUnknown_var hold;
  if (QelRovFacet* facet = ResolveFacet(hold)) facet->SetExpandedFlag(true);
}

void QelRovRefinementFacet::OnExpanderCollapsed(QelBaseUnknown*, QelSYPEventArgs*) {
  QelBaseUnknown_var hold;
  if (QelRovFacet* facet = ResolveFacet(hold)) facet->SetExpandedFlag(false);
}
