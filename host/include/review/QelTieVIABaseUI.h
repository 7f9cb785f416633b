#pragma once
// QelTieVIABaseUI<Impl>: the tie through which a browser item class (derived from
// QelAdapterVIABaseUI) answers QelIVIABaseUI: each slot calls the class operation of the
// same name, whatever the class's own virtual order.
#include "QelAdapterVIABaseUI.h"
#include "QelIVIABaseUI.h"
#include "QelTie.h"

template <class Item>
class QelTieVIABaseUI final : public QelTie<QelIVIABaseUI> {
 public:
  using QelTie::QelTie;

  HRESULT GetPropertyValue(const QelString& column, QelUnicodeString& value) override { return Self()->GetPropertyValue(column, value); }
  int GetPropertyCount() override { return Self()->GetPropertyCount(); }
  int IsSelectable() override { return Self()->IsSelectable(); }
  HRESULT GetDropList(QelListValQelBaseUnknown_var& targets) override { return Self()->GetDropList(targets); }
  HRESULT GetPropertyIcon(const QelString& column, QelUnicodeString& icon) override { return Self()->GetPropertyIcon(column, icon); }
  HRESULT GetStyle(int& style) override { return Self()->GetStyle(style); }
  HRESULT GetTooltip(QelUnicodeString& tooltip) override { return Self()->GetTooltip(tooltip); }
  HRESULT GetThumbnail(QelPixelImage** image) override { return Self()->GetThumbnail(image); }
  HRESULT GetItemTitle(QelUnicodeString& title) override { return Self()->GetItemTitle(title); }
  HRESULT GetThumbDisplay(int& mode) override { return Self()->GetThumbDisplay(mode); }
  HRESULT GetTilesImage(QelPixelImage** image) override { return Self()->GetTilesImage(image); }
  HRESULT GetTilesDisplay(int& mode) override { return Self()->GetTilesDisplay(mode); }
  HRESULT GetProperties(std::vector<QelString>& columns) override { return Self()->GetProperties(columns); }
  HRESULT SetIndex(int index) override { return Self()->SetIndex(index); }
  HRESULT GetIndexValue(int& index) override { return Self()->GetIndexValue(index); }
  HRESULT GetBoundingRadius(double& radius) override { return Self()->GetBoundingRadius(radius); }
  HRESULT GetBoundingBox(QelMathPoint& low, QelMathPoint& high) override { return Self()->GetBoundingBox(low, high); }
  HRESULT GetContextualMenu(QelBaseUnknown_var& menu) override { return Self()->GetContextualMenu(menu); }
  HRESULT GetRep(QelBaseUnknown_var& rep) override { return Self()->GetRep(rep); }
  HRESULT Get2DRep(QelBaseUnknown_var& rep) override { return Self()->Get2DRep(rep); }
  HRESULT GetStartZoomTime(double& seconds) override { return Self()->GetStartZoomTime(seconds); }
  HRESULT ActivateItem() override { return Self()->ActivateItem(); }
  HRESULT Get3DThumbnailRep(QelBaseUnknown_var& rep) override { return Self()->Get3DThumbnailRep(rep); }
  HRESULT Set3DThumbnailRep(QelBaseUnknown* rep) override { return Self()->Set3DThumbnailRep(rep); }
  HRESULT SetTurtable3DRepMode(int mode) override { return Self()->SetTurtable3DRepMode(mode); }
  HRESULT GetTurtable3DRepMode(int& mode) override { return Self()->GetTurtable3DRepMode(mode); }
  HRESULT GetProxyTurnTable3DRepWash(QelBaseUnknown_var& rep) override { return Self()->GetProxyTurnTable3DRepWash(rep); }
  HRESULT OnDrag() override { return Self()->OnDrag(); }
  QelPathElement* GetPathElement() override { return Self()->GetPathElement(); }
  HRESULT GetIconTitle(QelUnicodeString& title) override { return Self()->GetIconTitle(title); }
  HRESULT GetIntrospectable(QelISYPIntrospectable** introspectable) override { return Self()->GetIntrospectable(introspectable); }
  HRESULT OnDrop(QelBaseUnknown* dropped) override { return Self()->OnDrop(dropped); }
  HRESULT NotifyBrowser() override { return Self()->NotifyBrowser(); }
  HRESULT SetBackgroundColor(const QelAfrColor& color) override { return Self()->SetBackgroundColor(color); }

 private:
  Item* Self() const { return this->template Impl<Item>(); }
};
