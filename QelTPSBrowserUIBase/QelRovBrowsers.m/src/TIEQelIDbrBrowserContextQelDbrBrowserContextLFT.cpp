// Forwards QelIDbrBrowserContext to QelDbrBrowserContextLFT, operation by operation in slot order.
#include "QelDbrBrowserContextLFT.h"
#include "QelIDbrBrowserContext.h"
#include "QelRovBrowsersFactories.h"
#include "QelTie.h"

class TIEQelIDbrBrowserContextQelDbrBrowserContextLFT final : public QelTie<QelIDbrBrowserContext> {
 public:
  using QelTie::QelTie;
  HRESULT InitContents(QelBaseUnknown* a) override { return Self()->InitContents(a); }
  HRESULT ResetContents(QelBaseUnknown* a) override { return Self()->ResetContents(a); }
  HRESULT ChangeContextObject(QelBaseUnknown_var& object) override { return Self()->ChangeContextObject(object); }
  HRESULT GetContextName(QelString& name) override { return Self()->GetContextName(name); }
  HRESULT GetBrowserTitle(QelUnicodeString& title) override { return Self()->GetBrowserTitle(title); }
  HRESULT GetBrowserIconName(QelUnicodeString& icon) override { return Self()->GetBrowserIconName(icon); }
  HRESULT GetColumns(int type, std::vector<QelString>& columns, QelListValQelUnicodeString& headers) override {
    return Self()->GetColumns(type, columns, headers);
  }
  HRESULT ListNodeNames(int type, std::vector<QelString>& names) override { return Self()->ListNodeNames(type, names); }
  HRESULT ListNodeItems(QelString name, QelListValQelBaseUnknown_var& items) override {
    return Self()->ListNodeItems(std::move(name), items);
  }
  HRESULT OnObjectReplaced(QelBaseUnknown_var a, QelBaseUnknown_var b) override {
    return Self()->OnObjectReplaced(std::move(a), std::move(b));
  }
  int GetSelectionMode() override { return Self()->GetSelectionMode(); }
  QelBaseUnknown_var GetUIActiveObject() override { return Self()->GetUIActiveObject(); }
  int GetDisplayMode() override { return Self()->GetDisplayMode(); }
  int GetSortColumn() override { return Self()->GetSortColumn(); }
  bool IsItemEditable() override { return Self()->IsItemEditable(); }
  QelBaseUnknown_var GetDefaultSelection() override { return Self()->GetDefaultSelection(); }
  QelPathElement* GetItemPath(QelBaseUnknown_var& item) override { return Self()->GetItemPath(item); }

 private:
  ~TIEQelIDbrBrowserContextQelDbrBrowserContextLFT() override = default;
  QelDbrBrowserContextLFT* Self() const { return Impl<QelDbrBrowserContextLFT>(); }
};

extern "C" QelBaseUnknown* CreateTIEQelIDbrBrowserContextQelDbrBrowserContextLFT(QelBaseUnknown* impl) {
  return QelCreateTie<TIEQelIDbrBrowserContextQelDbrBrowserContextLFT>(impl);
}
