#pragma once
// A facet group over a model made in code, for the tests of the concrete facets: the
// editor, a display-change log by alias ("+Name" shown, "-Name" hidden), and a facet
// that stands in for the other facets of the group and counts their refreshes.
#include <string>
#include <vector>

#include "FacetTestDoubles.h"
#include "QelApplicationFrame.h"
#include "QelFrmEditor.h"
#include "QelRovFacetFilterData.h"

struct FacetModel {
  // `root` may be null: an editor without a root object.
  explicit FacetModel(const QelBaseUnknown_var& root);
  ~FacetModel();

  // Sets the editor's UI-active path to `objects`, root first.
  void SetUIActive(const std::vector<QelBaseUnknown*>& objects);
  // The log since the last call.
  std::vector<std::string> TakeChanges();

  QelBaseUnknown_var root;
  QelVar<QelFrmEditor> editor;
  QelVar<TestFacetGroup> group;
  QelVar<QelRovFacetFilterData> filter = Make<QelRovFacetFilterData>();
  QelVar<TestFacet> other;
  std::vector<std::string> changes;
  QelCallbackId callback = 0;
};

QelRovFacetProperty* PropertyOf(QelRovFacet* facet, int position);
std::string LabelOf(QelBaseUnknown* property);
// The labels of a group's children, in order.
std::vector<std::string> ChildLabels(QelBaseUnknown* group);
bool Shown(const QelBaseUnknown_var& object);
