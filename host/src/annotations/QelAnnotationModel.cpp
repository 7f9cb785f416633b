#include "QelAnnotationModel.h"

#include "QelLumAnnotation.h"
#include "QelLumAnnotationSet.h"
#include "QelLumCapture.h"
#include "QelLumView.h"
#include "QelMetaObject.h"
#include "QelPLMProductOccurrence.h"
#include "QelPLMRepInstance.h"
#include "QelPLMRepReference.h"

const QelMetaObject& QelAnnotationModel::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelAnnotationModel", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelAnnotationModel::GetMetaObject() const { return &MetaObject(); }

QelAnnotationModel::QelAnnotationModel(QelPLMProductOccurrence* root) : root_(root) {}
QelAnnotationModel::~QelAnnotationModel() = default;

QelPLMProductOccurrence* QelAnnotationModel::Root() const {
  return QelSysDynamicCast<QelPLMProductOccurrence>(root_.GetRaw());
}

void QelAnnotationModel::AddSet(QelLumAnnotationSet* set) { sets_.push_back(QelVar<QelLumAnnotationSet>::Retain(set)); }

QelAnnotationModel* QelAnnotationModel::Of(QelBaseUnknown* object) {
  QelBaseUnknown* impl = object ? object->GetImpl() : nullptr;
  if (!impl) return nullptr;
  if (auto* model = dynamic_cast<QelAnnotationModel*>(impl)) return model;
  if (auto* product = dynamic_cast<QelPLMProductOccurrence*>(impl)) {
    return QelSysDynamicCast<QelAnnotationModel>(product->ModelData().get());
  }
  if (auto* set = dynamic_cast<QelLumAnnotationSet*>(impl)) return set->Model();
  QelLumAnnotationSet* set = nullptr;
  if (auto* annotation = dynamic_cast<QelLumAnnotation*>(impl)) set = annotation->Set();
  else if (auto* view = dynamic_cast<QelLumView*>(impl)) set = view->Set();
  else if (auto* capture = dynamic_cast<QelLumCapture*>(impl)) set = capture->Set();
  else if (auto* rep = dynamic_cast<QelPLMRepInstance*>(impl)) return Of(rep->Product());
  else if (auto* reference = dynamic_cast<QelPLMRepReference*>(impl)) return Of(reference->Instance());
  return set ? set->Model() : nullptr;
}
