#include "QelRovFacetReview.h"

#include "QelAssert.h"
#include "QelFrmEditor.h"
#include "QelRovFacet.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetProperty.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovRefinementFacet.h"
#include "QelVidLayGrid.h"
#include "QelVidWidgetPrinter.h"

namespace {
// The facet group with a public way in; the group itself keeps its destructor protected.
class ReviewFacetGroup final : public QelRovFacetGroup {
 public:
  using QelRovFacetGroup::QelRovFacetGroup;

 private:
  ~ReviewFacetGroup() override = default;
};

// The root the facet widgets are printed from, as the panel's dialog holds them.
class ReviewPanel final : public QelVidWidget {
 public:
  ReviewPanel() : QelVidWidget(nullptr, QelString("Panel")) {}

 private:
  ~ReviewPanel() override = default;
};

QelIRovFacetReview::Kind KindOf(QelRovFacetProperty* property) {
  using Kind = QelIRovFacetReview::Kind;
  const int32_t flags = property->GetFlags();
  if (flags & QelRovFacetProperty::FlagValueRange) return Kind::Range;
  if (flags & QelRovFacetProperty::FlagRadio) return Kind::Radio;
  if (QelSysDynamicCast<QelRovFacetPropertyGroup>(property)) return Kind::Group;
  return Kind::CheckBox;
}

void AddRow(std::vector<QelIRovFacetReview::Row>& rows, const QelBaseUnknown_var& object) {
  auto* property = QelSysDynamicCast<QelRovFacetProperty>(object.get());
  if (!property || !property->GetVisibleFlag()) return;
  QelIRovFacetReview::Row row;
  QelUnicodeString label;
  property->GetName(label);
  row.label = label.Utf8();
  row.kind = KindOf(property);
  row.state = property->GetCheckState();
  row.property = object;
  QelListValQelBaseUnknown_var children;
  if (property->GetChildren(children) == S_OK)
    for (const auto& child : children) AddRow(row.children, child);
  rows.push_back(std::move(row));
}
}  // namespace

const QelMetaObject& QelRovFacetReview::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelRovFacetReview", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetReview::GetMetaObject() const { return &MetaObject(); }

QelBaseUnknown* QelRovFacetReview::Create() { return new QelRovFacetReview(); }

QelRovFacetReview::~QelRovFacetReview() = default;

void* QelRovFacetReview::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIRovFacetReview>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelRovFacetReview::Open(QelBaseUnknown* editor) {
  auto* frmEditor = QelSysDynamicCast<QelFrmEditor>(editor);
  if (!frmEditor) {
    QelAssertPointer("QelFrmEditor");
    return E_UNEXPECTED;
  }
  group_ = QelMakeVar<ReviewFacetGroup>(frmEditor);
  return group_->InitFacets();
}

HRESULT QelRovFacetReview::ListRows(std::vector<Row>& facets) {
  facets.clear();
  if (!group_) return E_FAIL;
  QelListValQelBaseUnknown_var list;
  if (group_->ListFacets(list) != S_OK) return E_UNEXPECTED;
  for (const auto& entry : list) {
    auto* facet = QelSysDynamicCast<QelRovFacet>(entry.get());
    if (!facet) continue;
    Row row;
    row.kind = Kind::Facet;
    QelUnicodeString name;
    facet->GetFacetName(name);
    row.label = name.Utf8();
    QelListValQelBaseUnknown_var properties;
    facet->GetProperties(properties);
    for (const auto& property : properties) AddRow(row.children, property);
    facets.push_back(std::move(row));
  }
  return S_OK;
}

HRESULT QelRovFacetReview::Click(QelBaseUnknown* property, bool checked) {
  auto* clicked = QelSysDynamicCast<QelRovFacetProperty>(property);
  if (!clicked) {
    QelAssertPointer("QelRovFacetProperty");
    return E_UNEXPECTED;
  }
  // A click may rebuild the row's own group away; keep it until the click is done.
  QelBaseUnknown_var hold(property);
  return clicked->SetCheck(checked);
}

HRESULT QelRovFacetReview::PrintWidgets(std::string& text, bool json) {
  text.clear();
  if (!group_) return E_FAIL;
  QelListValQelBaseUnknown_var facets;
  if (group_->ListFacets(facets) != S_OK) return E_UNEXPECTED;
  auto panel = QelMakeVar<ReviewPanel>();
  auto grid = QelMakeVar<QelVidLayGrid>(panel.get(), QelString("DialogGrid"));
  panel->AddChild(grid.get());
  int row = 0;
  for (const auto& facet : facets) {
    auto widget = QelMakeVar<QelRovRefinementFacet>(panel.get(), QelString("Facet" + std::to_string(row)), facet.get());
    if (QelFailed(widget->BuildPropertyWidgets())) continue;
    grid->AddWidget(widget.get(), {0, row++, 1, 1, 1, 1, 1, 0});
  }
  text = json ? QelVidPrintJson(panel.get()) + "\n" : QelVidPrintText(panel.get());
  return S_OK;
}
