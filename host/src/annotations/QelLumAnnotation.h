#pragma once
// QelLumAnnotation: one annotation of a set: a semantic annotation (QelITPS) or an
// annotated geometry (QelILumGeometry), possibly a text or dimension visualisation object.
// Its set is a weak link; it carries its naming, type code, tolerance value, default flag
// and a little geometry to draw.
#include <optional>
#include <string>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelILumGeometry.h"
#include "QelINavigateObject.h"
#include "QelISetMember.h"
#include "QelITPS.h"
#include "QelITPSDimVisu.h"
#include "QelITPSTextVisu.h"
#include "QelModelBuilder.h"
#include "QelModelObject.h"

class QelLumAnnotationSet;

class QelLumAnnotation : public QelModelObject,
                         public QelITPS,
                         public QelILumGeometry,
                         public QelITPSTextVisu,
                         public QelITPSDimVisu,
                         public QelINavigateObject,
                         public QelISetMember {
 public:
  QelLumAnnotation(QelLumAnnotationSet* set, const QelModelAnnotationDesc& desc);

  // Answered by the annotation's own QueryDirect: the classifier reaches the annotation
  // behind a handle without a dynamic_cast, once per annotation of a pass.
  static constexpr QelIID ClassIID = QelIID::Parse("{C81F3A5E-62D4-4B97-9E0C-5A2F7B18D463}");
  static QelLumAnnotation* From(QelBaseUnknown* object) {
    QelBaseUnknown* impl = object ? object->GetImpl() : nullptr;
    return impl ? static_cast<QelLumAnnotation*>(impl->FindOwnInterface(ClassIID)) : nullptr;
  }

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetSet(QelBaseUnknown_var& set) override;
  HRESULT GetToleranceValue(double& value) override;
  HRESULT GetTypeServices(QelBaseUnknown_var& classifierOwner) override;
  HRESULT IsDefaultAnnotation(bool& isDefault) override;
  HRESULT GetAnchor(QelMathPoint& anchor) override;
  HRESULT GetSegmentCount(int& count) override;
  HRESULT GetSegment(int index, QelMathPoint& from, QelMathPoint& to) override;
  HRESULT GetColor(float& red, float& green, float& blue) override;
  QelListValQelUnicodeString* GetIdentificators() override;
  HRESULT GetOwner(QelBaseUnknown_var& set) override;

  bool PassesFilter(const QelRovFacetFilterData& filter) const override;

  QelLumAnnotationSet* Set() const;
  const std::string& TypeName() const { return typeName_; }
  const std::string& SubTypeName() const { return subTypeName_; }
  int TypeCode() const { return typeCode_; }
  bool IsGeometry() const { return geometry_; }
  QelAnnotationVisu Visu() const { return visu_; }
  const std::optional<double>& Tolerance() const { return tolerance_; }
  bool IsDefault() const { return isDefault_; }
  const std::vector<std::string>& NavigationNames() const { return navigationNames_; }
  const std::optional<QelMathPoint>& Leader() const { return leader_; }
  const std::optional<QelModelToleranceFrame>& Frame() const { return frame_; }
  const std::optional<QelModelDimensionValue>& Dimension() const { return dimension_; }
  // What the annotation says, as one line a person reads: a tolerance frame's compartments
  // ("⌖ | ⌀0.75 Ⓜ | A | B"), a dimension's nominal and tolerance, a datum's letter; the
  // alias when it says nothing more. `Compartments` gives the same split at its bars.
  std::string Label() const;
  std::vector<std::string> Compartments() const;

 protected:
  ~QelLumAnnotation() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR set_;
  std::string typeName_;
  std::string subTypeName_;
  std::vector<std::string> navigationNames_;
  std::optional<double> tolerance_;
  int typeCode_;
  bool geometry_;
  bool isDefault_;
  QelAnnotationVisu visu_;
  QelMathPoint anchor_;
  std::vector<QelModelSegment> segments_;
  std::optional<QelMathPoint> leader_;
  std::optional<QelModelToleranceFrame> frame_;
  std::optional<QelModelDimensionValue> dimension_;
};
