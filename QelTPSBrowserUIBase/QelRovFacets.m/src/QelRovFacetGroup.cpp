#include "QelRovFacetGroup.h"

#include "QelAssert.h"
#include "QelDbrFraPanel.h"
#include "QelDelayedDestruction.h"
#include "QelFrmEditor.h"
#include "QelFrmLayout.h"
#include "QelMsgCatalog.h"
#include "QelRovRefinementDlg.h"
#include "QelSYP.h"
#include "QelVidCtlButton.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelITPSLightSet.h"
#include "QelAnnotationComponents.h"
#include "QelRovFacet.h"
#include "QelRovFacetAnnotation.h"
#include "QelRovFacetAnnotationSet.h"
#include "QelRovFacetView.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetServices.h"

namespace {
constexpr const char* kCSOChanged = "QelCSOChangeNotification";
constexpr int kSetComponent = 62;
}  // namespace

const QelMetaObject& QelRovFacetGroup::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovFacetGroup", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetGroup::GetMetaObject() const { return &MetaObject(); }

QelRovFacetGroup::QelRovFacetGroup(QelFrmEditor* editor) : editor_(editor) {
  if (!editor) QelAssertPointer("QelFrmEditor");
}

QelRovFacetGroup::~QelRovFacetGroup() {
  if (panel_) {
    panel_->SetVisibleFlag(0);
    panel_->RequestDelayedDestruction();
  }
  panel_ = nullptr;
  dialog_ = nullptr;
  filterData_ = nullptr;
  annotationSetFacet_ = nullptr;
  viewFacet_ = nullptr;
  annotationTypeFacet_ = nullptr;
  QelFrmEditor* editor = GetEditor();
  QelBaseUnknown* selection = editor ? editor->GetCSO() : nullptr;
  if (!selection) {
    QelAssertPointer(editor ? "CSO" : "QelFrmEditor");
  } else {
    QelCallbackManager::Get().RemoveCallbacksOn(selection, this, kCSOChanged);
    csoSubscription_ = 0;
  }
  editor_.Reset();
  // No RemoveObserver here: observables hold their observers weakly and skip dead ones.
  observables_.RemoveAll();
}

QelFrmEditor* QelRovFacetGroup::GetEditor() const { return QelSysDynamicCast<QelFrmEditor>(editor_.GetRaw()); }

void QelRovFacetGroup::SetFacets(QelRovFacet* annotationSet, QelRovFacet* view, QelRovFacet* annotationType,
                                 QelRovFacetFilterData* filterData) {
  annotationSetFacet_ = QelVar<QelRovFacet>::Retain(annotationSet);
  viewFacet_ = QelVar<QelRovFacet>::Retain(view);
  annotationTypeFacet_ = QelVar<QelRovFacet>::Retain(annotationType);
  filterData_ = QelVar<QelRovFacetFilterData>::Retain(filterData);
}

namespace {
// The annotation type facet is left out only in light review mode with the type filter
// neither allowed nor forced; without the sets component it is always made.
bool AllowsAnnotationTypeFacet() {
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kSetComponent, made);
  QelVar<QelILumSetComponent> component(made.get());
  if (!component) return true;
  bool lightReview = false;
  component->IsLightReviewMode(lightReview);
  if (!lightReview) return true;
  bool allowed = false;
  component->IsTypeFilterAllowed(allowed);
  if (allowed) return true;
  bool forced = false;
  component->IsTypeFilterForced(forced);
  return forced;
}
}  // namespace

HRESULT QelRovFacetGroup::InitFacets() {
  if (!filterData_) {
    filterData_ = QelMakeVar<QelRovFacetFilterData>();
    QelBaseUnknown* self = this;
    annotationSetFacet_ = QelMakeVar<QelRovFacetAnnotationSet>(self);
    viewFacet_ = QelMakeVar<QelRovFacetView>(self);
    if (AllowsAnnotationTypeFacet()) annotationTypeFacet_ = QelMakeVar<QelRovFacetAnnotation>(self);
  }
  if (!filterData_ || !annotationSetFacet_ || !viewFacet_) {
    QelAssertBool("facets");
    return E_UNEXPECTED;
  }
  filterData_->DefaultAnnot = false;
  filterData_->TolAnnot = false;
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  annotationSetFacet_->Refresh();
  viewFacet_->Refresh();
  if (annotationTypeFacet_) annotationTypeFacet_->Refresh();
  return S_OK;
}

HRESULT QelRovFacetGroup::ListFacets(QelListValQelBaseUnknown_var& facets) {
  if (facets.Size() != 0) {
    QelAssertBool("empty list");
    return E_UNEXPECTED;
  }
  if (!filterData_) InitFacets();
  if (!annotationSetFacet_ || !viewFacet_) {
    QelAssertBool("facets");
    return E_UNEXPECTED;
  }
  facets.Append(static_cast<QelBaseUnknown*>(annotationSetFacet_.get()));
  facets.Append(static_cast<QelBaseUnknown*>(viewFacet_.get()));
  if (annotationTypeFacet_) facets.Append(static_cast<QelBaseUnknown*>(annotationTypeFacet_.get()));
  return S_OK;
}

