#include "FacetTestDoubles.h"

#include "QelDictionary.h"
#include "QelTie.h"

HRESULT RecordingObserver::CanChangeCheckState(QelBaseUnknown*, QelCheckState newState) {
  asked.push_back(newState);
  return answer;
}

HRESULT RecordingObserver::OnPropertyChanged(QelBaseUnknown* object) {
  changed.push_back(object);
  return S_OK;
}

void* RecordingObserver::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIRovFacetPropertyObserver>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT TestProperty::ApplyCheckState() {
  if (log_) log_->push_back(name_ + (GetCheckState() == Checked ? "+" : "-"));
  display = GetCheckState();
  return applyAnswer;
}

HRESULT TestProperty::RefreshCheckState() {
  if (refreshAnswer == S_OK) SetCheckState(display);
  return refreshAnswer;
}

const QelMetaObject& TestFacet::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("TestFacet", QelMetaKind::Implementation, &QelRovFacet::MetaObject(), "tests");
  return meta;
}

namespace {
// The test facet answers the observer interface through a tie, as the real facets do.
class TieObserverTestFacet final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  // Through the base class, as a tie written for any facet would call it.
  HRESULT CanChangeCheckState(QelBaseUnknown* p, QelCheckState s) override {
    return Impl<QelRovFacet>()->CanChangeCheckState(p, s);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* p) override { return Impl<QelRovFacet>()->OnPropertyChanged(p); }

 private:
  ~TieObserverTestFacet() override = default;
};

const bool registered = [] {
  QelDictionary::Get().Register("TestFacet", QelIRovFacetPropertyObserver::IID,
                                &QelCreateTie<TieObserverTestFacet>, "tests");
  return true;
}();
}  // namespace
