#include "QelRovFacetView.h"

#include <vector>

#include "QelAnnotationComponents.h"
#include "QelAssert.h"
#include "QelILumCapture.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelITPSSet.h"
#include "QelITPSView.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetPropertyItemViewCapture.h"
#include "QelRovFacetServices.h"

namespace {
constexpr const char* kCatalog = "QelRovLumFacets";
constexpr int kSetComponent = 62;
constexpr int kPropertyCount = 2;
constexpr int kAll = 1;
constexpr int kCustom = 2;

QelUnicodeString Label(const char* key) { return QelMsgCatalog::BuildMessage(kCatalog, key); }

// The set holding a view or capture: a capture hands out its set side, which leads to the
// set; a view hands out the set itself.
QelVar<QelILumSet> SetOf(QelILumCapture* capture, QelITPSView* view) {
  QelBaseUnknown_var object;
  if (capture) {
    QelBaseUnknown_var first;
    capture->GetSet(first);
    QelVar<QelITPSSet> setSide(first.get());
    object = QelBaseUnknown_var(setSide.get());
  } else {
    view->GetSet(object);
  }
  return QelVar<QelILumSet>(object.get());
}
}  // namespace

const QelMetaObject& QelRovFacetView::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelRovFacetView", QelMetaKind::Implementation,
                                                            &QelRovFacet::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetView::GetMetaObject() const { return &MetaObject(); }

QelRovFacetView::QelRovFacetView(QelBaseUnknown* group) : QelRovFacet(group) {
  SetFacetName(Label("AnnotationView"));
  QelBaseUnknown* self = this;
  auto all = QelMakeVar<QelRovFacetPropertyItem>(Label("AnnotationView.All"), self);
  PropertyList().Append(static_cast<QelBaseUnknown*>(all.get()));
  all->SetCheckState(Unchecked);
  all->SetFlags(QelRovFacetProperty::FlagsRadio);
  auto custom = QelMakeVar<QelRovFacetPropertyGroup>(Label("AnnotationView.Custom"), QelUnicodeString(), self, true);
  PropertyList().Append(static_cast<QelBaseUnknown*>(custom.get()));
  custom->SetCheckState(Checked);
  custom->SetFlags(QelRovFacetProperty::FlagsRadio);
}

QelRovFacetView::~QelRovFacetView() = default;

void QelRovFacetView::Refresh() {
  QelRovFacetProperty* all = PropertyAt(kAll);
  if (!all) return;
  all->SetCheckState(Unchecked);
  Rebuild();
}

void QelRovFacetView::Rebuild() {
  auto* custom = PropertyGroupAt(kCustom);
  if (!custom) return;
  custom->RemoveAllProperties();
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (root) BuildViewCaptureItems(root.get());
}

HRESULT QelRovFacetView::BuildViewCaptureItems(QelBaseUnknown* root) {
  if (!root) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("2 properties");
    return E_UNEXPECTED;
  }
  auto* custom = PropertyGroupAt(kCustom);
  if (!custom) return E_UNEXPECTED;
  custom->RemoveAllProperties();
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kSetComponent, made);
  QelVar<QelILumSetComponent> component(made.get());
  if (!component) {
    QelAssertPointer("QelILumSetComponent");
    return E_UNEXPECTED;
  }
  QelListValQelBaseUnknown_var objects;
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root, objects);
  std::vector<QelBaseUnknown_var> captures;
  std::vector<QelBaseUnknown_var> views;
  QelBaseUnknown* group = custom;
  for (const QelBaseUnknown_var& object : objects) {
    QelVar<QelILumCapture> capture(object.get());
    QelVar<QelITPSView> view(object.get());
    if (!capture && !view) {
      QelAssertBool("QelILumCapture or QelITPSView");
      continue;
    }
    QelVar<QelILumSet> set = SetOf(capture.get(), view.get());
    if (!set) {
      QelAssertNullHandler();
      continue;
    }
    QelBaseUnknown_var owner;
    component->GetSetOwner(set.get(), owner);
    auto item = QelMakeVar<QelRovFacetPropertyItemViewCapture>(object.get(), owner.get(), set.get(), group);
    (capture ? captures : views).emplace_back(static_cast<QelBaseUnknown*>(item.get()));
  }
  component = nullptr;
  for (const auto& item : captures) custom->AddProperty(item.get());
  for (const auto& item : views) custom->AddProperty(item.get());
  custom->UpdateSelectAllState();
  return S_OK;
}

HRESULT QelRovFacetView::ApplyPropertyChange(QelBaseUnknown* property) {
  if (!property) {
    QelAssertPointer("property");
    return E_UNEXPECTED;
  }
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("2 properties");
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  QelBaseUnknown* all = PropertyList()[kAll].get();
  if (all && all->IsEqual(property) && root) {
    QelListValQelBaseUnknown_var objects;
    QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root.get(), objects);
    QelRovFacetServices::EnableDisableDisplay(objects, 1, nullptr);
  }
  return S_OK;
}