HRESULT QelRovFacetGroup::GetRootAndFilterData(const QelBaseUnknown_WR& group, QelBaseUnknown_var& root,
                                               QelRovFacetFilterData*& filterData) {
  root = nullptr;
  QelBaseUnknown_var object = group.Get();
  if (!object) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelRovFacetGroup* facetGroup = QelSysDynamicCast<QelRovFacetGroup>(object.get());
  if (!facetGroup) {
    QelAssertPointer("QelRovFacetGroup");
    return E_UNEXPECTED;
  }
  filterData = facetGroup->GetFilterData();
  return QelRovFacetServices::GetRootPLMObject(facetGroup->GetEditor(), root);
}

void QelRovFacetGroup::AddLightLoadModeObservers() {
  if (observables_.Size() != 0) return;
  QelBaseUnknown_var root;
  QelRovFacetServices::GetRootPLMObject(GetEditor(), root);
  if (!root) return;
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kSetComponent, made);
  QelVar<QelILumSetComponent> component(made.get());
  if (!component) {
    QelAssertPointer("QelILumSetComponent");
    return;
  }
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root.get(), sets, false);
  QelVar<QelILumLightLoadModeObserver> self(static_cast<QelBaseUnknown*>(this));
  for (int i = 1; i <= sets.Size(); ++i) {
    QelVar<QelILumSet> set(sets[i].get());
    if (!set) continue;
    QelVar<QelITPSLightSet> lightSet(set.get());
    if (!lightSet) continue;
    QelBaseUnknown_var owner;
    component->GetSetOwner(sets[i].get(), owner);
    QelVar<QelILumLightLoadModeObservable> observable(owner.get());
    // A null handle takes its place too, so the list mirrors the light sets.
    observables_.Append(static_cast<QelBaseUnknown*>(observable.get()));
    owner = nullptr;
    if (!observable) {
      QelAssertNullHandler();
      continue;
    }
    observable->AddObserver(self.get());
  }
}

void QelRovFacetGroup::RemoveLightLoadModeObservers() {
  QelVar<QelILumLightLoadModeObserver> self(static_cast<QelBaseUnknown*>(this));
  for (int i = 1; i <= observables_.Size(); ++i) {
    QelVar<QelILumLightLoadModeObservable> observable(observables_[i].get());
    if (!observable) {
      QelAssertNullHandler();
      continue;
    }
    observable->RemoveObserver(self.get());
  }
  observables_.RemoveAll();
}

HRESULT QelRovFacetGroup::CanChangeCheckState(QelBaseUnknown*, QelCheckState) { return S_OK; }

HRESULT QelRovFacetGroup::OnPropertyChanged(QelBaseUnknown* facet) {
  if (!facet || !annotationSetFacet_ || !viewFacet_ || !filterData_) {
    QelAssertPointer("facet");
    return E_UNEXPECTED;
  }
  // A refresh may reach back into the group; keep it whole until the end.
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  if (annotationSetFacet_->IsEqual(facet)) {
    viewFacet_->Refresh();
    if (annotationTypeFacet_) annotationTypeFacet_->Refresh();
  } else if (viewFacet_->IsEqual(facet)) {
    filterData_->DefaultAnnot = false;
    filterData_->TolAnnot = false;
    if (annotationTypeFacet_) annotationTypeFacet_->Refresh();
  } else if (annotationTypeFacet_ && annotationTypeFacet_->IsEqual(facet)) {
    viewFacet_->Refresh();
  } else {
    QelAssertBool("facet of the group");
    return E_UNEXPECTED;
  }
  return S_OK;
}

