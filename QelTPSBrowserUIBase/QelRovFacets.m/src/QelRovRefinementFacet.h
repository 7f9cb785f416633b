#pragma once
// QelRovRefinementFacet: one facet of the data filtering panel as an expandable section
// whose body grid holds one property widget per property, in the facet's order. It holds
// the facet weakly; the section's expanded state lives in the facet. Every change its
// property widgets report becomes one SendFacetEvent, which makes the dialog rebuild it.
// A section built inside a parent and later removed from it is retired: the next section
// built over the same facet moves over the rows it would make again.
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelSYPEventHandler.h"
#include "QelSYPEventArgs.h"
#include "QelUnicodeString.h"
#include "QelVidCtl.h"

class QelRovFacet;
class QelVidLayGrid;

class QelRovRefinementFacet : public QelVidCtl {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // For the introspection meta class: nothing set, no style.
  QelRovRefinementFacet();
  QelRovRefinementFacet(QelVidWidget* parent, const QelString& name, QelBaseUnknown* facet);

  HRESULT BuildPropertyWidgets();
  static QelSYPEvent* SendFacetEvent();
  // The handler of the property widgets' SendPropEvent; both arguments are ignored.
  void ForwardPropertyEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);

  QelString GetResourceFilename(int level) const override;

  // Introspectable properties and handlers.
  int GetExpandedFlag() const;
  QelUnicodeString GetFacetName() const { return facetName_; }
  QelUnicodeString GetFacetIcon() const { return QelUnicodeString("QelTPSIcon_EmptyIcon.png"); }
  void OnExpanderExpanded(QelBaseUnknown* origin, QelSYPEventArgs* args);
  void OnExpanderCollapsed(QelBaseUnknown* origin, QelSYPEventArgs* args);

  QelVidLayGrid* GetGrid() const { return grid_; }

 protected:
  ~QelRovRefinementFacet() override;
  void OnTemplateApplied() override;

 private:
  // The facet, held for the caller; null after an assertion when it is gone ("NULL
  // handler") or no facet.
  QelRovFacet* ResolveFacet(QelBaseUnknown_var& hold) const;
  // The rows of the retired section over `facet`, if there is one (with its forwarder),
  // and this section recorded as the one over `facet` when it has a parent.
  std::vector<QelVar<QelVidWidget>> TakeRetiredRows(QelBaseUnknown* facet, QelVar<QelSYPEventHandler>& forwarder);

  QelBaseUnknown_WR facet_;
  QelUnicodeString facetName_;
  QelVidLayGrid* grid_ = nullptr;
  // The SendPropEvent handler of every row, so that a later section can disconnect it.
  QelVar<QelSYPEventHandler> forwarder_;
};
