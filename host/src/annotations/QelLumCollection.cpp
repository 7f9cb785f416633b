#include "QelLumCollection.h"

#include "QelMetaObject.h"

const QelMetaObject& QelLumCollection::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumCollection", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumCollection::GetMetaObject() const { return &MetaObject(); }

QelLumCollection::~QelLumCollection() = default;

void* QelLumCollection::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelILumCollection>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

QelVar<QelILumCollection> QelLumCollection::FromLinks(const std::vector<QelBaseUnknown_WR>& links) {
  auto* made = new QelLumCollection();
  made->items_.reserve(links.size());
  for (const auto& link : links) {
    if (QelBaseUnknown_var item = link.Get()) made->items_.push_back(std::move(item));
  }
  return QelVar<QelILumCollection>::Adopt(made);
}

HRESULT QelLumCollection::GetCount(uint32_t& count) {
  count = static_cast<uint32_t>(items_.size());
  return S_OK;
}

HRESULT QelLumCollection::GetItem(uint32_t index, QelBaseUnknown_var& item) {
  if (index >= items_.size()) {
    item = nullptr;
    return E_FAIL;
  }
  item = items_[index];
  return S_OK;
}
