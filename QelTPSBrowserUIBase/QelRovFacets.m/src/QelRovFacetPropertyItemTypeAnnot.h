#pragma once
// QelRovFacetPropertyItemTypeAnnot: the row of one annotation sub-type, standing for all
// the annotations of that sub-type the facet added. It has no object of its own, so its
// state changes only by the user or its group; it keeps the filter data alive.
#include "QelRovFacetPropertyItem.h"

class QelRovFacetFilterData;

class QelRovFacetPropertyItemTypeAnnot : public QelRovFacetPropertyItem {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelRovFacetPropertyItemTypeAnnot(const QelUnicodeString& label, QelRovFacetFilterData* filterData,
                                   QelBaseUnknown* group);

  // No duplicate check: the facet adds each annotation once.
  void AddAnnotation(QelBaseUnknown* annotation) { annotations_.Append(annotation); }
  void ClearAnnotations() { annotations_.RemoveAll(); }

  // Requests the display of every annotation held, last to first; request results are
  // not looked at.
  HRESULT ApplyCheckState() override;
  int32_t CountItems() override;

 protected:
  ~QelRovFacetPropertyItemTypeAnnot() override;

 private:
  QelListValQelBaseUnknown_var annotations_;
  QelVar<QelRovFacetFilterData> filterData_;
};
