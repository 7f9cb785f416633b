#pragma once
// QelIDbrBrowserContextFactory: asked on the object a review browser opens on, whether a
// browser of a type may open here and for its context.
#include "QelVar.h"

class QelIDbrBrowserContextFactory : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIDbrBrowserContextFactory;
  static constexpr QelIID IID = QelIID::Parse("{09AD0A48-233D-4BA7-BE18-A775AE5E6936}");

  virtual bool IsBrowserAvailable(int& browserType) = 0;
  // The context (the browser holds it); null when none can be given.
  virtual QelBaseUnknown_var GetBrowserContext(int& browserType, QelBaseUnknown_var& browser) = 0;

 protected:
  ~QelIDbrBrowserContextFactory() override = default;
};
