#pragma once
// QelPropertyOperator: how an annotation's tolerance value must relate to one bound of the
// tolerance range of the filter data. The left bound uses Equal, Greater, GreaterOrEqual;
// the right bound Less, LessOrEqual (the preset of both before anything is read).
enum QelPropertyOperator : int {
  QelPropertyOperatorEqual = 0,
  QelPropertyOperatorLess = 1,
  QelPropertyOperatorNotEqual = 2,
  QelPropertyOperatorLessOrEqual = 3,
  QelPropertyOperatorGreater = 4,
  QelPropertyOperatorGreaterOrEqual = 5,
};
