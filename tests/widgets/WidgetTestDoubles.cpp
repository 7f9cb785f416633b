#include "WidgetTestDoubles.h"

#include "QelSYPMetaClass.h"
#include "QelSYPWRefMethEventHandler.h"

HRESULT RecordingFacet::ApplyPropertyChange(QelBaseUnknown* property) {
  if (auto* p = QelSysDynamicCast<QelRovFacetProperty>(property)) statesAtApply.push_back(p->GetCheckState());
  return TestFacet::ApplyPropertyChange(property);
}

RebuildingPanel::RebuildingPanel(std::vector<QelBaseUnknown*> facets) : QelVidWidget(nullptr, QelString("Panel")) {
  for (QelBaseUnknown* facet : facets) facets_.emplace_back(facet);
  grid_ = QelMakeVar<QelVidLayGrid>(this, QelString("DialogGrid"));
  AddChild(grid_.get());
}

void RebuildingPanel::Rebuild() {
  while (grid_->GetChildCount() > 0) grid_->RemoveWidget(grid_->GetChild(0));
  int row = 0;
  for (size_t i = 0; i < facets_.size(); ++i) {
    auto widget = QelMakeVar<QelRovRefinementFacet>(this, QelString("Facet" + std::to_string(i)), facets_[i].get());
    if (QelFailed(widget->BuildPropertyWidgets())) continue;
    QelSYPWRefMethEventHandler<RebuildingPanel>::Connect(widget.get(), QelRovRefinementFacet::SendFacetEvent(), this,
                                                         &RebuildingPanel::OnFacetEvent);
    grid_->AddWidget(widget.get(), {0, row++, 1, 1, 1, 1, 1, 0});
  }
  ++rebuilds;
}

void RebuildingPanel::OnFacetEvent(QelBaseUnknown*, QelSYPEventArgs*) { Rebuild(); }

QelRovRefinementFacet* RebuildingPanel::FacetWidget(int index) const {
  auto in = grid_->GetWidgetsInRow(index);
  return in.empty() ? nullptr : dynamic_cast<QelRovRefinementFacet*>(in[0]);
}

void PanelTest::SetUp() {
  group = Make<TestFacetGroup>(nullptr);
  facet = Make<RecordingFacet>(group.get());
  facet->Name("Types");
  filter = Make<QelRovFacetFilterData>();
  group->SetFacets(facet.get(), facet.get(), nullptr, filter.get());
  capture.Clear();  // the group's null editor
}

QelVar<TestProperty> PanelTest::Add(const char* name, int32_t flags) {
  auto property = Make<TestProperty>(name, facet.get());
  property->SetFlags(flags);
  if (flags & QelRovFacetProperty::FlagValueRange) property->SetRangeMode(3);
  facet->Add(property.get());
  return property;
}

QelVar<QelRovRefinementFacet> PanelTest::Build() {
  auto widget = Make<QelRovRefinementFacet>(nullptr, QelString("Facet0"), facet.get());
  EXPECT_EQ(widget->BuildPropertyWidgets(), S_OK);
  return widget;
}

QelRovRefinementProperty* PanelTest::Row(QelRovRefinementFacet* widget, int row) {
  if (!widget || !widget->GetGrid()) return nullptr;
  for (QelVidWidget* w : widget->GetGrid()->GetWidgetsInRow(row))
    if (auto* p = dynamic_cast<QelRovRefinementProperty*>(w)) return p;
  return nullptr;
}

QelSYPValue PanelTest::Read(QelVidWidget* widget, const char* property) {
  QelSYPValue value;
  const QelSYPMetaClass* meta = widget ? widget->GetSYPMetaClass() : nullptr;
  if (meta) meta->GetProperty(widget, property, value);
  return value;
}
