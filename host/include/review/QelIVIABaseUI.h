#pragma once
// QelIVIABaseUI: an item of a review browser as its list display reads it: column texts
// and icons, thumbnail, title, path, introspection object, menu, and activation. Images,
// paths and introspection objects handed out carry one reference for the caller.
#include <vector>

#include "QelIDbrBrowserViewBaseUI.h"
#include "QelISYPIntrospectable.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMathVector.h"
#include "QelPixelImage.h"

class QelIVIABaseUI : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIVIABaseUI;
  static constexpr QelIID IID = QelIID::Parse("{9F38D5CD-5D51-496A-928B-F519FAE56F42}");

  virtual HRESULT GetPropertyValue(const QelString& column, QelUnicodeString& value) = 0;
  virtual int GetPropertyCount() = 0;
  virtual int IsSelectable() = 0;
  virtual HRESULT GetDropList(QelListValQelBaseUnknown_var& targets) = 0;
  virtual HRESULT GetPropertyIcon(const QelString& column, QelUnicodeString& icon) = 0;
  virtual HRESULT GetStyle(int& style) = 0;
  virtual HRESULT GetTooltip(QelUnicodeString& tooltip) = 0;
  virtual HRESULT GetThumbnail(QelPixelImage** image) = 0;
  virtual HRESULT GetItemTitle(QelUnicodeString& title) = 0;
  virtual HRESULT GetThumbDisplay(int& mode) = 0;
  virtual HRESULT GetTilesImage(QelPixelImage** image) = 0;
  virtual HRESULT GetTilesDisplay(int& mode) = 0;
  virtual HRESULT GetProperties(std::vector<QelString>& columns) = 0;
  virtual HRESULT SetIndex(int index) = 0;
  virtual HRESULT GetIndexValue(int& index) = 0;
  virtual HRESULT GetBoundingRadius(double& radius) = 0;
  virtual HRESULT GetBoundingBox(QelMathPoint& low, QelMathPoint& high) = 0;
  virtual HRESULT GetContextualMenu(QelBaseUnknown_var& menu) = 0;
  virtual HRESULT GetRep(QelBaseUnknown_var& rep) = 0;
  virtual HRESULT Get2DRep(QelBaseUnknown_var& rep) = 0;
  virtual HRESULT GetStartZoomTime(double& seconds) = 0;
  virtual HRESULT ActivateItem() = 0;
  virtual HRESULT Get3DThumbnailRep(QelBaseUnknown_var& rep) = 0;
  virtual HRESULT Set3DThumbnailRep(QelBaseUnknown* rep) = 0;
  virtual HRESULT SetTurtable3DRepMode(int mode) = 0;
  virtual HRESULT GetTurtable3DRepMode(int& mode) = 0;
  virtual HRESULT GetProxyTurnTable3DRepWash(QelBaseUnknown_var& rep) = 0;
  virtual HRESULT OnDrag() = 0;
  virtual QelPathElement* GetPathElement() = 0;
  virtual HRESULT GetIconTitle(QelUnicodeString& title) = 0;
  virtual HRESULT GetIntrospectable(QelISYPIntrospectable** introspectable) = 0;
  virtual HRESULT OnDrop(QelBaseUnknown* dropped) = 0;
  virtual HRESULT NotifyBrowser() = 0;
  virtual HRESULT SetBackgroundColor(const QelAfrColor& color) = 0;

 protected:
  ~QelIVIABaseUI() override = default;
};
