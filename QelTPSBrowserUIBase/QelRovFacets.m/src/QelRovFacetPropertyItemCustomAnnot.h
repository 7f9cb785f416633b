#pragma once
// QelRovFacetPropertyItemCustomAnnot: the row of one annotation, shown or hidden through
// the facet group's filter data. The item keeps that filter data alive for its own
// lifetime; the annotation itself is held weakly. A facet rebuilding its rows may renew
// an item in place instead of making the same one again.
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

  // Makes this item what a new one for `annotation` and `filterData` under the same group
  // would be: label and icon read again, state read from the display, default flags. False,
  // and the item left as it was, when it stands for another annotation or filter data, or
  // when a new item would report a fault.
  bool Renew(QelBaseUnknown* annotation, QelRovFacetFilterData* filterData);

 protected:
  ~QelRovFacetPropertyItemCustomAnnot() override;

 private:
  QelVar<QelRovFacetFilterData> filterData_;
};
