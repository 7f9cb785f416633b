#include "QelModelBuilder.h"

#include "QelAnnotationModel.h"
#include "QelAssert.h"
#include "QelLumAnnotation.h"
#include "QelLumAnnotationSet.h"
#include "QelLumCamera.h"
#include "QelLumCapture.h"
#include "QelLumView.h"
#include "QelPLMProductOccurrence.h"
#include "QelPLMRepInstance.h"
#include "QelPLMRepReference.h"

struct QelModelBuilder::State {
  QelVar<QelPLMProductOccurrence> root;
  QelVar<QelAnnotationModel> model;

  template <class T>
  T* Mine(QelBaseUnknown* object) const {
    T* found = QelSysDynamicCast<T>(object);
    if (!found || QelAnnotationModel::Of(object) != model.get()) {
      QelAssertBool("object of another kind or another model");
      return nullptr;
    }
    return found;
  }
};

QelModelBuilder::QelModelBuilder(const QelModelProductDesc& root) : state_(std::make_unique<State>()) {
  state_->root = QelMakeVar<QelPLMProductOccurrence>(root.alias, root.icon, root.shown);
  state_->model = QelMakeVar<QelAnnotationModel>(state_->root.get());
  state_->root->SetModelData(state_->model.get(), true);
  state_->root->SetLightLoadMode(root.lightLoadMode);
  state_->root->SetShape(root.shape);
}

QelModelBuilder::~QelModelBuilder() = default;

QelBaseUnknown_var QelModelBuilder::Root() const { return QelBaseUnknown_var(state_->root.get()); }

void QelModelBuilder::SetSourceName(const std::string& name) {
  if (state_->model) state_->model->SetSourceName(name);
}

void QelModelBuilder::SetNotRead(std::vector<QelModelNotRead> notRead) {
  if (state_->model) state_->model->SetNotRead(std::move(notRead));
}

std::vector<QelModelNotRead> QelModelBuilder::NotRead(QelBaseUnknown* object) {
  QelAnnotationModel* model = QelAnnotationModel::Of(object);
  return model ? model->NotRead() : std::vector<QelModelNotRead>{};
}

void QelModelBuilder::SetLengthUnit(const std::string& unit) {
  if (state_->model) state_->model->SetLengthUnit(unit);
}

QelBaseUnknown_var QelModelBuilder::AddProduct(const QelBaseUnknown_var& parent, const QelModelProductDesc& desc) {
  if (!state_->model) return nullptr;
  auto* father = state_->Mine<QelPLMProductOccurrence>(parent.get());
  if (!father) return nullptr;
  auto child = QelMakeVar<QelPLMProductOccurrence>(desc.alias, desc.icon, desc.shown);
  child->SetModelData(state_->model.get(), false);
  child->SetLightLoadMode(desc.lightLoadMode);
  child->SetPlacement(desc.placement);
  child->SetShape(desc.shape);
  father->AddChild(child.get());
  return QelBaseUnknown_var(child.get());
}

bool QelModelBuilder::SetShape(const QelBaseUnknown_var& product, std::shared_ptr<const QelMeshShape> shape) {
  if (!state_->model) return false;
  auto* occurrence = state_->Mine<QelPLMProductOccurrence>(product.get());
  if (!occurrence) return false;
  occurrence->SetShape(std::move(shape));
  return true;
}

QelBaseUnknown_var QelModelBuilder::AddRepInstance(const QelBaseUnknown_var& product, const QelModelRepInstanceDesc& desc) {
  if (!state_->model) return nullptr;
  auto* owner = state_->Mine<QelPLMProductOccurrence>(product.get());
  if (!owner) return nullptr;
  auto reference = QelMakeVar<QelPLMRepReference>(desc.referenceAlias.empty() ? desc.alias : desc.referenceAlias, "I_RepReference");
  auto rep = QelMakeVar<QelPLMRepInstance>(owner, desc.alias, desc.icon, reference.get());
  owner->AddRepInstance(rep.get());
  return QelBaseUnknown_var(rep.get());
}

QelBaseUnknown_var QelModelBuilder::AddSet(const QelBaseUnknown_var& owner, const QelModelSetDesc& desc) {
  if (!state_->model) return nullptr;
  auto* product = state_->Mine<QelPLMProductOccurrence>(owner.get());
  if (!product) return nullptr;
  QelPLMRepInstance* rep = nullptr;
  if (desc.rep) {
    rep = state_->Mine<QelPLMRepInstance>(desc.rep);
    if (!rep || !rep->Product() || !rep->Product()->IsEqual(product)) {
      QelAssertBool("rep instance of another product");
      return nullptr;
    }
  }
  auto set = QelMakeVar<QelLumAnnotationSet>(state_->model.get(), product, rep, desc);
  state_->model->AddSet(set.get());
  return QelBaseUnknown_var(set.get());
}

