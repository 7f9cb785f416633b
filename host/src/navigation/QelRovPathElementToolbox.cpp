#include "QelRovPathElementToolbox.h"

#include "QelIPLMNavOccurrence.h"
#include "QelPathElement.h"

HRESULT QelRovPathElementToolbox::GetMechPartToContextTransfo(QelPathElement* path,
                                                             QelMathTransformation& transformation) {
  transformation = QelMathTransformation();
  if (!path) return E_FAIL;
  // Built aside so that a failure half-way leaves the caller's identity untouched.
  QelMathTransformation toContext;
  bool contextFound = false;
  for (int i = 0; i < path->GetSize(); ++i) {
    QelVar<QelIPLMNavOccurrence> occurrence((*path)[i].get());
    if (!occurrence) continue;
    // The context's own placement is in a frame above the path and takes no part.
    if (!contextFound) {
      contextFound = true;
      continue;
    }
    QelMathTransformation placement;
    if (QelFailed(occurrence->GetPlacement(placement))) return E_FAIL;
    // Root side last: the leaf's placement is applied to a point first.
    toContext = toContext * placement;
  }
  if (!contextFound) return E_FAIL;
  transformation = toContext;
  return S_OK;
}
