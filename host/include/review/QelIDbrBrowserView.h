#pragma once
// QelIDbrBrowserView: the part of a review browser that shows items: it lends a viewer for
// item previews, bracketed by BeginPreview and EndPreview so that it can restore itself.
#include "QelPathElement.h"

class QelIDbrBrowserView : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDbrBrowserView;
  static constexpr QelIID IID = QelIID::Parse("{6925BC82-898C-4E28-A566-2108B35CB2FD}");

  // The path under which items are shown (one reference for the caller), or null.
  virtual QelPathElement* GetRootPath() = 0;
  // The viewer previews are rendered with (0: the thumbnail viewer); null when none.
  virtual QelBaseUnknown_var GetPreviewViewer(int which) = 0;
  // How many previews were begun, for a person to see the cost of a listing.
  virtual int GetPreviewCount() = 0;
  virtual HRESULT BeginPreview() = 0;
  virtual HRESULT EndPreview() = 0;

 protected:
  ~QelIDbrBrowserView() override = default;
};
