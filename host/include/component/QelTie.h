#pragma once
// QelTie<I>: base of the ties, the counted forwarding objects through which a class
// implements an interface without deriving from it. A tie holds one reference to its
// implementation; it answers its own interface and passes every other query on.
//
//   class TieObserverOfFacet final : public QelTie<QelIRovFacetPropertyObserver> {
//     using QelTie::QelTie;
//     HRESULT OnPropertyChanged(QelBaseUnknown* p) override { return Impl<QelRovFacet>()->OnPropertyChanged(p); }
//   };
#include "QelVar.h"

template <class I>
class QelTie : public I {
 public:
  explicit QelTie(QelBaseUnknown* impl) : impl_(QelBaseUnknown_var::Retain(impl ? impl->GetImpl() : nullptr)) {}

  QelBaseUnknown* GetImpl() override { return impl_.get(); }
  const QelMetaObject* GetMetaObject() const override { return impl_->GetMetaObject(); }
  const char* GetLateType() const override { return impl_->GetLateType(); }
  HRESULT QueryInterface(const QelIID& iid, void** out) override {
    if (void* mine = QueryDirect(iid)) {
      this->AddRef();
      *out = mine;
      return S_OK;
    }
    return impl_->QueryInterface(iid, out);
  }

 protected:
  ~QelTie() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (iid == I::IID) return static_cast<I*>(this);
    if (iid == QelBaseUnknown::IID) return static_cast<QelBaseUnknown*>(this);
    return nullptr;
  }
  template <class C>
  C* Impl() const { return dynamic_cast<C*>(impl_.get()); }

 private:
  QelBaseUnknown_var impl_;
};

// The factory of a tie class, as the dictionary stores it.
template <class Tie>
QelBaseUnknown* QelCreateTie(QelBaseUnknown* impl) {
  return impl ? new Tie(impl) : nullptr;
}
