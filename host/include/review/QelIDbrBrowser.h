#pragma once
// QelIDbrBrowser: the review browser as its context and its items see it: they tell it
// when what it lists has gone, changed object, or been rebuilt.
#include "QelVar.h"

class QelIDbrBrowser : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDbrBrowser;
  static constexpr QelIID IID = QelIID::Parse("{FE83328B-6669-461A-8DEB-F513EE730151}");

  virtual int GetBrowserType() = 0;
  // The context shown; null when none.
  virtual QelBaseUnknown_var GetBrowserContext() = 0;
  // Rebuilds the nodes and items from the context.
  virtual HRESULT Refresh() = 0;
  // The context lost its object and emptied itself.
  virtual HRESULT OnContextEmptied() = 0;
  // The context switched to another object and rebuilt its lists.
  virtual HRESULT OnContextObjectChanged() = 0;
  // The context rebuilt its lists after a light-load-mode change.
  virtual HRESULT OnContentsRebuilt() = 0;

 protected:
  ~QelIDbrBrowser() override = default;
};
