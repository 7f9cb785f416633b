#pragma once
// QelLumCollection: a snapshot collection handed out by the annotation layer: it holds a
// reference to each item for its own lifetime and gives each item with a new reference.
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelILumCollection.h"

class QelLumCollection : public QelILumCollection {
 public:
  QelLumCollection() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // A new collection of the objects still alive among `links`.
  static QelVar<QelILumCollection> FromLinks(const std::vector<QelBaseUnknown_WR>& links);
  template <class T>
  static QelVar<QelILumCollection> FromHandles(const std::vector<QelVar<T>>& handles) {
    auto* made = new QelLumCollection();
    made->items_.reserve(handles.size());
    for (const auto& h : handles) made->items_.emplace_back(static_cast<QelBaseUnknown*>(h.get()));
    return QelVar<QelILumCollection>::Adopt(made);
  }

  HRESULT GetCount(uint32_t& count) override;
  HRESULT GetItem(uint32_t index, QelBaseUnknown_var& item) override;

 protected:
  ~QelLumCollection() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  std::vector<QelBaseUnknown_var> items_;
};
