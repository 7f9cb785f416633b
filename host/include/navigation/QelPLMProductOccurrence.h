#pragma once
// QelPLMProductOccurrence: a node of the product tree (late type "SorOccurrence"). It owns
// its child occurrences and representation instances; its father is a weak link. The
// root occurrence also owns the annotation data of the model (an opaque object), so the
// last handle on the root frees the whole model.
//
// It is the owner of annotation sets and, for light sets, the light-load mode observable.
// Observers are subscribed through QelCallbackManager: held weakly, they may be added or
// removed during a notification, and one that goes away without RemoveObserver is
// skipped, never called and never kept alive.
#include <memory>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelIPLMNavOccurrence.h"
#include "QelMeshShape.h"
#include "QelModelObject.h"

class QelPLMRepInstance;

class QelPLMProductOccurrence : public QelModelObject,
                                public QelIPLMNavOccurrence,
                                public QelILumLightLoadModeObservable {
 public:
  QelPLMProductOccurrence(std::string alias, std::string icon, bool shown);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;
  const char* GetLateType() const override;

  HRESULT ListRepOccurrences(QelListValQelBaseUnknown_var& reps) override;
  HRESULT ListChildren(QelListValQelBaseUnknown_var& children) override;
  HRESULT GetFather(QelBaseUnknown_var& father) override;
  HRESULT GetPlacement(QelMathTransformation& placement) override;

  HRESULT AddObserver(QelBaseUnknown* observer) override;
  HRESULT RemoveObserver(QelBaseUnknown* observer) override;
  HRESULT IsLightLoadMode(bool& on) override;
  HRESULT SetLightLoadMode(bool on) override;

  void AddChild(QelPLMProductOccurrence* child);
  void AddRepInstance(QelPLMRepInstance* rep);
  void SetPlacement(const QelMathTransformation& placement) { placement_ = placement; }
  const QelMathTransformation& Placement() const { return placement_; }
  // The product's own shape in its coordinates, shared with every picture; null: none.
  void SetShape(std::shared_ptr<const QelMeshShape> shape) { shape_ = std::move(shape); }
  const std::shared_ptr<const QelMeshShape>& Shape() const { return shape_; }
  QelPLMProductOccurrence* Father() const;
  const std::vector<QelVar<QelPLMProductOccurrence>>& Children() const { return children_; }
  const std::vector<QelVar<QelPLMRepInstance>>& RepInstances() const { return reps_; }

  // The annotation data of the model: owned by the root, seen weakly by the others.
  void SetModelData(QelBaseUnknown* data, bool owning);
  QelBaseUnknown_var ModelData() const;

 protected:
  ~QelPLMProductOccurrence() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR father_;
  std::vector<QelVar<QelPLMProductOccurrence>> children_;
  std::vector<QelVar<QelPLMRepInstance>> reps_;
  QelBaseUnknown_var ownedData_;
  QelBaseUnknown_WR data_;
  bool lightLoadMode_ = false;
  QelMathTransformation placement_;
  std::shared_ptr<const QelMeshShape> shape_;
};
