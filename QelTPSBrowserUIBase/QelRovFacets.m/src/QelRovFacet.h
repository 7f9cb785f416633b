#pragma once
// QelRovFacet: one section of the data filtering panel, a list of top-level properties
// in display order. The facet holds its properties through that list and its facet
// group weakly; it is the observer of its top-level properties, keeps its radio choices
// exclusive and turns an applied change into the facet's display requests.
#include "QelBaseUnknown_WR.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMetaObject.h"
#include "QelUnicodeString.h"

class QelRovFacetGroup;
class QelRovFacetPropertyGroup;
class QelRovFacetProperty;

class QelRovFacet : public virtual QelBaseUnknown {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // Sets the facet's default check states and rebuilds its dynamic properties.
  virtual void Refresh() = 0;
  // Rebuilds the dynamic properties only, keeping the check states of the top-level
  // ones; the facet group calls it when the sets' load mode changed.
  virtual void Rebuild() {}
  // Copies the top-level properties into `properties`, which must be empty.
  virtual HRESULT GetProperties(QelListValQelBaseUnknown_var& properties);
  // Turns a change of one of the facet's properties into display requests. S_OK: the
  // change took effect and the facet group must be told; anything else: it must not.
  virtual HRESULT ApplyPropertyChange(QelBaseUnknown* property) = 0;

  // Null (after a null-handler report) when the group is gone; null too when the owner
  // is not a facet group.
  QelVar<QelRovFacetGroup> GetFacetGroup() const;
  // E_FAIL with an empty text while the facet has no name.
  HRESULT GetFacetName(QelUnicodeString& name) const;
  HRESULT GetExpandedFlag(bool& expanded) const;
  HRESULT SetExpandedFlag(bool expanded);

  // Observer operations, forwarded by each concrete facet's tie. Only the annotation set
  // facet vetoes; it overrides CanChangeCheckState.
  virtual HRESULT CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState);
  virtual HRESULT OnPropertyChanged(QelBaseUnknown* property);

 protected:
  explicit QelRovFacet(QelBaseUnknown* group);
  ~QelRovFacet() override;

  QelListValQelBaseUnknown_var& PropertyList() { return properties_; }
  // The group's weak reference as the group's look-ups take it; resolving it through
  // GetFacetGroup would report a gone group a second time.
  const QelBaseUnknown_WR& FacetGroupRef() const { return group_; }
  // The top-level property at `position` (1-based); null, after a report, when the entry
  // is not a property.
  QelRovFacetProperty* PropertyAt(int position) const;
  // The property group at `position` (1-based), or null after a pointer assertion naming
  // "QelRovFacetPropertyGroup".
  QelRovFacetPropertyGroup* PropertyGroupAt(int position) const;
  void SetFacetName(const QelUnicodeString& name) { name_ = name; }

 private:
  QelListValQelBaseUnknown_var properties_;
  QelBaseUnknown_WR group_;
  QelUnicodeString name_;
  bool expanded_ = true;
};
