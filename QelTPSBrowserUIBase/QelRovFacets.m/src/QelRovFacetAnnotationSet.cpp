#include "QelRovFacetAnnotationSet.h"

#include <unordered_set>

#include "QelAnnotationComponents.h"
#include "QelApplicationFrame.h"
#include "QelAssert.h"
#include "QelDlgNotify.h"
#include "QelFrmEditor.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelIPLMNavOccurrence.h"
#include "QelIPLMNavRepInstance.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetPropertyItemAnnotSet.h"
#include "QelRovFacetServices.h"

namespace {
constexpr const char* kCatalog = "QelRovLumFacets";
constexpr int kSetComponent = 62;
constexpr int kPropertyCount = 4;
constexpr int kAll = 1;
constexpr int kRoot = 2;
constexpr int kCustom = 3;
constexpr int kNone = 4;
constexpr int kConfirmStyle = QelDlgNotify::StyleModal | QelDlgNotify::StyleYesNo;

QelUnicodeString Label(const char* key) { return QelMsgCatalog::BuildMessage(kCatalog, key); }
}  // namespace

const QelMetaObject& QelRovFacetAnnotationSet::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovFacetAnnotationSet", QelMetaKind::Implementation, &QelRovFacet::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetAnnotationSet::GetMetaObject() const { return &MetaObject(); }

QelRovFacetAnnotationSet::QelRovFacetAnnotationSet(QelBaseUnknown* group) : QelRovFacet(group) {
  SetFacetName(Label("AnnotationSet"));
  QelBaseUnknown* self = this;
  auto all = QelMakeVar<QelRovFacetPropertyItem>(Label("AnnotationSet.All"), self);
  auto root = QelMakeVar<QelRovFacetPropertyItem>(Label("AnnotationSet.Root"), self);
  auto custom = QelMakeVar<QelRovFacetPropertyGroup>(Label("AnnotationSet.Custom"), QelUnicodeString(), self, true);
  auto none = QelMakeVar<QelRovFacetPropertyItem>(Label("AnnotationSet.None"), self);
  for (QelRovFacetProperty* property : {static_cast<QelRovFacetProperty*>(all.get()),
                                        static_cast<QelRovFacetProperty*>(root.get()),
                                        static_cast<QelRovFacetProperty*>(custom.get()),
                                        static_cast<QelRovFacetProperty*>(none.get())}) {
    PropertyList().Append(static_cast<QelBaseUnknown*>(property));
    property->SetFlags(QelRovFacetProperty::FlagsRadio);
  }
}

QelRovFacetAnnotationSet::~QelRovFacetAnnotationSet() = default;

bool QelRovFacetAnnotationSet::IsProperty(int position, QelBaseUnknown* property) const {
  QelBaseUnknown* entry = const_cast<QelRovFacetAnnotationSet*>(this)->PropertyList()[position].get();
  return entry && property && entry->IsEqual(property);
}

void QelRovFacetAnnotationSet::Refresh() {
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("4 properties");
    return;
  }
  constexpr QelCheckState defaults[kPropertyCount] = {Unchecked, Unchecked, Checked, Unchecked};
  for (int position = 1; position <= kPropertyCount; ++position) {
    QelRovFacetProperty* property = PropertyAt(position);
    if (!property) continue;
    property->SetCheckState(defaults[position - 1]);
    if (position == kRoot) UpdateRootVisibility(property);
  }
  Rebuild();
}

void QelRovFacetAnnotationSet::UpdateRootVisibility(QelRovFacetProperty* rootChoice) {
  QelVar<QelRovFacetGroup> group = GetFacetGroup();
  if (!group) return;
  QelFrmEditor* editor = group->GetEditor();
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return;
  }
  QelVar<QelPathElement> path = editor->GetUIActivePath();
  path->InitToLeafElement();
  QelBaseUnknown_var element = path->NextFatherElement();
  if (!QelVar<QelIPLMNavOccurrence>(element.get())) {
    rootChoice->SetVisibleFlag(false);
    return;
  }
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) rootChoice->SetVisibleFlag(false);
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListARMOrDirectSets(root.get(), sets, false);
  rootChoice->SetVisibleFlag(sets.Size() != 0);
}

void QelRovFacetAnnotationSet::Rebuild() {
  QelRovFacetPropertyGroup* custom = PropertyGroupAt(kCustom);
  if (!custom) return;
  custom->RemoveAllProperties();
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) return;
  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root.get(), sets, false);
  BuildSetItems(sets, custom);
}

