#pragma once
// QelRovFacetGroup: everything the data filtering panel of one editor needs: the editor
// (held weakly: a group may outlive it), the facets and the filter data (owned), the
// docked panel (held; the panel holds the dialog) and the light-load-mode observables it
// subscribed to. It is the observer of its facets, which hold it weakly, and of those
// observables. A group that goes hides its panel and hands it to delayed destruction.
#include "QelBaseUnknown_WR.h"
#include "QelCallbackManager.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMetaObject.h"

class QelFrmEditor;
class QelRovFacet;
class QelRovFacetFilterData;
class QelRovRefinementDlg;
class QelDbrFraPanel;

class QelRovFacetGroup : public virtual QelBaseUnknown {
 public:
  // CreatePanel's answer for a drafting window, where no panel is made.
  static constexpr HRESULT kDraftingWindow = 0x40202;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // A null editor is reported; the group is still made.
  explicit QelRovFacetGroup(QelFrmEditor* editor);

  // The editor without a reference; null once it is gone.
  QelFrmEditor* GetEditor() const;
  // Null until the facets are created.
  QelRovFacetFilterData* GetFilterData() const { return filterData_.get(); }

  // The root product of the group's editor and the group's filter data (may be null), as
  // facets ask for them through their weak reference to the group.
  static HRESULT GetRootAndFilterData(const QelBaseUnknown_WR& group, QelBaseUnknown_var& root,
                                      QelRovFacetFilterData*& filterData);

  // Creates the filter data and the facets once (the annotation type facet only when the
  // sets component allows it), clears the filter switches and refreshes every facet.
  HRESULT InitFacets();
  // Appends the facets in the order the panel shows them, creating them first if needed;
  // `facets` must be empty.
  HRESULT ListFacets(QelListValQelBaseUnknown_var& facets);

  // Builds the facets, the dialog and the docked panel in a 3D window of the editor: S_OK
  // when built now, S_FALSE when nothing was built (already there, or no window of the
  // editor can take it), kDraftingWindow, or E_UNEXPECTED.
  HRESULT CreatePanel();
  // Hides the panel and has it destroyed; the facets and subscriptions stay.
  void ClosePanel();
  void ShowPanel(bool show);
  bool IsPanelInitialized() const { return panel_ && dialog_; }
  // A new dialog over the refreshed facets in the existing panel.
  void RefreshPanel();
  // The editor's selection changed: the dialog offers a refresh.
  void OnCSOChanged();
  QelRovRefinementDlg* GetDialog() const { return dialog_; }
  QelDbrFraPanel* GetPanel() const { return panel_.get(); }

  // Subscribes to the light-load mode of the owners of the light sets under the root,
  // once: nothing happens while subscriptions exist.
  void AddLightLoadModeObservers();
  void RemoveLightLoadModeObservers();
  const QelListValQelBaseUnknown_var& GetObservables() const { return observables_; }

  // Observer operations, forwarded by the group's ties.
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState);
  // A facet reports an applied change: the facets that depend on it are refreshed.
  HRESULT OnPropertyChanged(QelBaseUnknown* facet);
  HRESULT OnLightLoadModeChanged();

 protected:
  ~QelRovFacetGroup() override;

  // Installs the facets and the filter data, each with one reference of the group's own.
  // The annotation type facet may be null.
  void SetFacets(QelRovFacet* annotationSet, QelRovFacet* view, QelRovFacet* annotationType,
                 QelRovFacetFilterData* filterData);

 private:
  // InitFacets, then a dialog over the listed facets, its template applied.
  QelVar<QelRovRefinementDlg> MakeDialog();

  QelBaseUnknown_WR editor_;
  QelVar<QelRovFacet> annotationSetFacet_;
  QelVar<QelRovFacet> viewFacet_;
  QelVar<QelRovFacet> annotationTypeFacet_;
  QelVar<QelRovFacetFilterData> filterData_;
  // Held by the panel, not by the group.
  QelRovRefinementDlg* dialog_ = nullptr;
  // The viewer's dock holds the panel too; the group's own reference keeps the dialog
  // pointer sound while the panel is not docked.
  QelVar<QelDbrFraPanel> panel_;
  // A dialog whose widgets failed to build, kept until ClosePanel forgets it.
  QelVar<QelRovRefinementDlg> orphanDialog_;
  QelListValQelBaseUnknown_var observables_;
  QelCallbackId csoSubscription_ = 0;
};
