#pragma once
// QelRovFacetFilterData: the refinement a facet group passes with its display requests:
// the default-annotation switch, the tolerance switch and the tolerance range. Counted;
// one per facet group, kept alive by the annotation items that hold it.
//
// Values are copied into the object's own storage; GetToleranceValues hands out pointers
// into that storage (valid until the next SetToleranceValues), null meaning "no value".
#include "QelPropertyOperator.h"
#include "QelVar.h"

class QelRovFacetFilterData : public QelBaseUnknown {
 public:
  QelRovFacetFilterData();

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetToleranceValues(QelPropertyOperator& leftOp, double*& leftValue, QelPropertyOperator& rightOp,
                             double*& rightValue);
  HRESULT SetToleranceValues(QelPropertyOperator leftOp, const double* leftValue, QelPropertyOperator rightOp,
                             const double* rightValue);

  // Whether a tolerance value lies in the range. A null bound does not constrain; with
  // an Equal left operator the right bound is not consulted.
  bool IsInToleranceRange(double value) const;

  bool DefaultAnnot = false;
  bool TolAnnot = false;

 protected:
  ~QelRovFacetFilterData() override;

 private:
  // An open range "lower <= value <= upper" with neither bound set: operators the panel's
  // range row can show from the start (its left combo has no "value <= lower").
  QelPropertyOperator leftOp_ = QelPropertyOperatorGreaterOrEqual;
  QelPropertyOperator rightOp_ = QelPropertyOperatorLessOrEqual;
  double left_ = 0.0;
  double right_ = 0.0;
  bool hasLeft_ = false;
  bool hasRight_ = false;
};
