#pragma once
// QelRovFacetAnnotation: the facet that chooses which annotations of the visible sets are
// shown: all of them, by type and sub-type, or by one of seven kinds; a default-annotation
// switch and a tolerance range refine every choice through the group's filter data.
// Made and held by the facet group; type groups, type rows and annotation rows live from
// one build to the next, the five choices and the seven kind groups as long as the facet.
#include "QelRovFacet.h"

class QelRovFacetFilterData;
class QelRovFacetPropertyGroup;

class QelRovFacetAnnotation : public QelRovFacet {
 public:
  static constexpr int KindCount = 7;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  explicit QelRovFacetAnnotation(QelBaseUnknown* group);

  // The kind choice, the two switches from the filter data, then the dynamic rows.
  void Refresh() override;
  // The dynamic rows only; the five choices keep their states.
  void Rebuild() override;
  // S_FALSE without a root object.
  HRESULT ApplyPropertyChange(QelBaseUnknown* property) override;

  HRESULT BuildTypeProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData);
  HRESULT BuildKindProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData);

  // The kind index (1..7) of an annotation type code; 0 for a code of no kind.
  static int KindOfTypeCode(int code);

 protected:
  ~QelRovFacetAnnotation() override;

 private:
  void ClearDynamicProperties();
  QelRovFacetPropertyGroup* GroupAt(int position) const;
  bool IsProperty(int position, QelBaseUnknown* property) const;
};
