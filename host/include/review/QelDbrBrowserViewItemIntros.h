#pragma once
// QelDbrBrowserViewItemIntros: the row of a browser item in the list display. It reads the
// item's texts through QelIVIABaseUI and redraws when its shading colour is set. It holds
// the item weakly: the item's adapter owns the row.
#include "QelBaseUnknown_WR.h"
#include "QelIAfrListItem.h"
#include "QelISYPIntrospectable.h"

class QelDbrBrowserViewItemIntros : public QelISYPIntrospectable, public QelIAfrListItem {
 public:
  explicit QelDbrBrowserViewItemIntros(QelBaseUnknown* item) : item_(item) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  const QelSYPMetaClass* GetSYPMetaClass() const override { return nullptr; }
  void DispatchModifyProperty(const char* propertyName) override;
  QelAfrColor GetShadingColor() override { return shading_; }
  void SetShadingColor(const QelAfrColor& color) override;

  // The item's text in a column, as the row shows it; empty when the item is gone.
  QelUnicodeString GetText(const char* column) const;
  int GetRedrawCount() const { return redraws_; }

 protected:
  ~QelDbrBrowserViewItemIntros() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR item_;
  QelAfrColor shading_{0, 0, 0, 0};
  int redraws_ = 0;
};
