#pragma once
// QelRovFacetServices: the annotation data layer as the facets see it: listing sets,
// annotations, views and captures of a product model, and showing or hiding them. Static
// operations only; every handle they hand out carries its own reference. No operation
// throws; each answers S_OK on success.
//
// The listing flags and how filter data applies to an annotation are stated in
// docs/display-rule.md.
#include "QelCallbackManager.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelVar.h"

// Dispatched on a product model after an object of it was shown or hidden by a display
// request; the payload is the object.
inline constexpr const char* kQelDisplayChanged = "QelDisplayChanged";

class QelFrmEditor;
class QelPathElement;
class QelRovFacetFilterData;

class QelRovFacetServices {
 public:
  QelRovFacetServices() = delete;

  // On by default; QEL_REFINEMENT_DEV=0 in the environment, or SetRefinementDevActive,
  // switches it off so that the facet controller is never made.
  static bool IsRefinementDevActive();
  static void SetRefinementDevActive(bool active);

  static HRESULT GetRootPLMObject(QelFrmEditor* editor, QelBaseUnknown_var& root);
  static HRESULT GetWorkingUIActivePath(QelFrmEditor* editor, QelVar<QelPathElement>& path);

  // Append to `list`. Flags: see docs/display-rule.md.
  static HRESULT ListAllSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list, bool flag);
  static HRESULT ListDirectSets(QelBaseUnknown* object, QelListValQelBaseUnknown_var& list, bool flag);
  static HRESULT ListARMOrDirectSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list, bool flag);
  // Sets shown, in model order; per set its annotations, or its views then its captures.
  static HRESULT ListAnnotationsOfVisibleSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list);
  static HRESULT ListCapturesAndViewsOfVisibleSets(QelBaseUnknown* root, QelListValQelBaseUnknown_var& list);

  // enable 1 shows, 0 hides. A non-null filter refines which annotations are shown.
  // The list form answers the first failure, after treating every entry.
  static HRESULT EnableDisableDisplay(const QelListValQelBaseUnknown_var& list, int enable,
                                      QelRovFacetFilterData* filter);
  static HRESULT EnableDisableDisplay(QelBaseUnknown* object, int enable, QelRovFacetFilterData* filter);
  // S_OK shown, S_FALSE hidden; E_FAIL for an object of no model.
  static HRESULT IsDisplayEnabled(QelBaseUnknown* object);
  // Subscribes `fn` to kQelDisplayChanged of the model that `objectOfModel` belongs to:
  // it is called once per object whose shown state a display request changed. 0 for an
  // object of no model.
  static QelCallbackId AddDisplayChangeCallback(QelBaseUnknown* objectOfModel, QelBaseUnknown* subscriber,
                                                QelCallbackFn fn);

  // The three mode answers of the sets component (62); (false, false, false) by default.
  static void SetLumSetModes(bool lightReviewMode, bool typeFilterAllowed, bool typeFilterForced);
};
