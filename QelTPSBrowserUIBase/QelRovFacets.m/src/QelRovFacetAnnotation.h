#pragma once
// QelRovFacetAnnotation: the facet that chooses which annotations of the visible sets are
// shown: all of them, by type and sub-type, or by one of seven kinds; a default-annotation
// switch and a tolerance range refine every choice through the group's filter data.
// Made and held by the facet group; type groups, type rows and annotation rows live from
// one build to the next (an annotation row whose annotation comes again is renewed in
// place), the five choices and the seven kind groups as long as the facet.
#include <vector>

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
  void ClearTypeRows();
  void ClearKindRows();
  // Both builds over one listing of the visible annotations, the type build telling the
  // kind build which annotations are text or dimension objects: those questions are the
  // dearest of a pass.
  void BuildDynamicProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData);
  // `annotations` null: listed here. `visu`, per annotation: -1 not asked yet, else
  // whether it is a text or dimension object.
  HRESULT BuildTypeRows(QelBaseUnknown* root, QelRovFacetFilterData* filterData,
                        const QelListValQelBaseUnknown_var* annotations, std::vector<signed char>* visu);
  HRESULT BuildKindRows(QelBaseUnknown* root, QelRovFacetFilterData* filterData,
                        const QelListValQelBaseUnknown_var* annotations, const std::vector<signed char>* visu);

  bool IsProperty(int position, QelBaseUnknown* property) const;
};
