#pragma once
// QelERovBrowserContextFactory: data extension of product occurrences and DMU validations
// that offers the light views browser and hands out its context. It lives as long as the
// object it extends and refers to the context it handed out weakly: the browser holds the
// context, and once the browser lets it go the next request makes a new one.
#include "QelBaseUnknown_WR.h"
#include "QelIDbrBrowserContextFactory.h"

class QelERovBrowserContextFactory : public QelIDbrBrowserContextFactory {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;
  // The data extension's creator, as the dictionary stores it.
  static QelBaseUnknown* Create(QelBaseUnknown* extended);

  bool IsBrowserAvailable(int& browserType) override;
  QelBaseUnknown_var GetBrowserContext(int& browserType, QelBaseUnknown_var& browser) override;

 protected:
  QelERovBrowserContextFactory() = default;
  ~QelERovBrowserContextFactory() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR context_;
};