HRESULT QelRovFacetAnnotationSet::BuildSetItems(const QelListValQelBaseUnknown_var& sets,
                                                QelRovFacetPropertyGroup* group) {
  if (!group) {
    QelAssertPointer("QelRovFacetPropertyGroup");
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kSetComponent, made);
  QelVar<QelILumSetComponent> component(made.get());
  if (!component) {
    QelAssertPointer("QelILumSetComponent");
    return E_UNEXPECTED;
  }
  // Sets that already have a row, by implementation identity, so that no set is
  // compared with every row.
  std::unordered_set<const QelBaseUnknown*> present;
  const QelListValQelBaseUnknown_var& children = group->GetPropertyList();
  for (int i = 1; i <= children.Size(); ++i) {
    auto* item = QelSysDynamicCast<QelRovFacetPropertyItemAnnotSet>(children[i].get());
    if (!item) {
      QelAssertPointer("QelRovFacetPropertyItemAnnotSet");
      continue;
    }
    if (QelBaseUnknown_var set = item->GetObject()) present.insert(set->GetImpl());
  }
  for (const QelBaseUnknown_var& entry : sets) {
    QelVar<QelILumSet> set(entry.get());
    if (!set) {
      QelAssertNullHandler();
      continue;
    }
    if (!present.insert(set->GetImpl()).second) continue;
    QelBaseUnknown_var owner;
    component->GetSetOwner(entry.get(), owner);
    if (!owner) {
      QelAssertNullHandler();
      continue;
    }
    QelListValQelBaseUnknown_var instances;
    component->ListRepInstances(owner.get(), instances);
    QelListValQelBaseUnknown_var references;
    for (const QelBaseUnknown_var& object : instances) {
      QelVar<QelIPLMNavRepInstance> instance(object.get());
      if (!instance) {
        QelAssertNullHandler();
        continue;
      }
      QelBaseUnknown_var referenced = instance->GetReferencedObject();
      if (!referenced) {
        QelAssertNullHandler();
        continue;
      }
      references.Append(referenced);
    }
    auto item = QelMakeVar<QelRovFacetPropertyItemAnnotSet>(entry.get(), owner.get(), references,
                                                            static_cast<QelBaseUnknown*>(group));
    group->AddProperty(static_cast<QelBaseUnknown*>(item.get()));
  }
  group->UpdateSelectAllState();
  return S_OK;
}

HRESULT QelRovFacetAnnotationSet::ApplyPropertyChange(QelBaseUnknown* property) {
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("4 properties");
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) return S_FALSE;
  QelListValQelBaseUnknown_var sets;
  if (IsProperty(kAll, property)) {
    QelRovFacetServices::ListAllSets(root.get(), sets, true);
    QelRovFacetServices::EnableDisableDisplay(sets, 1, nullptr);
    QelRovFacetPropertyGroup* custom = PropertyGroupAt(kCustom);
    if (!custom) return E_UNEXPECTED;
    QelBaseUnknown_var groupObject = FacetGroupRef().Get();
    auto* group = QelSysDynamicCast<QelRovFacetGroup>(groupObject.get());
    if (!group) {
      QelAssertPointer("QelRovFacetGroup");
      return E_UNEXPECTED;
    }
    BuildSetItems(sets, custom);
    group->RemoveLightLoadModeObservers();
    group->AddLightLoadModeObservers();
  } else if (IsProperty(kRoot, property)) {
    QelRovFacetServices::ListAllSets(root.get(), sets, false);
    QelRovFacetServices::EnableDisableDisplay(sets, 0, nullptr);
    sets.RemoveAll();
    QelRovFacetServices::ListARMOrDirectSets(root.get(), sets, true);
    QelRovFacetServices::EnableDisableDisplay(sets, 1, nullptr);
  } else if (IsProperty(kNone, property)) {
    QelRovFacetServices::ListAllSets(root.get(), sets, false);
    QelRovFacetServices::EnableDisableDisplay(sets, 0, nullptr);
  }
  return S_OK;
}

HRESULT QelRovFacetAnnotationSet::CanChangeCheckState(QelBaseUnknown* property, QelCheckState newState) {
  if (!property) {
    QelAssertPointer("property");
    return E_UNEXPECTED;
  }
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("4 properties");
    return E_UNEXPECTED;
  }
  if (!IsProperty(kAll, property)) return S_OK;
  if (newState != Checked) {
    QelAssertBool("Checked");
    return E_UNEXPECTED;
  }
  QelApplicationFrame* frame = QelApplicationFrame::GetFrame();
  if (!frame) {
    QelAssertPointer("QelApplicationFrame");
    return E_UNEXPECTED;
  }
  const QelUnicodeString message = Label("AnnotationSet.AllDlg.Message");
  const QelUnicodeString title = Label("AnnotationSet.AllDlg.Title");
  auto dialog = QelMakeVar<QelDlgNotify>(frame->GetMainWindow(), "QelRovAnnotSetAllDlg", kConfirmStyle);
  const int answer = dialog->DisplayBlocked(message, title);
  dialog->RequestDelayedDestruction();
  return answer == QelDlgNotify::AnswerYes ? S_OK : S_FALSE;
}
