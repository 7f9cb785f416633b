#pragma once
// QelRovRefinementDlg: the content of one editor's data filtering panel. Its style gives
// a grid in a scrollable area and the refresh and close buttons; the grid holds one facet
// section per facet of the group, each followed by a spacer, rebuilt after every change a
// section reports. The panel holds the dialog; the dialog holds its facets and reaches
// its facet group weakly.
#include "QelBaseUnknown_WR.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelSYPEventArgs.h"
#include "QelVidCtl.h"

class QelFrmEditor;
class QelRovFacetGroup;
class QelVidCtlButton;
class QelVidCtlScrollableArea;
class QelVidLayGrid;

class QelRovRefinementDlg : public QelVidCtl {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // For the introspection meta class: nothing set, no style.
  QelRovRefinementDlg();
  QelRovRefinementDlg(QelBaseUnknown* parentCommand, const QelString& name, const QelListValQelBaseUnknown_var& facets,
                      QelFrmEditor* editor);

  // One section and one spacer per facet; E_UNEXPECTED without grid or facets. A section
  // that fails to build is left out and the others move up.
  HRESULT BuildFacetWidgets();
  // Builds the sections again over the facets as they are now, keeping both scroll offsets.
  void RefreshFacetWidgets();
  // The handler of the sections' SendFacetEvent.
  void OnFacetEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);

  QelVidCtlButton* GetCloseButton() const { return closeButton_; }
  int GetRefreshButtonEnableFlag() const { return refreshButtonEnableFlag_; }
  void SetRefreshButtonEnableFlag(int value);

  // Event handlers of the buttons; both arguments are ignored.
  void OnRefresh(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnClose(QelBaseUnknown* origin, QelSYPEventArgs* args);

  QelString GetResourceFilename(int level) const override;

  // State a test or a renderer may read.
  QelVidLayGrid* GetGrid() const { return grid_; }
  QelVidCtlScrollableArea* GetScrollableArea() const { return scrollableArea_; }
  const QelListValQelBaseUnknown_var& GetFacetWidgets() const { return facetWidgets_; }
  QelRovFacetGroup* GetFacetGroup() const;

 protected:
  ~QelRovRefinementDlg() override;
  void OnTemplateApplied() override;

 private:
  QelFrmEditor* editor_ = nullptr;  // kept for the host; never read here
  QelListValQelBaseUnknown_var facets_;
  QelListValQelBaseUnknown_var facetWidgets_;
  std::vector<QelVar<QelVidWidget>> spacers_;
  QelVidLayGrid* grid_ = nullptr;
  QelVidCtlScrollableArea* scrollableArea_ = nullptr;
  int refreshButtonEnableFlag_ = 0;
  QelBaseUnknown_WR facetGroup_;
  QelVidCtlButton* closeButton_ = nullptr;
};
