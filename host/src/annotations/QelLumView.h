#pragma once
// QelLumView: an annotation view of a set: a plane and the annotations shown in it. An
// extraction view also lists its reference views; a view may group related views (what
// component 45 gives). Every link (set, elements, other views) is weak. Views of light
// sets have the late type "QelTPSLightView".
#include <optional>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelITPSExtractionView.h"
#include "QelITPSLight.h"
#include "QelITPSView.h"
#include "QelITPSViewGroup.h"
#include "QelModelObject.h"

class QelLumAnnotationSet;

class QelLumView : public QelModelObject,
                   public QelITPSView,
                   public QelITPSExtractionView,
                   public QelITPSViewGroup,
                   public QelITPSLight {
 public:
  QelLumView(QelLumAnnotationSet* set, std::string alias, std::string icon, std::optional<QelMathPlane> plane,
             bool extraction, bool shown);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;
  const char* GetLateType() const override;

  HRESULT GetSet(QelBaseUnknown_var& set) override;
  // Leaves the object listed under its set without a link back to it.
  void DetachSet() { set_.Reset(); }
  HRESULT GetPlane(QelMathPlane*& plane) override;
  HRESULT GetElements(QelVar<QelILumCollection>& elements) override;
  HRESULT GetReferenceViews(QelVar<QelILumCollection>& views) override;
  // Related views: the views grouped under this one.
  HRESULT GetViews(QelVar<QelILumCollection>& views) override;

  QelLumAnnotationSet* Set() const;
  bool IsExtraction() const { return extraction_; }
  bool HasRelatedViews() const { return !related_.empty(); }
  const std::optional<QelMathPlane>& Plane() const { return plane_; }
  const std::vector<QelBaseUnknown_WR>& Elements() const { return elements_; }
  const std::vector<QelBaseUnknown_WR>& ReferenceViews() const { return references_; }
  const std::vector<QelBaseUnknown_WR>& RelatedViews() const { return related_; }
  void AddElement(QelBaseUnknown* element) { elements_.emplace_back(element); }
  void AddReferenceView(QelBaseUnknown* view) { references_.emplace_back(view); }
  void AddRelatedView(QelBaseUnknown* view) { related_.emplace_back(view); }

 protected:
  ~QelLumView() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR set_;
  std::optional<QelMathPlane> plane_;
  std::vector<QelBaseUnknown_WR> elements_;
  std::vector<QelBaseUnknown_WR> references_;
  std::vector<QelBaseUnknown_WR> related_;
  bool extraction_;
  bool light_;
};
