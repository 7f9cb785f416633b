// Forwards QelIDbrBrowserViewBaseUI to QelERovViewsBrowserViewBaseUI, operation by operation in slot order.
#include "QelERovViewsBrowserViewBaseUI.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelRovBrowsersFactories.h"
#include "QelTie.h"

class TIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI final : public QelTie<QelIDbrBrowserViewBaseUI> {
 public:
  using QelTie::QelTie;
  HRESULT SetBrowserView(QelBaseUnknown_var view) override { return Self()->SetBrowserView(std::move(view)); }
  int GetDisplayFlags() override { return Self()->GetDisplayFlags(); }
  void ClearViewState() override { Self()->ClearViewState(); }
  void SetRootPath(QelPathElement* path) override { Self()->SetRootPath(path); }
  HRESULT RefreshItem() override { return Self()->RefreshItem(); }
  HRESULT RefreshItemProperty(QelString property, bool redraw) override {
    return Self()->RefreshItemProperty(std::move(property), redraw);
  }
  QelUnicodeString GetDescription() override { return Self()->GetDescription(); }
  QelAfrColor GetItemColor() override { return Self()->GetItemColor(); }

 private:
  ~TIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI() override = default;
  QelERovViewsBrowserViewBaseUI* Self() const { return Impl<QelERovViewsBrowserViewBaseUI>(); }
};

extern "C" QelBaseUnknown* CreateTIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI>(impl);
}
