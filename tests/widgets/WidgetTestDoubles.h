#pragma once
// Doubles for the panel widgets: a property with an icon, a facet that records the check
// state of each property it applies, a panel that rebuilds its facet widgets on every
// SendFacetEvent as the dialog does, and a fixture with one facet in a facet group that
// has filter data.
#include <gtest/gtest.h>

#include "FacetTestDoubles.h"
#include "QelAssert.h"
#include "QelRovFacetFilterData.h"
#include "QelRovRefinementFacet.h"
#include "QelRovRefinementProperty.h"
#include "QelVidLayGrid.h"

class IconProperty : public TestProperty {
 public:
  IconProperty(const char* name, QelBaseUnknown* owner, const char* icon) : TestProperty(name, owner) {
    SetIconName(QelUnicodeString(icon));
  }

 protected:
  ~IconProperty() override = default;
};

class RecordingFacet : public TestFacet {
 public:
  using TestFacet::TestFacet;
  HRESULT ApplyPropertyChange(QelBaseUnknown* property) override;
  // The property's check state at each apply.
  std::vector<QelCheckState> statesAtApply;

 protected:
  ~RecordingFacet() override = default;
};

// The dialog's part of the road of a click: on each facet widget's SendFacetEvent it
// drops every facet widget and builds them again from the facets.
class RebuildingPanel : public QelVidWidget {
 public:
  explicit RebuildingPanel(std::vector<QelBaseUnknown*> facets);
  void Rebuild();
  void OnFacetEvent(QelBaseUnknown* origin, QelSYPEventArgs* args);
  QelRovRefinementFacet* FacetWidget(int index) const;
  int rebuilds = 0;

 protected:
  ~RebuildingPanel() override = default;

 private:
  std::vector<QelBaseUnknown_var> facets_;
  QelVar<QelVidLayGrid> grid_;
};

class PanelTest : public ::testing::Test {
 protected:
  void SetUp() override;
  QelVar<TestProperty> Add(const char* name, int32_t flags = QelRovFacetProperty::FlagsCheckBox);
  QelVar<QelRovRefinementFacet> Build();
  // The property widget in `row` of a facet widget's grid.
  static QelRovRefinementProperty* Row(QelRovRefinementFacet* widget, int row);
  static QelSYPValue Read(QelVidWidget* widget, const char* property);

  QelAssertionCapture capture;
  QelVar<TestFacetGroup> group;
  QelVar<RecordingFacet> facet;
  QelVar<QelRovFacetFilterData> filter;
};
