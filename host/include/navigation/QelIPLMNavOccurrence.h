#pragma once
// A product occurrence of the product tree (late type "SorOccurrence"): its representation
// occurrences and its child occurrences; children are owned downward, the parent is a weak link.
// Its placement maps its own coordinates into its father's (the identity for the root).
#include "QelListValQelBaseUnknown_var.h"
#include "QelMathTransformation.h"
#include "QelVar.h"

class QelIPLMNavOccurrence : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIPLMNavOccurrence;
  static constexpr QelIID IID = QelIID::Parse("{A14E5A64-0070-471A-BB64-AEAF5ABC79E7}");

  virtual HRESULT ListRepOccurrences(QelListValQelBaseUnknown_var& reps) = 0;
  virtual HRESULT ListChildren(QelListValQelBaseUnknown_var& children) = 0;
  virtual HRESULT GetFather(QelBaseUnknown_var& father) = 0;
  virtual HRESULT GetPlacement(QelMathTransformation& placement) = 0;

 protected:
  ~QelIPLMNavOccurrence() override = default;
};
