#include "QelRovRefinementDlg.h"

#include <string>

#include "QelAssert.h"
#include "QelDictionary.h"
#include "QelIHyxFacetCtrl.h"
#include "QelRovFacet.h"
#include "QelRovFacetGroup.h"
#include "QelRovRefinementFacet.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidGridConstraints.h"
#include "QelVidLayGrid.h"
#include "QelVidSpacer.h"

namespace {
constexpr QelVidGridConstraints CellOf(int row) { return QelVidGridConstraints{0, row, 1, 1, 1, 1, 1, 0}; }
}  // namespace

const QelMetaObject& QelRovRefinementDlg::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovRefinementDlg", QelMetaKind::Implementation, &QelVidCtl::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}
const QelMetaObject* QelRovRefinementDlg::GetMetaObject() const { return &MetaObject(); }

QelRovRefinementDlg::QelRovRefinementDlg() : QelVidCtl(nullptr, QelString()) {}

QelRovRefinementDlg::QelRovRefinementDlg(QelBaseUnknown*, const QelString& name,
                                         const QelListValQelBaseUnknown_var& facets, QelFrmEditor* editor)
    : QelVidCtl(nullptr, name), editor_(editor), facets_(facets) {
  SetCustomStyle(QelString("QelRovRefinementFacet.sypstyle"), QelString("DefaultDlg"), QelString(""));
  if (facets_.Size() < 1) {
    QelAssertBool("facets");
    return;
  }
  auto* first = QelSysDynamicCast<QelRovFacet>(facets_[1].get());
  if (!first) {
    QelAssertPointer("QelRovFacet");
    return;
  }
  QelVar<QelRovFacetGroup> group = first->GetFacetGroup();
  if (!group) QelAssertPointer("QelRovFacetGroup");
  facetGroup_ = QelBaseUnknown_WR(group.get());
}

QelRovRefinementDlg::~QelRovRefinementDlg() = default;

QelString QelRovRefinementDlg::GetResourceFilename(int level) const {
  if (level <= 0) return QelString("QelRovRefinementDlg");
  return QelVidCtl::GetResourceFilename(level - 1);
}

QelRovFacetGroup* QelRovRefinementDlg::GetFacetGroup() const {
  return QelSysDynamicCast<QelRovFacetGroup>(facetGroup_.GetRaw());
}

void QelRovRefinementDlg::OnTemplateApplied() {
  grid_ = dynamic_cast<QelVidLayGrid*>(RetrieveSypNamedObject(QelString("DialogGrid")));
  if (!grid_) return QelAssertPointer("DialogGrid");
  scrollableArea_ = dynamic_cast<QelVidCtlScrollableArea*>(RetrieveSypNamedObject(QelString("MainScrollableArea")));
  if (!scrollableArea_) return QelAssertPointer("MainScrollableArea");
  closeButton_ = dynamic_cast<QelVidCtlButton*>(RetrieveSypNamedObject(QelString("CloseButton")));
  if (!closeButton_) QelAssertPointer("CloseButton");
}

HRESULT QelRovRefinementDlg::BuildFacetWidgets() {
  if (!grid_) {
    QelAssertPointer("DialogGrid");
    return E_UNEXPECTED;
  }
  const int n = facets_.Size();
  if (n < 1) {
    QelAssertBool("facets");
    return E_UNEXPECTED;
  }
  int row = 0;
  for (int i = 1; i <= n; ++i) {
    QelVar<QelRovRefinementFacet> widget =
        QelMakeVar<QelRovRefinementFacet>(this, QelString("Facet" + std::to_string(i - 1)), facets_[i].get());
    if (QelFailed(widget->BuildPropertyWidgets())) {
      QelAssertBool("BuildPropertyWidgets");
      continue;
    }
    QelSYPWRefMethEventHandler<QelRovRefinementDlg>::Connect(widget.get(), QelRovRefinementFacet::SendFacetEvent(),
                                                            this, &QelRovRefinementDlg::OnFacetEvent);
    grid_->AddWidget(widget.get(), CellOf(row++));
    facetWidgets_.Append(static_cast<QelBaseUnknown*>(widget.get()));
    QelVar<QelVidSpacer> spacer = QelMakeVar<QelVidSpacer>(this, QelString("Spacer"));
    grid_->AddWidget(spacer.get(), CellOf(row++));
    spacer->SetMinimumDimension(QelVidPoint{10.0, 10.0});
    spacers_.emplace_back(spacer.get());
  }
  // Without a section there is no row to take the free height.
  if (row > 0) grid_->SetRowWeight(row - 1, 1.0);
  SetRefreshButtonEnableFlag(0);
  return S_OK;
}

void QelRovRefinementDlg::RefreshFacetWidgets() {
  if (!scrollableArea_) return QelAssertPointer("MainScrollableArea");
  const int h = scrollableArea_->GetHScrollOffset();
  const int v = scrollableArea_->GetVScrollOffset();
  if (!grid_) return QelAssertPointer("DialogGrid");
  // Called from inside a section's own dispatch: the dispatch keeps it alive until it returns.
  QelVar<QelRovRefinementDlg> hold = QelVar<QelRovRefinementDlg>::Retain(this);
  // The old sections stay alive, detached, until the new ones have taken over the rows
  // they would make again.
  std::vector<QelVar<QelVidWidget>> previous;
  for (const auto& widget : facetWidgets_) {
    auto* facetWidget = QelSysDynamicCast<QelVidWidget>(widget.get());
    if (!facetWidget) {
      QelAssertNullHandler();
      continue;
    }
    previous.push_back(QelVar<QelVidWidget>::Retain(facetWidget));
    grid_->RemoveWidget(facetWidget);
  }
  for (const auto& spacer : spacers_) grid_->RemoveWidget(spacer.get());
  spacers_.clear();
  facetWidgets_.RemoveAll();
  BuildFacetWidgets();
  scrollableArea_->SetHScrollOffset(h);
  scrollableArea_->SetVScrollOffset(v);
}

void QelRovRefinementDlg::OnFacetEvent(QelBaseUnknown*, QelSYPEventArgs*) { RefreshFacetWidgets(); }

void QelRovRefinementDlg::SetRefreshButtonEnableFlag(int value) {
  refreshButtonEnableFlag_ = value;
  QelVar<QelISYPIntrospectable> introspectable(static_cast<QelBaseUnknown*>(this));
  if (introspectable) introspectable->DispatchModifyProperty("RefreshButtonEnableFlag");
}

void QelRovRefinementDlg::OnRefresh(QelBaseUnknown*, QelSYPEventArgs*) {
  QelBaseUnknown_var group = facetGroup_.Get();
  auto* facetGroup = QelSysDynamicCast<QelRovFacetGroup>(group.get());
  if (!facetGroup) return QelAssertPointer("QelRovFacetGroup");
  facetGroup->RefreshPanel();
}

void QelRovRefinementDlg::OnClose(QelBaseUnknown*, QelSYPEventArgs*) {
  QelVar<QelIHyxFacetCtrl> controller = QelInstantiateComponent<QelIHyxFacetCtrl>("QelRovFacetController");
  if (controller) controller->CloseDataFilteringPanel();
}
