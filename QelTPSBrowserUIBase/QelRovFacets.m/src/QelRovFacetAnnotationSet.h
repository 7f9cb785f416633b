#pragma once
// QelRovFacetAnnotationSet: the facet that decides which annotation sets are shown: all of
// them (after the user confirms), the root product's own, a free choice with one row per
// set, or none. Made and held by the facet group; its set rows live from one rebuild to
// the next.
#include "QelRovFacet.h"

class QelRovFacetPropertyGroup;

class QelRovFacetAnnotationSet : public QelRovFacet {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  explicit QelRovFacetAnnotationSet(QelBaseUnknown* group);

  // Default choice (the free choice), the root choice's visibility, then Rebuild.
  void Refresh() override;
  // One row per set of the model, under the free choice; the choices keep their states.
  void Rebuild() override;
  HRESULT ApplyPropertyChange(QelBaseUnknown* property) override;
  // Asks the user to confirm the choice of every set; S_FALSE when refused.
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override;

  // Adds a row for each set of `sets` that `group` has none for yet.
  HRESULT BuildSetItems(const QelListValQelBaseUnknown_var& sets, QelRovFacetPropertyGroup* group);

 protected:
  ~QelRovFacetAnnotationSet() override;

 private:
  void UpdateRootVisibility(QelRovFacetProperty* rootChoice);
  bool IsProperty(int position, QelBaseUnknown* property) const;
};