HRESULT QelRovFacetGroup::OnLightLoadModeChanged() {
  RemoveLightLoadModeObservers();
  AddLightLoadModeObservers();
  if (!annotationSetFacet_ || !viewFacet_) {
    QelAssertPointer("facet");
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  annotationSetFacet_->Rebuild();
  viewFacet_->Rebuild();
  if (annotationTypeFacet_) annotationTypeFacet_->Rebuild();
  if (dialog_) dialog_->RefreshFacetWidgets();
  return S_OK;
}

namespace {
constexpr int kAllowedDockAreas = 0x18;
constexpr int kDockArea = 0x10;

// The window the panel goes into: the current one, or, from a 2D layout window, the first
// other window of the editor that is not one. Null when there is none.
QelFrmWindow* TargetWindow(QelFrmLayout* layout, QelFrmWindow* current, QelFrmEditor* editor) {
  if (!current->IsAKindOf("Qel2DLWindow")) return current;
  QelListValQelBaseUnknown_var windows = layout->GetWindowList(nullptr, nullptr);
  for (int i = 1; i <= windows.Size(); ++i) {
    auto* window = QelSysDynamicCast<QelFrmWindow>(windows[i].get());
    if (!window) {
      QelAssertPointer("QelFrmWindow");
      continue;
    }
    if (window->GetEditor() && window->GetEditor()->IsEqual(editor) && !window->IsAKindOf("Qel2DLWindow"))
      return window;
  }
  return nullptr;
}
}  // namespace

QelVar<QelRovRefinementDlg> QelRovFacetGroup::MakeDialog() {
  InitFacets();
  QelListValQelBaseUnknown_var facets;
  ListFacets(facets);
  return QelMakeVar<QelRovRefinementDlg>(nullptr, QelString("QelRovRefinementDlg"), facets, GetEditor());
}

HRESULT QelRovFacetGroup::CreatePanel() {
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  if (!layout) {
    QelAssertPointer("QelFrmLayout");
    return E_UNEXPECTED;
  }
  QelFrmWindow* current = layout->GetCurrentWindow();
  if (!current) {
    QelAssertPointer("QelFrmWindow");
    return E_UNEXPECTED;
  }
  QelFrmEditor* editor = GetEditor();
  if (current->IsAKindOf("Qel2DLWindow") && !editor) {
    QelAssertPointer("QelFrmEditor");
    return E_UNEXPECTED;
  }
  if (!current->IsAKindOf("Qel2DLWindow") && current->IsAKindOf("QelDftWindow")) return kDraftingWindow;
  QelFrmWindow* target = TargetWindow(layout, current, editor);
  if (dialog_ || panel_ || !target) return S_FALSE;
  QelVar<QelFrmWindow> holdTarget = QelVar<QelFrmWindow>::Retain(target);

  QelVar<QelRovRefinementDlg> dialog = MakeDialog();
  dialog_ = dialog.get();
  if (dialog->BuildFacetWidgets() < 0) {
    QelAssertBool("BuildFacetWidgets");
    // Nothing holds a dialog without a panel; keep it so the state stays as reported.
    orphanDialog_ = dialog;
    return E_UNEXPECTED;
  }
  panel_ = QelMakeVar<QelDbrFraPanel>(nullptr, QelString("QelRovRefinementFraPanel"), dialog.get(), kAllowedDockAreas,
                                      kDockArea, true);
  panel_->SetTitle(QelMsgCatalog::BuildMessage("QelRovRefinementCmd", "Title"));
  panel_->SetCloseButtonFlag(0);
  panel_->SetMinimizeButtonFlag(1);
  panel_->SetVisibleFlag(1);
  panel_->SetIconName(QelString("I_Hyq_DataFilteringCmd"));
  panel_->SetDefaultButton(dialog->GetCloseButton());

  QelBaseUnknown_var viewer = target->GetViewer();
  if (!viewer) {
    QelAssertPointer("viewer");
    return E_UNEXPECTED;
  }
  panel_->InsertInViewer(viewer.get());
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return E_UNEXPECTED;
  }
  QelCSO* selection = editor->GetCSO();
  if (!selection) {
    QelAssertPointer("CSO");
    return E_UNEXPECTED;
  }
  if (!csoSubscription_) {
    QelBaseUnknown_WR self(static_cast<QelBaseUnknown*>(this));
    csoSubscription_ = QelCallbackManager::Get().AddCallback(
        selection, kCSOChanged, this, [self](QelBaseUnknown*, QelBaseUnknown*) {
          QelBaseUnknown_var held = self.Get();
          if (auto* group = QelSysDynamicCast<QelRovFacetGroup>(held.get())) group->OnCSOChanged();
        });
  }
  AddLightLoadModeObservers();
  return S_OK;
}

void QelRovFacetGroup::ClosePanel() {
  if (panel_) {
    panel_->SetVisibleFlag(0);
    panel_->RequestDelayedDestruction();
  }
  panel_ = nullptr;
  dialog_ = nullptr;
  orphanDialog_ = nullptr;
}

void QelRovFacetGroup::ShowPanel(bool show) {
  if (panel_) panel_->SetVisibleFlag(show ? 1 : 0);
}

void QelRovFacetGroup::RefreshPanel() {
  if (!panel_) return;
  QelBaseUnknown_var self = QelBaseUnknown_var::Retain(this);
  QelVar<QelRovRefinementDlg> dialog = MakeDialog();
  if (dialog->BuildFacetWidgets() < 0) return QelAssertBool("BuildFacetWidgets");
  // The old dialog may be the one whose button asked for this: it is held until the
  // host is idle.
  QelVar<QelRovRefinementDlg> old = QelVar<QelRovRefinementDlg>::Retain(dialog_);
  panel_->SetApplicativeWidget(dialog.get());
  panel_->SetDefaultButton(dialog->GetCloseButton());
  if (!old) {
    QelAssertPointer("QelRovRefinementDlg");
    return;
  }
  QelDelayedDestruction::Request(old.get());
  dialog_ = dialog.get();
  QelSYP::LoadResources(static_cast<QelBaseUnknown*>(dialog.get()));
}

void QelRovFacetGroup::OnCSOChanged() {
  if (dialog_) dialog_->SetRefreshButtonEnableFlag(1);
}
