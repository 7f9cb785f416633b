#pragma once
// QelIRovFacetReview: the facets of one editor as a host program without widgets reads
// and clicks them (a terminal session, a script). Made by name ("QelRovFacetReview")
// through the component dictionary; it holds the facet group it opens, and the rows it
// hands out hold their properties, so a row stays clickable while it is kept.
#include <string>
#include <vector>

#include "QelStatus.h"
#include "QelVar.h"

class QelIRovFacetReview : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelIRovFacetReview;
  static constexpr QelIID IID = QelIID::Parse("{6D1C3E2A-8B47-4F0E-9A53-2C7B1E4F8D90}");

  enum class Kind { Facet, Radio, CheckBox, Group, Range };
  struct Row {
    std::string label;
    Kind kind = Kind::CheckBox;
    QelCheckState state = Unchecked;
    QelBaseUnknown_var property;  // null for a facet row
    std::vector<Row> children;    // the rows a panel shows under this one
  };

  // Makes the facet group of `editor` (a QelFrmEditor) with its facets, refreshed. A
  // second call replaces the group.
  virtual HRESULT Open(QelBaseUnknown* editor) = 0;
  // One row per facet, in panel order; rows without a place in the panel are left out.
  virtual HRESULT ListRows(std::vector<Row>& facets) = 0;
  // The user's click on a row: S_OK when the state changed, S_FALSE when it already was
  // so, E_FAIL when refused (a refused confirmation).
  virtual HRESULT Click(QelBaseUnknown* property, bool checked) = 0;
  // The panel's facet widgets, built over the facets as they are now and printed as a
  // person sees them (text) or as JSON.
  virtual HRESULT PrintWidgets(std::string& text, bool json) = 0;

 protected:
  ~QelIRovFacetReview() override = default;
};
