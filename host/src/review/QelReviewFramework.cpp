#include "QelReviewFramework.h"

#include <memory>

#include "QelCommandHeader.h"
#include "QelDbrDisplayCaptureCommand.h"
#include "QelDbrFilterAndClippingController.h"
#include "QelDbrFilterComponent.h"
#include "QelDictionary.h"
#include "QelIBuildPath.h"
#include "QelIDriClippingFactory.h"
#include "QelIDriFilterFactory.h"
#include "QelITPSExtractionView.h"
#include "QelILumCapture.h"
#include "QelILumSet.h"
#include "QelIPLMNavOccurrence.h"
#include "QelITPSView.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelRovFacetServices.h"
#include "QelRovPathElementToolbox.h"
#include "QelTie.h"

namespace {
constexpr const char* kFramework = "QelReviewFramework";

// The path of `object` beside the leaf of `path`: the same context, another leaf.
QelVar<QelPathElement> Sibling(QelPathElement* path, QelBaseUnknown* object) {
  auto made = QelMakeVar<QelPathElement>();
  for (int i = 0; i + 1 < path->GetSize(); ++i) made->AddChildElement((*path)[i].get());
  made->AddChildElement(object);
  return made;
}

void AddItems(QelILumCollection* items, std::vector<QelBaseUnknown_var>& out) {
  uint32_t count = 0;
  if (!items || items->GetCount(count) != S_OK) return;
  for (uint32_t i = 0; i < count; ++i) {
    QelBaseUnknown_var item;
    if (items->GetItem(i, item) == S_OK && item) out.push_back(item);
  }
}

bool Holds(const std::vector<QelBaseUnknown_var>& list, QelBaseUnknown* object) {
  for (const auto& item : list)
    if (item->IsEqual(object)) return true;
  return false;
}

// A light view or capture adds itself below the root; a product adds the chain of its
// fathers below the root's leaf.
class TieBuildPath final : public QelTie<QelIBuildPath> {
 public:
  using QelTie::QelTie;
  QelVar<QelPathElement> BuildPath(QelPathElement* root) override {
    if (!root) return {};
    QelBaseUnknown* self = GetImpl();
    QelVar<QelIPLMNavOccurrence> product{self};
    QelVar<QelPathElement> path = root->Copy();
    if (!product) {
      path->AddChildElement(self);
      return path;
    }
    std::vector<QelBaseUnknown_var> chain;
    QelBaseUnknown_var at = QelBaseUnknown_var::Retain(self);
    QelBaseUnknown_var leaf = root->GetLeaf();
    while (at && !(leaf && leaf->IsEqual(at.get()))) {
      chain.push_back(at);
      QelVar<QelIPLMNavOccurrence> occurrence{at.get()};
      QelBaseUnknown_var father;
      if (!occurrence || occurrence->GetFather(father) != S_OK) father = nullptr;
      at = father;
    }
    if (!at) return {};  // not below the root's leaf
    for (auto it = chain.rbegin(); it != chain.rend(); ++it) path->AddChildElement(it->get());
    return path;
  }
};

// A view leaves out the elements of its set it does not hold; a capture those its linked
// view does not hold. Without `flag`, annotations of the other sets are left out too.
class TieFilterFactory final : public QelTie<QelIDriFilterFactory> {
 public:
  using QelTie::QelTie;
  HRESULT GetFilter(QelPathElement* path, bool flag, QelVar<QelDbrFilter>& filter) override {
    filter = nullptr;
    if (!path || path->GetSize() == 0) return E_FAIL;
    QelBaseUnknown_var setObject, view;
    if (QelVar<QelITPSView> asView{GetImpl()}) {
      asView->GetSet(setObject);
      view = QelBaseUnknown_var::Retain(GetImpl());
    } else if (QelVar<QelILumCapture> capture{GetImpl()}) {
      capture->GetSet(setObject);
      bool linked = false;
      if (capture->IsLinkedToView(linked) == S_OK && linked) capture->GetLinkedView(view);
    }
    QelVar<QelILumSet> set{setObject.get()};
    if (!set) return E_FAIL;
    std::vector<QelBaseUnknown_var> out, held;
    QelVar<QelILumCollection> elements;
    if (QelVar<QelITPSView> shown{view.get()}; shown && shown->GetElements(elements) == S_OK) {
      std::vector<QelBaseUnknown_var> all;
      AddItems(elements.get(), held);
      QelVar<QelILumCollection> setElements;
      if (set->GetElements(setElements) == S_OK) AddItems(setElements.get(), all);
      for (const auto& e : all)
        if (!Holds(held, e.get())) out.push_back(e);
    }
    if (!flag) {
      QelListValQelBaseUnknown_var sets;
      QelRovFacetServices::ListAllSets((*path)[0].get(), sets, false);
      for (int i = 1; i <= sets.Size(); ++i) {
        QelVar<QelILumSet> other{sets[i].get()};
        if (!other || other->IsEqual(set.get())) continue;
        QelVar<QelILumCollection> otherElements;
        if (other->GetElements(otherElements) == S_OK) AddItems(otherElements.get(), out);
      }
    }
    if (out.empty() && held.empty()) return S_FALSE;
    filter = QelMakeVar<QelDbrFilter>(0, QelDbrFilterAndClippingController::GetRootPath(path).get());
    auto component = QelMakeVar<QelDbrFilterComponent>();
    for (const auto& e : out) component->AddPathElement(Sibling(path, e.get()).get());
    filter->AddFilterComponent(component.get());
    // What the view holds is drawn as activating it shows it: its set and elements, even
    // those the panel hides now.
    if (!held.empty()) filter->Keep(set.get());
    for (const auto& e : held) filter->Keep(e.get());
    return S_OK;
  }
};

// A section (extraction) view clips along its plane, placed in the context; other views
// and captures keep the model whole.
class TieClippingFactory final : public QelTie<QelIDriClippingFactory> {
 public:
  using QelTie::QelTie;
  HRESULT GetClipping(QelPathElement* path, bool flag, QelVar<QelDbrClipping>& clipping) override {
    clipping = nullptr;
    QelVar<QelITPSView> view{GetImpl()};
    if (!path || !view || !flag || !QelVar<QelITPSExtractionView>(GetImpl())) return S_FALSE;
    QelMathPlane* plane = nullptr;
    if (view->GetPlane(plane) != S_OK || !plane) return S_FALSE;
    std::unique_ptr<QelMathPlane> owned(plane);
    QelMathTransformation t;
    QelRovPathElementToolbox::GetMechPartToContextTransfo(path, t);
    clipping = QelMakeVar<QelDbrClipping>(QelMathPlane(t.Apply(owned->GetOrigin()), t.ApplyToVector(owned->GetNormal()),
                                                       t.ApplyToVector(owned->GetFirstDirection()),
                                                       t.ApplyToVector(owned->GetSecondDirection())));
    return S_OK;
  }
};
}  // namespace

void QelReviewFramework::Register() {
  static bool done = false;
  if (done) return;
  done = true;
  QelDictionary& d = QelDictionary::Get();
  for (const char* type : {"QelTPSLightView", "QelTPSLightCapture", "QelLumView", "QelLumCapture"}) {
    d.Register(type, QelIBuildPath::IID, QelCreateTie<TieBuildPath>, kFramework);
    d.Register(type, QelIDriFilterFactory::IID, QelCreateTie<TieFilterFactory>, kFramework);
    d.Register(type, QelIDriClippingFactory::IID, QelCreateTie<TieClippingFactory>, kFramework);
  }
  d.Register("SorOccurrence", QelIBuildPath::IID, QelCreateTie<TieBuildPath>, kFramework);
  d.Register("QelLumAnnotation", QelIBuildPath::IID, QelCreateTie<TieBuildPath>, kFramework);
  QelCommandHeader::Register(QelDbrDisplayCaptureCommand::kHeaderName, &QelDbrDisplayCaptureCommand::Run, kFramework);
}
