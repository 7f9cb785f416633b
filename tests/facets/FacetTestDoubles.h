#pragma once
// Test doubles of the facet model: a recording observer, a leaf property whose display
// is a field, and a facet whose change handling is scripted. Every apply is written to a
// shared log so tests can check which properties were applied, and in what order.
#include <string>
#include <vector>

#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacet.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetProperty.h"

using ApplyLog = std::vector<std::string>;

class RecordingObserver : public QelIRovFacetPropertyObserver {
 public:
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) override;
  HRESULT OnPropertyChanged(QelBaseUnknown* object) override;

  HRESULT answer = S_OK;
  std::vector<QelCheckState> asked;
  std::vector<QelBaseUnknown*> changed;

 protected:
  ~RecordingObserver() override = default;
  void* QueryDirect(const QelIID& iid) override;
};

class TestProperty : public QelRovFacetProperty {
 public:
  TestProperty(const char* name, QelBaseUnknown* owner, ApplyLog* log = nullptr)
      : QelRovFacetProperty(QelUnicodeString(name), QelUnicodeString(), owner), name_(name), log_(log) {}

  HRESULT ApplyCheckState() override;
  // Copies `display` into the state unless left out (refreshAnswer S_FALSE).
  HRESULT RefreshCheckState() override;
  int32_t CountItems() override { return items; }

  QelCheckState display = Unchecked;
  HRESULT applyAnswer = S_OK;
  HRESULT refreshAnswer = S_OK;
  int32_t items = 1;

 protected:
  ~TestProperty() override = default;

 private:
  std::string name_;
  ApplyLog* log_;
};

class TestFacet : public QelRovFacet {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  explicit TestFacet(QelBaseUnknown* group) : QelRovFacet(group) {}
  void Add(QelBaseUnknown* property) { PropertyList().Append(property); }
  void Remove(QelBaseUnknown* property) { PropertyList().RemoveValue(property); }
  void Name(const char* name) { SetFacetName(QelUnicodeString(name)); }

  void Refresh() override { ++refreshes; }
  void Rebuild() override { ++rebuilds; }
  HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState state) override {
    return veto == S_OK ? QelRovFacet::CanChangeCheckState(property, state) : veto;
  }
  HRESULT ApplyPropertyChange(QelBaseUnknown* property) override {
    applied.push_back(property);
    return applyAnswer;
  }

  HRESULT applyAnswer = S_OK;
  HRESULT veto = S_OK;  // what CanChangeCheckState answers when not S_OK
  int refreshes = 0;
  int rebuilds = 0;
  std::vector<QelBaseUnknown*> applied;

 protected:
  ~TestFacet() override = default;
};

// A facet group whose facets and filter data are given by the test.
class TestFacetGroup : public QelRovFacetGroup {
 public:
  using QelRovFacetGroup::QelRovFacetGroup;
  using QelRovFacetGroup::SetFacets;

 protected:
  ~TestFacetGroup() override = default;
};

template <class T, class... Args>
QelVar<T> Make(Args&&... args) {
  return QelMakeVar<T>(std::forward<Args>(args)...);
}
