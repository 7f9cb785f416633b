#pragma once
// QelRovFacetPropertyItemCustomAnnot: the row of one annotation, shown or hidden through
// the facet group's filter data. The item keeps that filter data alive for its own
// lifetime; the annotation itself is held weakly.
#include "QelRovFacetPropertyItem.h"

class QelRovFacetFilterData;

class QelRovFacetPropertyItemCustomAnnot : public QelRovFacetPropertyItem {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // The label is the annotation's first navigation name, else its alias.
  QelRovFacetPropertyItemCustomAnnot(QelBaseUnknown* annotation, QelRovFacetFilterData* filterData,
                                     QelBaseUnknown* group);

  HRESULT ApplyCheckState() override;

 protected:
  ~QelRovFacetPropertyItemCustomAnnot() override;

 private:
  QelVar<QelRovFacetFilterData> filterData_;
};
