#pragma once
// An extraction view: a view made from reference views; the first reference view
// gives the plane a camera is placed against.
#include "QelILumCollection.h"
#include "QelVar.h"

class QelITPSExtractionView : public virtual QelBaseUnknown {
 public:
  using QelInterfaceSelf = QelITPSExtractionView;
  static constexpr QelIID IID = QelIID::Parse("{0FB2C0F4-EF6D-4813-8950-6A61BC87F795}");

  virtual HRESULT GetReferenceViews(QelVar<QelILumCollection>& views) = 0;

 protected:
  ~QelITPSExtractionView() override = default;
};
