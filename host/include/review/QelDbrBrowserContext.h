#pragma once
// QelDbrBrowserContext: the base of browser contexts. It holds the context object (the
// product whose contents are shown) and knows the browsers it serves, per browser type,
// weakly: the browser holds the context, never the other way round.
#include <utility>
#include <vector>

#include "QelBaseUnknown_WR.h"

class QelDbrBrowserContext : public QelBaseUnknown {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  QelBaseUnknown_var GetContextObject() const { return object_; }
  void SetContextObject(QelBaseUnknown* object) { object_ = QelBaseUnknown_var(object); }

  // Registers (or replaces) the browser of a type.
  HRESULT SetBrowser(int browserType, QelBaseUnknown* browser);
  // The browser of a type; null when none was registered or it has gone.
  QelBaseUnknown_var GetBrowser(int browserType) const;
  // The leaf of the current editor's UI-active path; null when nothing is UI-active.
  QelBaseUnknown_var GetUIActiveObject() const;

 protected:
  explicit QelDbrBrowserContext(QelBaseUnknown* contextObject) : object_(contextObject) {}
  ~QelDbrBrowserContext() override = default;

 private:
  QelBaseUnknown_var object_;
  std::vector<std::pair<int, QelBaseUnknown_WR>> browsers_;
};
