#pragma once
// QelRovFacetView: the facet of the annotation views and captures of the visible sets:
// show them all, or a free choice with one row per capture and per view (captures
// first). Made and held by the facet group; its rows live from one rebuild to the next.
#include "QelRovFacet.h"

class QelRovFacetView : public QelRovFacet {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  explicit QelRovFacetView(QelBaseUnknown* group);

  // Unchecks "all" only: after the user chose it, neither choice stays checked.
  void Refresh() override;
  void Rebuild() override;
  // S_OK also without a root object, so that the facet group hears of the choice.
  HRESULT ApplyPropertyChange(QelBaseUnknown* property) override;

  HRESULT BuildViewCaptureItems(QelBaseUnknown* root);

 protected:
  ~QelRovFacetView() override;
};
