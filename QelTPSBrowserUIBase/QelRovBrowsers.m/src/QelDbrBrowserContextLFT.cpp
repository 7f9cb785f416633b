#include "QelDbrBrowserContextLFT.h"

#include "QelAnnotationComponents.h"
#include "QelAssert.h"
#include "QelFrmEditor.h"
#include "QelIAlias.h"
#include "QelIBuildPath.h"
#include "QelIDbrBrowser.h"
#include "QelIDMUPersistencySupportOwner.h"
#include "QelIHyxViewsOfComponent.h"
#include "QelILumCapture.h"
#include "QelILumCollection.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelIPLMNavOccurrence.h"
#include "QelIPLMNavRepInstance.h"
#include "QelIPLMNavRepOccurrence.h"
#include "QelISetMember.h"
#include "QelITPSLightSet.h"
#include "QelITPSView.h"
#include "QelITPSViewGroup.h"
#include "QelITPSViewRelations.h"
#include "QelMetaObject.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetServices.h"

namespace {
constexpr int kSetComponent = 62;
constexpr int kViewRelationComponent = 45;
constexpr int kLightBrowserType = 1;
constexpr const char* kCatalog = "QelDbrBrowserViewDlg";

QelVar<QelILumSetComponent> SetComponent() {
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kSetComponent, made);
  return QelVar<QelILumSetComponent>(made.get());
}

QelBaseUnknown_var OwnerOf(QelILumSetComponent* component, QelBaseUnknown* set) {
  QelBaseUnknown_var owner;
  component->GetSetOwner(set, owner);
  return owner;
}

QelUnicodeString AliasOf(QelBaseUnknown* object) {
  QelUnicodeString alias;
  if (QelVar<QelIAlias> named{object}) named->GetAlias(alias);
  return alias;
}
}  // namespace

const QelMetaObject& QelDbrBrowserContextLFT::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelDbrBrowserContextLFT", QelMetaKind::Implementation, &QelDbrBrowserContext::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelDbrBrowserContextLFT::GetMetaObject() const { return &MetaObject(); }

QelDbrBrowserContextLFT::QelDbrBrowserContextLFT(QelBaseUnknown* contextObject)
    : QelDbrBrowserContext(contextObject) {}

QelDbrBrowserContextLFT::~QelDbrBrowserContextLFT() {
  // A browser may drop its context without ResetContents; an observable that kept a plain
  // pointer to it would then call into freed memory on the next mode change.
  StopObserving();
  sets_.RemoveAll();
  labels_.RemoveAll();
}

void QelDbrBrowserContextLFT::StopObserving() {
  for (const auto& weak : observed_)
    if (QelVar<QelILumLightLoadModeObservable> observable{weak.Get().get()}) observable->RemoveObserver(this);
  observed_.clear();
}

template <class Call>
bool QelDbrBrowserContextLFT::CallBrowser(Call call) {
  QelBaseUnknown_var found = GetBrowser(kLightBrowserType);
  QelVar<QelIDbrBrowser> browser{found.get()};
  if (!browser) {
    QelAssertNullHandler();
    return false;
  }
  call(browser.get());
  return true;
}

QelUnicodeString QelDbrBrowserContextLFT::BuildSetLabel(QelBaseUnknown* set) {
  QelUnicodeString label;
  QelVar<QelILumSetComponent> component = SetComponent();
  if (!component) {
    QelAssertPointer();
    return label;
  }
  QelBaseUnknown_var owner = OwnerOf(component.get(), set);
  if (!owner) {
    QelAssertNullHandler();
    return label;
  }
  QelListValQelBaseUnknown_var instances, referenced;
  component->ListRepInstances(owner.get(), instances);
  for (const auto& instance : instances) {
    QelVar<QelIPLMNavRepInstance> rep{instance.get()};
    if (!rep) {
      QelAssertNullHandler();
      continue;
    }
    QelBaseUnknown_var object = rep->GetReferencedObject();
    if (!object) {
      QelAssertPointer();
      continue;
    }
    referenced.Append(object);
  }
  bool first = true;
  for (const auto& object : referenced) {
    QelVar<QelIAlias> named{object.get()};
    if (!named) {
      QelAssertNullHandler();
      continue;
    }
    QelUnicodeString alias;
    named->GetAlias(alias);
    if (!first) label.Append(", ");
    label.Append(alias);
    first = false;
  }
  for (QelBaseUnknown* named : {owner.get(), set}) {
    if (!QelVar<QelIAlias>(named)) continue;
    if (!label.IsEmpty()) label.Append("/");
    label.Append(AliasOf(named));
  }
  return label;
}

