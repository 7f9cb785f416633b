#pragma once
// QelRovFacetReview: answers QelIRovFacetReview over one facet group, which it owns. The
// facets are reached through the group only, so that the group's dependent refresh keeps
// every listing true.
#include "QelIRovFacetReview.h"
#include "QelMetaObject.h"

class QelRovFacetGroup;
class QelRovFacetProperty;

class QelRovFacetReview : public QelIRovFacetReview {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // The named creator of the component dictionary: a new reference.
  static QelBaseUnknown* Create();

  HRESULT Open(QelBaseUnknown* editor) override;
  HRESULT ListRows(std::vector<Row>& facets) override;
  HRESULT Click(QelBaseUnknown* property, bool checked) override;
  HRESULT PrintWidgets(std::string& text, bool json) override;

 protected:
  QelRovFacetReview() = default;
  ~QelRovFacetReview() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelVar<QelRovFacetGroup> group_;
};
