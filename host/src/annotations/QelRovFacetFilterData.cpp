#include "QelRovFacetFilterData.h"

#include "QelMetaObject.h"

namespace {
// The relation `value op bound` the annotation's tolerance value must satisfy.
bool Satisfies(double value, QelPropertyOperator op, double bound) {
  switch (op) {
    case QelPropertyOperatorEqual: return value == bound;
    case QelPropertyOperatorLess: return value < bound;
    case QelPropertyOperatorNotEqual: return value != bound;
    case QelPropertyOperatorLessOrEqual: return value <= bound;
    case QelPropertyOperatorGreater: return value > bound;
    case QelPropertyOperatorGreaterOrEqual: return value >= bound;
  }
  return false;
}
}  // namespace

const QelMetaObject& QelRovFacetFilterData::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelRovFacetFilterData", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelRovFacetFilterData::GetMetaObject() const { return &MetaObject(); }

QelRovFacetFilterData::QelRovFacetFilterData() = default;
QelRovFacetFilterData::~QelRovFacetFilterData() = default;

HRESULT QelRovFacetFilterData::GetToleranceValues(QelPropertyOperator& leftOp, double*& leftValue,
                                                  QelPropertyOperator& rightOp, double*& rightValue) {
  leftOp = leftOp_;
  rightOp = rightOp_;
  leftValue = hasLeft_ ? &left_ : nullptr;
  rightValue = hasRight_ ? &right_ : nullptr;
  return S_OK;
}

HRESULT QelRovFacetFilterData::SetToleranceValues(QelPropertyOperator leftOp, const double* leftValue,
                                                  QelPropertyOperator rightOp, const double* rightValue) {
  // Read both values before writing: callers pass back the pointers Get handed out.
  const bool hasLeft = leftValue != nullptr;
  const bool hasRight = rightValue != nullptr;
  const double left = hasLeft ? *leftValue : 0.0;
  const double right = hasRight ? *rightValue : 0.0;
  leftOp_ = leftOp;
  rightOp_ = rightOp;
  hasLeft_ = hasLeft;
  hasRight_ = hasRight;
  left_ = left;
  right_ = right;
  return S_OK;
}

bool QelRovFacetFilterData::IsInToleranceRange(double value) const {
  if (hasLeft_ && !Satisfies(value, leftOp_, left_)) return false;
  if (leftOp_ == QelPropertyOperatorEqual && hasLeft_) return true;
  if (hasRight_ && !Satisfies(value, rightOp_, right_)) return false;
  return true;
}
