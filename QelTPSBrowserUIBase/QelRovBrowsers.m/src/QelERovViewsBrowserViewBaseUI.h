#pragma once
// QelERovViewsBrowserViewBaseUI: data extension of light annotation views and captures
// that answers the review browser for one item: column texts, icon, thumbnail, path,
// list row, menu and activation. It lives as long as its item, which it refers to weakly.
// The thumbnail, the item path and the list row are made on first request and kept (an
// absent thumbnail is tried again); the browser view is known weakly.
#include "QelAdapterVIABaseUI.h"
#include "QelBaseUnknown_WR.h"
#include "QelDbrBrowserViewItemIntros.h"

class QelERovViewsBrowserViewBaseUI : public QelAdapterVIABaseUI {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;
  // The data extension's creator, as the dictionary stores it.
  static QelBaseUnknown* Create(QelBaseUnknown* extended);

  // QelIDbrBrowserViewBaseUI, through its tie.
  HRESULT SetBrowserView(QelBaseUnknown_var browserView);
  int GetDisplayFlags() { return 0; }
  void ClearViewState() {}
  void SetRootPath(QelPathElement* path);
  HRESULT RefreshItem();
  HRESULT RefreshItemProperty(QelString property, bool redraw);
  QelUnicodeString GetDescription();
  QelAfrColor GetItemColor() { return QelAfrColor(0, 0, 0, 0); }

  // QelIVIABaseUI, through its tie; the other operations keep the adapter's answers.
  HRESULT GetPropertyValue(const QelString& column, QelUnicodeString& value) override;
  int GetPropertyCount() override { return 0; }
  int IsSelectable() override { return 1; }
  HRESULT GetPropertyIcon(const QelString& column, QelUnicodeString& icon) override;
  HRESULT GetThumbnail(QelPixelImage** image) override;
  HRESULT GetItemTitle(QelUnicodeString& title) override;
  HRESULT GetContextualMenu(QelBaseUnknown_var& menu) override;
  HRESULT ActivateItem() override;
  QelPathElement* GetPathElement() override;
  HRESULT GetIntrospectable(QelISYPIntrospectable** introspectable) override;
  HRESULT NotifyBrowser() override;

 protected:
  explicit QelERovViewsBrowserViewBaseUI(QelBaseUnknown* item) : item_(item) {}
  ~QelERovViewsBrowserViewBaseUI() override;

 private:
  QelPixelImage* RenderThumbnail();

  QelBaseUnknown_WR item_;
  QelVar<QelPixelImage> thumbnail_;
  QelVar<QelPathElement> rootPath_;
  QelVar<QelPathElement> itemPath_;
  QelBaseUnknown_WR browserView_;
  QelBaseUnknown_WR intros_;
  QelVar<QelDbrBrowserViewItemIntros> introsCreation_;
};
