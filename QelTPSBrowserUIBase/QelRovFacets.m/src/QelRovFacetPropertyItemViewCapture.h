#pragma once
// QelRovFacetPropertyItemViewCapture: the row of one annotation view or capture. The
// view or capture, its set's owner and its set are host objects held weakly; the label
// "view/owner/set" is rebuilt each time it is read.
#include "QelRovFacetPropertyItem.h"

class QelRovFacetPropertyItemViewCapture : public QelRovFacetPropertyItem {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelRovFacetPropertyItemViewCapture(QelBaseUnknown* viewOrCapture, QelBaseUnknown* ownerObject,
                                     QelBaseUnknown* set, QelBaseUnknown* group);

  HRESULT ApplyCheckState() override;
  // E_UNEXPECTED with an empty label when the view or capture has no alias.
  HRESULT UpdateName() override;

 protected:
  ~QelRovFacetPropertyItemViewCapture() override;

 private:
  QelBaseUnknown_WR ownerObject_;
  QelBaseUnknown_WR set_;
};
