#pragma once
// QelAdapterVIABaseUI: the base of browser items; every QelIVIABaseUI operation has a
// neutral answer here (E_NOTIMPL, 0, 1 or null), and items override what they know. It
// does not derive from the interface: a tie (QelTieVIABaseUI) forwards to it by name.
#include <vector>

#include "QelIDbrBrowserViewBaseUI.h"
#include "QelISYPIntrospectable.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMathVector.h"
#include "QelPixelImage.h"

class QelAdapterVIABaseUI : public QelBaseUnknown {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  virtual HRESULT GetPropertyValue(const QelString& column, QelUnicodeString& value) { (void)column; (void)value; return E_NOTIMPL; }
  virtual int GetPropertyCount() { return 0; }
  virtual int IsSelectable() { return 1; }
  virtual HRESULT GetDropList(QelListValQelBaseUnknown_var& targets) { (void)targets; return E_NOTIMPL; }
  virtual HRESULT GetPropertyIcon(const QelString& column, QelUnicodeString& icon) { (void)column; (void)icon; return E_NOTIMPL; }
  virtual HRESULT GetStyle(int& style) { (void)style; return E_NOTIMPL; }
  virtual HRESULT GetTooltip(QelUnicodeString& tooltip) { (void)tooltip; return E_NOTIMPL; }
  virtual HRESULT GetThumbnail(QelPixelImage** image) { (void)image; return E_NOTIMPL; }
  virtual HRESULT GetItemTitle(QelUnicodeString& title) { (void)title; return E_NOTIMPL; }
  virtual HRESULT GetThumbDisplay(int& mode) { (void)mode; return E_NOTIMPL; }
  virtual HRESULT GetTilesImage(QelPixelImage** image) { (void)image; return E_NOTIMPL; }
  virtual HRESULT GetTilesDisplay(int& mode) { (void)mode; return E_NOTIMPL; }
  virtual HRESULT GetIntrospectable(QelISYPIntrospectable** introspectable) { (void)introspectable; return E_NOTIMPL; }
  virtual HRESULT GetIconTitle(QelUnicodeString& title) { (void)title; return E_NOTIMPL; }
  virtual QelPathElement* GetPathElement() { return nullptr; }
  virtual HRESULT OnDrag() { return E_NOTIMPL; }
  virtual HRESULT GetProxyTurnTable3DRepWash(QelBaseUnknown_var& rep) { (void)rep; return E_NOTIMPL; }
  virtual HRESULT GetTurtable3DRepMode(int& mode) { (void)mode; return E_NOTIMPL; }
  virtual HRESULT SetTurtable3DRepMode(int mode) { (void)mode; return E_NOTIMPL; }
  virtual HRESULT Set3DThumbnailRep(QelBaseUnknown* rep) { (void)rep; return E_NOTIMPL; }
  virtual HRESULT Get3DThumbnailRep(QelBaseUnknown_var& rep) { (void)rep; return E_NOTIMPL; }
  virtual HRESULT ActivateItem() { return E_NOTIMPL; }
  virtual HRESULT GetStartZoomTime(double& seconds) { (void)seconds; return E_NOTIMPL; }
  virtual HRESULT Get2DRep(QelBaseUnknown_var& rep) { (void)rep; return E_NOTIMPL; }
  virtual HRESULT GetRep(QelBaseUnknown_var& rep) { (void)rep; return E_NOTIMPL; }
  virtual HRESULT GetContextualMenu(QelBaseUnknown_var& menu) { (void)menu; return E_NOTIMPL; }
  virtual HRESULT GetBoundingBox(QelMathPoint& low, QelMathPoint& high) { (void)low; (void)high; return E_NOTIMPL; }
  virtual HRESULT GetBoundingRadius(double& radius) { (void)radius; return E_NOTIMPL; }
  virtual HRESULT GetIndexValue(int& index) { (void)index; return E_NOTIMPL; }
  virtual HRESULT SetIndex(int index) { (void)index; return E_NOTIMPL; }
  virtual HRESULT GetProperties(std::vector<QelString>& columns) { (void)columns; return E_NOTIMPL; }
  virtual HRESULT OnDrop(QelBaseUnknown* dropped) { (void)dropped; return E_NOTIMPL; }
  virtual HRESULT NotifyBrowser() { return E_NOTIMPL; }
  virtual HRESULT SetBackgroundColor(const QelAfrColor& color) { (void)color; return E_NOTIMPL; }

 protected:
  QelAdapterVIABaseUI() = default;
  ~QelAdapterVIABaseUI() override = default;
};
