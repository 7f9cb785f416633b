#pragma once
// QelLumAnnotationSet: an annotation set. It owns its annotations, views and captures (in
// model order); its model, owner product and representation instance are weak links.
// Answers QelITPSLightSet only when loaded in light mode.
#include <optional>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelIHyxViewsOfComponent.h"
#include "QelILumSet.h"
#include "QelITPSLightSet.h"
#include "QelITPSSet.h"
#include "QelModelBuilder.h"
#include "QelModelObject.h"

class QelAnnotationModel;
class QelLumAnnotation;
class QelLumCapture;
class QelLumView;

class QelLumAnnotationSet : public QelModelObject,
                            public QelILumSet,
                            public QelITPSSet,
                            public QelITPSLightSet,
                            public QelIHyxViewsOfComponent {
 public:
  QelLumAnnotationSet(QelAnnotationModel* model, QelBaseUnknown* owner, QelBaseUnknown* rep,
                      const QelModelSetDesc& desc);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetKind(int& kind) override;
  HRESULT GetCaptures(QelVar<QelILumCollection>& captures) override;
  HRESULT GetElements(QelVar<QelILumCollection>& elements) override;
  HRESULT GetViews(QelVar<QelILumCollection>& views) override;
  HRESULT GetAnnotationCount(int& count) override;
  HRESULT GetSet(QelBaseUnknown_var& set) override;
  HRESULT CountViews(int& count) override;
  HRESULT CountOtherElements(int& count) override;
  HRESULT ListViews(QelListValQelBaseUnknown_var& views) override;
  HRESULT ListOtherElements(QelListValQelBaseUnknown_var& elements) override;

  QelAnnotationModel* Model() const;
  QelBaseUnknown* Owner() const { return owner_.GetRaw(); }
  QelBaseUnknown* Rep() const { return rep_.GetRaw(); }
  bool IsLight() const { return light_; }
  int Kind() const { return kind_; }
  QelRootSetScope RootScope() const { return rootScope_; }
  // The views component's second list as given to SetOtherElements; null: every capture.
  const std::optional<std::vector<QelBaseUnknown_WR>>& OtherElements() const { return otherElements_; }

  const std::vector<QelVar<QelLumAnnotation>>& Annotations() const { return annotations_; }
  const std::vector<QelVar<QelLumView>>& Views() const { return views_; }
  const std::vector<QelVar<QelLumCapture>>& Captures() const { return captures_; }
  void AddAnnotation(QelLumAnnotation* annotation);
  void AddView(QelLumView* view);
  void AddCapture(QelLumCapture* capture);
  void SetOtherElements(const std::vector<QelBaseUnknown*>& elements);

 protected:
  ~QelLumAnnotationSet() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR model_;
  QelBaseUnknown_WR owner_;
  QelBaseUnknown_WR rep_;
  int kind_;
  bool light_;
  QelRootSetScope rootScope_;
  std::vector<QelVar<QelLumAnnotation>> annotations_;
  std::vector<QelVar<QelLumView>> views_;
  std::vector<QelVar<QelLumCapture>> captures_;
  std::optional<std::vector<QelBaseUnknown_WR>> otherElements_;
};