QelBaseUnknown_var QelModelBuilder::AddAnnotation(const QelBaseUnknown_var& set, const QelModelAnnotationDesc& desc) {
  if (!state_->model) return nullptr;
  auto* owner = state_->Mine<QelLumAnnotationSet>(set.get());
  if (!owner) return nullptr;
  auto annotation = QelMakeVar<QelLumAnnotation>(owner, desc);
  owner->AddAnnotation(annotation.get());
  return QelBaseUnknown_var(annotation.get());
}

QelBaseUnknown_var QelModelBuilder::AddView(const QelBaseUnknown_var& set, const QelModelViewDesc& desc) {
  if (!state_->model) return nullptr;
  auto* owner = state_->Mine<QelLumAnnotationSet>(set.get());
  if (!owner) return nullptr;
  for (QelBaseUnknown* e : desc.elements) {
    auto* annotation = state_->Mine<QelLumAnnotation>(e);
    if (!annotation || annotation->Set() != owner) return nullptr;
  }
  for (const auto* views : {&desc.referenceViews, &desc.relatedViews}) {
    for (QelBaseUnknown* v : *views) {
      if (!state_->Mine<QelLumView>(v)) return nullptr;
    }
  }
  auto view = QelMakeVar<QelLumView>(owner, desc.alias, desc.icon, desc.plane, desc.extraction, desc.shown);
  for (QelBaseUnknown* e : desc.elements) view->AddElement(e);
  for (QelBaseUnknown* v : desc.referenceViews) view->AddReferenceView(v);
  for (QelBaseUnknown* v : desc.relatedViews) view->AddRelatedView(v);
  owner->AddView(view.get());
  return QelBaseUnknown_var(static_cast<QelITPSView*>(view.get()));
}

QelBaseUnknown_var QelModelBuilder::AddCapture(const QelBaseUnknown_var& set, const QelModelCaptureDesc& desc) {
  if (!state_->model) return nullptr;
  auto* owner = state_->Mine<QelLumAnnotationSet>(set.get());
  if (!owner) return nullptr;
  if (desc.view) {
    auto* view = state_->Mine<QelLumView>(desc.view);
    if (!view || view->Set() != owner) {
      QelAssertBool("linked view of another set");
      return nullptr;
    }
  }
  QelVar<QelICamera> camera;
  if (desc.camera) {
    camera = QelVar<QelICamera>::Adopt(new QelLumCamera(desc.camera->origin, desc.camera->target, desc.camera->zenith));
  }
  auto capture = QelMakeVar<QelLumCapture>(owner, desc.alias, desc.icon, desc.view, camera.get(), desc.shown);
  owner->AddCapture(capture.get());
  return QelBaseUnknown_var(static_cast<QelILumCapture*>(capture.get()));
}

bool QelModelBuilder::SetOtherElements(const QelBaseUnknown_var& set, const std::vector<QelBaseUnknown*>& elements) {
  if (!state_->model) return false;
  auto* owner = state_->Mine<QelLumAnnotationSet>(set.get());
  if (!owner) return false;
  owner->SetOtherElements(elements);
  return true;
}

QelBaseUnknown_var QelModelBuilder::Finish() {
  QelBaseUnknown_var root(state_->root.get());
  state_->root = nullptr;
  state_->model = nullptr;
  return root;
}

bool QelModelBuilder::DetachFromSet(const QelBaseUnknown_var& viewOrCapture) {
  if (auto* view = QelSysDynamicCast<QelLumView>(viewOrCapture.get())) {
    view->DetachSet();
    return true;
  }
  if (auto* capture = QelSysDynamicCast<QelLumCapture>(viewOrCapture.get())) {
    capture->DetachSet();
    return true;
  }
  return false;
}

bool QelModelBuilder::SetShown(const QelBaseUnknown_var& object, bool shown) {
  auto* target = QelSysDynamicCast<QelModelObject>(object.get());
  if (!target) return false;
  target->SetShown(shown);
  return true;
}

HRESULT QelModelBuilder::SwitchLightLoadMode(const QelBaseUnknown_var& owner, bool on) {
  auto* product = QelSysDynamicCast<QelPLMProductOccurrence>(owner.get());
  if (!product) return E_FAIL;
  return product->SetLightLoadMode(on);
}
