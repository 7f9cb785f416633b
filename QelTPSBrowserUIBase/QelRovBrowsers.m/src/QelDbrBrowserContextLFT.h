#pragma once
// QelDbrBrowserContextLFT: the review browser's context for light annotation sets: one
// node per set of the context object, under it the set's captures view by view. Held by
// its browser (through its QelIDbrBrowserContext tie), cached weakly by the context
// factory. While filled it observes the light-load mode of the owners of its light sets,
// and it withdraws from them whenever it refills and when it goes, reset or not.
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelDbrBrowserContext.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelListValQelUnicodeString.h"
#include "QelPathElement.h"
#include "QelString.h"

class QelILumSetComponent;

class QelDbrBrowserContextLFT : public QelDbrBrowserContext {
 public:
  explicit QelDbrBrowserContextLFT(QelBaseUnknown* contextObject);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // QelIDbrBrowserContext, through its tie.
  HRESULT InitContents(QelBaseUnknown* unused);
  HRESULT ResetContents(QelBaseUnknown* unused);
  HRESULT ChangeContextObject(QelBaseUnknown_var& object);
  HRESULT GetContextName(QelString& name);
  HRESULT GetBrowserTitle(QelUnicodeString& title);
  HRESULT GetBrowserIconName(QelUnicodeString& icon);
  HRESULT GetColumns(int browserType, std::vector<QelString>& columns, QelListValQelUnicodeString& headers);
  HRESULT ListNodeNames(int browserType, std::vector<QelString>& names);
  HRESULT ListNodeItems(QelString name, QelListValQelBaseUnknown_var& items);
  HRESULT OnObjectReplaced(QelBaseUnknown_var replaced, QelBaseUnknown_var by);
  int GetSelectionMode() { return 0; }
  QelBaseUnknown_var GetUIActiveObject() { return QelDbrBrowserContext::GetUIActiveObject(); }
  int GetDisplayMode() { return 1; }
  int GetSortColumn() { return 0; }
  bool IsItemEditable() { return false; }
  QelBaseUnknown_var GetDefaultSelection() { return nullptr; }
  QelPathElement* GetItemPath(QelBaseUnknown_var& item);

  // QelILumLightLoadModeObserver, through its tie.
  HRESULT OnLightLoadModeChanged();

  // The label of a set's node: its owner's instances' aliases, the owner's alias and the
  // set's alias, joined as "Inst1, Inst2/Part1/Set.1".
  static QelUnicodeString BuildSetLabel(QelBaseUnknown* set);

 protected:
  ~QelDbrBrowserContextLFT() override;

 private:
  // Tests reach the private operations through this friend.
  friend class QelDbrBrowserContextLFTProbe;

  static HRESULT ListCapturesOfView(QelBaseUnknown* view, QelListValQelBaseUnknown_var& captures, QelBaseUnknown* set);
  static HRESULT FindRepOccurrenceOfSet(QelBaseUnknown* set, QelBaseUnknown* occurrence, bool searchChildren,
                                        QelBaseUnknown_var& rep);
  // Calls the browser of type 1 through `call`; false (after an assertion) without one.
  template <class Call>
  bool CallBrowser(Call call);
  void StopObserving();

  QelListValQelBaseUnknown_var sets_;
  QelListValQelUnicodeString labels_;
  // The observables this context added itself to, whatever its lists hold now.
  std::vector<QelBaseUnknown_WR> observed_;
};
