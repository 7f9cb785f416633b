#pragma once
// QelIDbrBrowserViewBaseUI: an item of a review browser as the browser view drives it: it
// is told where it is shown (browser view, root path) and asked to refresh.
#include "QelPathElement.h"
#include "QelString.h"
#include "QelUnicodeString.h"
#include "QelVidColor.h"

using QelAfrColor = QelVidColor;

class QelIDbrBrowserViewBaseUI : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDbrBrowserViewBaseUI;
  static constexpr QelIID IID = QelIID::Parse("{F835C430-E0C5-44AE-AFFF-3D87CB6662C6}");

  virtual HRESULT SetBrowserView(QelBaseUnknown_var browserView) = 0;
  // Item-specific display flags; 0: none.
  virtual int GetDisplayFlags() = 0;
  // Forgets what the item computed for the browser view it was shown in last.
  virtual void ClearViewState() = 0;
  // Keeps `path` (adding a reference); null is kept as null.
  virtual void SetRootPath(QelPathElement* path) = 0;
  virtual HRESULT RefreshItem() = 0;
  virtual HRESULT RefreshItemProperty(QelString property, bool redraw) = 0;
  virtual QelUnicodeString GetDescription() = 0;
  virtual QelAfrColor GetItemColor() = 0;

 protected:
  ~QelIDbrBrowserViewBaseUI() override = default;
};
