#pragma once
// QelRovBrowserViewToolbox: turns a light annotation view or capture into something the
// 3D viewer shows: a camera square to a view, a capture's viewpoint, a rendered preview and
// its description. Static operations only; no state. Exported to other modules.
#include "Qel3DViewer.h"
#include "QelI3DCamera.h"
#include "QelITPSView.h"
#include "QelPathElement.h"
#include "QelPixelImage.h"
#include "QelRovFacetsExport.h"
#include "QelUnicodeString.h"

class QEL_ROV_EXPORT QelRovBrowserViewToolbox {
 public:
  QelRovBrowserViewToolbox() = delete;

  // A 576 x 432 preview of `item` rendered with `viewer` (whose main viewpoint keeps the
  // item's camera afterwards), one reference for the caller; null on failure.
  static QelPixelImage* GetThumbnailPreview(QelBaseUnknown_var& item, Qel3DViewer* viewer, QelPathElement* rootPath);
  // For a view, the name of the first capture linked to it; for a capture, the name of its
  // linked view; empty otherwise.
  static QelUnicodeString GetThumbnailDescription(QelBaseUnknown_var& item);

 private:
  // Tests reach the private operations through this friend.
  friend class QelRovBrowserViewToolboxProbe;

  static QelPathElement* CreateObjectPath(QelBaseUnknown_var& object, QelPathElement* rootPath);
  static HRESULT ComputeCameraFromView(QelVar<QelITPSView>& view, QelVar<QelI3DCamera>& camera);
  static HRESULT ApplyCaptureViewpoint(QelPathElement* capturePath, Qel3DViewer* viewer, QelPathElement* rootPath);
  static HRESULT InitializeViewModesFomCurrentViewer(Qel3DViewer* viewer);
};
