#pragma once
// QelRovFacetPropertyItemAnnotSet: the row of one annotation set. Its label joins the
// aliases of the objects the set's owner references, the owner and the set; set, owner
// and references are host objects the item only names, so the set and owner are held
// weakly and the references through the list the facet gave.
#include "QelRovFacetPropertyItem.h"

class QelRovFacetPropertyItemAnnotSet : public QelRovFacetPropertyItem {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelRovFacetPropertyItemAnnotSet(QelBaseUnknown* set, QelBaseUnknown* ownerObject,
                                  const QelListValQelBaseUnknown_var& references, QelBaseUnknown* group);

  HRESULT ApplyCheckState() override;
  // "ref1, ref2/owner/set": a missing part drops together with its separator.
  HRESULT UpdateName() override;

 protected:
  ~QelRovFacetPropertyItemAnnotSet() override;

 private:
  QelBaseUnknown_WR ownerObject_;
  QelListValQelBaseUnknown_var references_;
};