HRESULT QelDbrBrowserContextLFT::InitContents(QelBaseUnknown*) {
  sets_.RemoveAll();
  labels_.RemoveAll();
  // Refilling must not leave this context observing the owners of the sets it listed
  // before (another context object, or the same owners twice).
  StopObserving();
  QelBaseUnknown_var object = GetContextObject();
  QelRovFacetServices::ListARMOrDirectSets(object.get(), sets_, true);
  QelVar<QelILumSetComponent> component = SetComponent();
  if (!component) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  QelVar<QelILumLightLoadModeObserver> self{static_cast<QelBaseUnknown*>(this)};
  for (const auto& entry : sets_) {
    QelVar<QelILumSet> set{entry.get()};
    labels_.Append(BuildSetLabel(set.get()));
    if (!QelVar<QelITPSLightSet>(entry.get())) continue;
    QelBaseUnknown_var owner = OwnerOf(component.get(), entry.get());
    QelVar<QelILumLightLoadModeObservable> observable{owner.get()};
    if (!observable) {
      QelAssertNullHandler();
      continue;
    }
    bool known = false;
    for (const auto& weak : observed_) known = known || weak.RefersTo(observable.get());
    if (known) continue;  // owners of several sets are observed once
    observable->AddObserver(self.get());
    observed_.emplace_back(observable.get());
  }
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::ResetContents(QelBaseUnknown*) {
  QelVar<QelILumSetComponent> component = SetComponent();
  if (!component) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  for (const auto& entry : sets_) {
    if (!QelVar<QelITPSLightSet>(entry.get())) continue;
    QelBaseUnknown_var owner = OwnerOf(component.get(), entry.get());
    QelVar<QelILumLightLoadModeObservable> observable{owner.get()};
    if (!observable) {
      QelAssertNullHandler();
      continue;
    }
    observable->RemoveObserver(this);
  }
  StopObserving();
  sets_.RemoveAll();
  labels_.RemoveAll();
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::ChangeContextObject(QelBaseUnknown_var& object) {
  QelBaseUnknown_var found = GetBrowser(kLightBrowserType);
  QelVar<QelIDbrBrowser> browser{found.get()};
  if (!browser) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var current = GetContextObject();
  auto follow = [&](QelBaseUnknown* next) {
    SetContextObject(next);
    InitContents(nullptr);
    browser->OnContextObjectChanged();
  };
  auto empty = [&] {
    browser->OnContextEmptied();
    ResetContents(nullptr);
    SetContextObject(nullptr);
    return S_FALSE;
  };
  if (QelVar<QelIPLMNavOccurrence>(object.get())) {
    if (!current || !current->IsEqual(object.get())) follow(object.get());
    return S_OK;
  }
  QelVar<QelIDMUPersistencySupportOwner> owner{object.get()};
  QelBaseUnknown_var support = owner ? owner->GetSupportOwner() : nullptr;
  if (support && std::string_view(support->GetImpl()->IsA()) == "PCCMemDMUValidationValidation") {
    QelBaseUnknown_var root;
    QelRovFacetServices::GetRootPLMObject(QelFrmEditor::GetCurrentEditor(), root);
    if (!root) return empty();
    if (current && current->IsEqual(root.get())) return S_FALSE;
    follow(root.get());
    return S_OK;
  }
  return empty();
}

HRESULT QelDbrBrowserContextLFT::GetContextName(QelString& name) {
  name = "Review";
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::GetBrowserTitle(QelUnicodeString& title) {
  title = QelMsgCatalog::BuildMessage(kCatalog, "Title_CaptureBrowser");
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::GetBrowserIconName(QelUnicodeString& icon) {
  icon = "I_Hyq_ViewBrowser.png";
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::GetColumns(int, std::vector<QelString>& columns,
                                            QelListValQelUnicodeString& headers) {
  columns.emplace_back("NAME");
  headers.Append(QelMsgCatalog::BuildMessage(kCatalog, "NameHeader"));
  columns.emplace_back("ASSOCIATED_FILTER");
  headers.Append(QelMsgCatalog::BuildMessage(kCatalog, "SupportHeader"));
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::ListNodeNames(int browserType, std::vector<QelString>& names) {
  if (browserType != kLightBrowserType) {
    QelAssertBool();
    return E_UNEXPECTED;
  }
  for (const auto& label : labels_) names.emplace_back(label.Utf8());
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::ListNodeItems(QelString name, QelListValQelBaseUnknown_var& items) {
  QelBaseUnknown_var set;
  for (const auto& entry : sets_)
    if (BuildSetLabel(entry.get()).Utf8() == name.Str()) {
      set = entry;
      break;
    }
  QelVar<QelIHyxViewsOfComponent> views{set.get()};
  if (!views) return S_FALSE;
  QelListValQelBaseUnknown_var listed;
  views->ListViews(listed);
  for (const auto& view : listed) {
    QelListValQelBaseUnknown_var captures;
    ListCapturesOfView(view.get(), captures, set.get());
    if (captures.Size() > 0) {
      items.Append(captures);
      continue;
    }
    QelBaseUnknown_var made;
    QelTPSInstantiateComponentBase(kViewRelationComponent, made);
    QelVar<QelITPSViewRelations> relations{made.get()};
    if (!relations) {
      QelAssertPointer();
      return E_UNEXPECTED;
    }
    QelBaseUnknown_var related;
    relations->GetRelatedObject(QelVar<QelITPSView>(view.get()).get(), related);
    if (!related) continue;
    QelVar<QelITPSViewGroup> group{related.get()};
    QelVar<QelILumCollection> grouped;
    if (group) group->GetViews(grouped);
    if (!grouped) {
      QelAssertPointer();
      return E_UNEXPECTED;
    }
    uint32_t count = 0;
    grouped->GetCount(count);
    for (uint32_t i = 0; i < count; ++i) {
      QelBaseUnknown_var other;
      grouped->GetItem(i, other);
      ListCapturesOfView(other.get(), items, set.get());
    }
  }
  QelListValQelBaseUnknown_var others;
  views->ListOtherElements(others);
  for (const auto& element : others)
    if (items.Locate(element.get()) == 0) items.Append(element);
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::ListCapturesOfView(QelBaseUnknown* view, QelListValQelBaseUnknown_var& captures,
                                                    QelBaseUnknown* set) {
  if (!view || !set) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelVar<QelILumSet> asSet{set};
  QelVar<QelILumCollection> all;
  if (!asSet || asSet->GetCaptures(all) != S_OK) {
    QelAssertBool();
    return E_UNEXPECTED;
  }
  if (!all) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  uint32_t count = 0;
  all->GetCount(count);
  for (uint32_t i = 0; i < count; ++i) {
    QelBaseUnknown_var item;
    if (all->GetItem(i, item) != S_OK) {
      QelAssertBool();
      continue;
    }
    if (!item) {
      QelAssertPointer();
      continue;
    }
    QelVar<QelILumCapture> capture{item.get()};
    bool linked = false;
    QelBaseUnknown_var linkedView;
    if (capture && capture->IsLinkedToView(linked) == S_OK && linked && capture->GetLinkedView(linkedView) == S_OK &&
        linkedView && linkedView->IsEqual(view))
      captures.Append(item);
  }
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::OnObjectReplaced(QelBaseUnknown_var, QelBaseUnknown_var) { return S_OK; }

QelPathElement* QelDbrBrowserContextLFT::GetItemPath(QelBaseUnknown_var& item) {
  if (!item) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelBaseUnknown_var owner;
  if (QelVar<QelITPSView> view{item.get()}) {
    view->GetSet(owner);
  } else if (QelVar<QelISetMember> member{item.get()}) {
    member->GetOwner(owner);
  }
  if (!owner) {
    QelAssertPointer();
    return nullptr;
  }
  QelVar<QelILumSet> set{owner.get()};
  owner = nullptr;
  if (!set) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelVar<QelPathElement> uiPath;
  QelRovFacetServices::GetWorkingUIActivePath(QelFrmEditor::GetCurrentEditor(), uiPath);
  if (!uiPath) {
    QelAssertPointer();
    return nullptr;
  }
  uiPath->InitToLeafElement();
  QelBaseUnknown_var leaf = uiPath->NextFatherElement();
  if (!QelVar<QelIPLMNavOccurrence>(leaf.get())) return nullptr;
  int kind = 0;
  set->GetKind(kind);
  QelBaseUnknown_var rep;
  FindRepOccurrenceOfSet(set.get(), leaf.get(), kind == 2, rep);
  if (!rep) {
    QelAssertNullHandler();
    return nullptr;
  }
  // The representation occurrence placed under the UI-active path.
  QelVar<QelPathElement> path = uiPath->Copy();
  uiPath = nullptr;
  path->AddChildElement(rep.get());
  if (QelVar<QelITPSLightSet>(set.get())) {
    path->AddChildElement(set.get());
    return path.Detach();
  }
  QelVar<QelIBuildPath> build{set.get()};
  if (!build) {
    QelAssertNullHandler();
    return nullptr;
  }
  QelVar<QelPathElement> built = build->BuildPath(path.get());
  path = nullptr;
  if (!built) {
    QelAssertNullHandler();
    return nullptr;
  }
  return built.Detach();
}

HRESULT QelDbrBrowserContextLFT::FindRepOccurrenceOfSet(QelBaseUnknown* set, QelBaseUnknown* occurrence,
                                                        bool searchChildren, QelBaseUnknown_var& rep) {
  rep = nullptr;
  if (!set) {
    QelAssertNullHandler();
    return E_UNEXPECTED;
  }
  QelVar<QelIPLMNavOccurrence> product{occurrence};
  if (!product) {
    QelAssertPointer();
    return E_UNEXPECTED;
  }
  QelListValQelBaseUnknown_var reps;
  product->ListRepOccurrences(reps);
  for (const auto& candidate : reps) {
    if (!candidate) {
      QelAssertPointer();
      continue;
    }
    QelVar<QelIPLMNavRepOccurrence> repOccurrence{candidate.get()};
    QelBaseUnknown_var reference;
    if (repOccurrence) repOccurrence->GetRepReference(reference);
    if (!reference) {
      QelAssertPointer();
      return E_UNEXPECTED;
    }
    QelListValQelBaseUnknown_var direct;
    QelRovFacetServices::ListDirectSets(reference.get(), direct, true);
    for (const auto& stored : direct)
      if (stored->IsEqual(set)) {
        rep = candidate;
        break;
      }
    if (rep) break;
  }
  reps.RemoveAll();
  if (rep) return S_OK;
  if (!searchChildren) return E_FAIL;
  QelListValQelBaseUnknown_var children;
  product->ListChildren(children);
  for (const auto& child : children) {
    FindRepOccurrenceOfSet(set, child.get(), false, rep);
    if (rep) break;
  }
  return S_OK;
}

HRESULT QelDbrBrowserContextLFT::OnLightLoadModeChanged() {
  // Held up: the browser told below may drop this context while it is still running.
  QelBaseUnknown_var self(static_cast<QelBaseUnknown*>(this));
  ResetContents(nullptr);
  InitContents(nullptr);
  return CallBrowser([](QelIDbrBrowser* browser) { browser->OnContentsRebuilt(); }) ? S_OK : E_UNEXPECTED;
}
