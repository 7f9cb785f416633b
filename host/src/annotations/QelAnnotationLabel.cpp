#include "QelAnnotationLabel.h"

#include "QelAnnotationModel.h"
#include "QelLumAnnotation.h"

std::string QelAnnotationLabel::Text(QelBaseUnknown* annotation) {
  const QelLumAnnotation* a = QelLumAnnotation::From(annotation);
  return a && (a->Frame() || a->Dimension()) ? a->Label() : std::string();
}

std::string QelAnnotationLabel::LengthUnit(QelBaseUnknown* modelObject) {
  const QelAnnotationModel* model = QelAnnotationModel::Of(modelObject);
  return model ? model->LengthUnit() : std::string();
}
