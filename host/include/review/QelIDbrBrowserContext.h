#pragma once
// QelIDbrBrowserContext: what a review browser shows: its title, icon and columns, the
// names of its nodes and the items under each. The browser holds its context; a context
// knows its browsers only weakly (QelDbrBrowserContext::SetBrowser).
#include <vector>

#include "QelListValQelBaseUnknown_var.h"
#include "QelPathElement.h"
#include "QelString.h"
#include "QelUnicodeString.h"

class QelListValQelUnicodeString;

class QelIDbrBrowserContext : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDbrBrowserContext;
  static constexpr QelIID IID = QelIID::Parse("{D7552488-666B-4FCC-A385-37967628DC72}");

  // Fills the context (the argument is the browser's and not used by contexts so far).
  virtual HRESULT InitContents(QelBaseUnknown* unused) = 0;
  // Empties it and withdraws it from whatever it observes.
  virtual HRESULT ResetContents(QelBaseUnknown* unused) = 0;
  // Follows a new UI-active object.
  virtual HRESULT ChangeContextObject(QelBaseUnknown_var& object) = 0;
  virtual HRESULT GetContextName(QelString& name) = 0;
  virtual HRESULT GetBrowserTitle(QelUnicodeString& title) = 0;
  virtual HRESULT GetBrowserIconName(QelUnicodeString& icon) = 0;
  // Appends the column identifiers and, position for position, their headers.
  virtual HRESULT GetColumns(int browserType, std::vector<QelString>& columns, QelListValQelUnicodeString& headers) = 0;
  virtual HRESULT ListNodeNames(int browserType, std::vector<QelString>& names) = 0;
  virtual HRESULT ListNodeItems(QelString name, QelListValQelBaseUnknown_var& items) = 0;
  // Told that an object of the model was replaced by another.
  virtual HRESULT OnObjectReplaced(QelBaseUnknown_var replaced, QelBaseUnknown_var by) = 0;
  // 0: single selection.
  virtual int GetSelectionMode() = 0;
  virtual QelBaseUnknown_var GetUIActiveObject() = 0;
  // 1: items listed under their nodes.
  virtual int GetDisplayMode() = 0;
  // The column sorted on first (0-based).
  virtual int GetSortColumn() = 0;
  virtual bool IsItemEditable() = 0;
  // The item selected when the browser opens; null: none.
  virtual QelBaseUnknown_var GetDefaultSelection() = 0;
  // A new path (one reference for the caller) under which the item is shown, or null.
  virtual QelPathElement* GetItemPath(QelBaseUnknown_var& item) = 0;

 protected:
  ~QelIDbrBrowserContext() override = default;
};
