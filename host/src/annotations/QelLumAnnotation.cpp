#include "QelLumAnnotation.h"

#include <cmath>
#include <cstdio>

#include "QelLumAnnotationSet.h"
#include "QelMetaObject.h"
#include "QelRovFacetFilterData.h"
#include "QelTPSTypeClassifier.h"

const QelMetaObject& QelLumAnnotation::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelLumAnnotation", QelMetaKind::Implementation,
                                                            &QelModelObject::MetaObject(), "QelAnnotationLayer");
  return meta;
}
const QelMetaObject* QelLumAnnotation::GetMetaObject() const { return &MetaObject(); }

QelLumAnnotation::QelLumAnnotation(QelLumAnnotationSet* set, const QelModelAnnotationDesc& desc)
    : QelModelObject(desc.alias, desc.icon, desc.shown),
      set_(set ? set->GetImpl() : nullptr),
      typeName_(desc.typeName),
      subTypeName_(desc.subTypeName),
      navigationNames_(desc.navigationNames),
      tolerance_(desc.tolerance),
      typeCode_(desc.typeCode),
      geometry_(desc.geometry),
      isDefault_(desc.isDefault),
      visu_(desc.visu),
      anchor_(desc.anchor),
      segments_(desc.segments),
      leader_(desc.leader),
      frame_(desc.frame),
      dimension_(desc.dimension) {}
QelLumAnnotation::~QelLumAnnotation() = default;

void* QelLumAnnotation::QueryDirect(const QelIID& iid) {
  if (iid == ClassIID) return this;
  // Which kind of annotation this is decides the interfaces it answers.
  if (iid == QelITPS::IID) return geometry_ ? nullptr : static_cast<QelITPS*>(this);
  if (iid == QelILumGeometry::IID) return geometry_ ? static_cast<QelILumGeometry*>(this) : nullptr;
  if (iid == QelITPSTextVisu::IID) return visu_ == QelAnnotationVisu::Text ? static_cast<QelITPSTextVisu*>(this) : nullptr;
  if (iid == QelITPSDimVisu::IID) {
    return visu_ == QelAnnotationVisu::Dimension ? static_cast<QelITPSDimVisu*>(this) : nullptr;
  }
  if (void* mine = QelQueryDirect<QelINavigateObject, QelISetMember>(this, iid)) return mine;
  return QelModelObject::QueryDirect(iid);
}

QelLumAnnotationSet* QelLumAnnotation::Set() const { return QelSysDynamicCast<QelLumAnnotationSet>(set_.GetRaw()); }

HRESULT QelLumAnnotation::GetSet(QelBaseUnknown_var& set) {
  set = set_.Get();
  return set ? S_OK : E_FAIL;
}

HRESULT QelLumAnnotation::GetOwner(QelBaseUnknown_var& set) { return GetSet(set); }

HRESULT QelLumAnnotation::GetToleranceValue(double& value) {
  if (!tolerance_) return S_FALSE;
  value = *tolerance_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetTypeServices(QelBaseUnknown_var& classifierOwner) {
  classifierOwner = QelBaseUnknown_var::Adopt(new QelTPSTypeClassifier());
  return S_OK;
}

HRESULT QelLumAnnotation::IsDefaultAnnotation(bool& isDefault) {
  isDefault = isDefault_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetAnchor(QelMathPoint& anchor) {
  anchor = anchor_;
  return S_OK;
}

HRESULT QelLumAnnotation::GetSegmentCount(int& count) {
  count = static_cast<int>(segments_.size());
  return S_OK;
}

HRESULT QelLumAnnotation::GetSegment(int index, QelMathPoint& from, QelMathPoint& to) {
  if (index < 0 || index >= static_cast<int>(segments_.size())) return E_FAIL;
  from = segments_[index].from;
  to = segments_[index].to;
  return S_OK;
}

HRESULT QelLumAnnotation::GetColor(float& red, float& green, float& blue) {
  // Default annotations are drawn darker so a reviewer tells them apart.
  red = isDefault_ ? 0.0f : 0.1f;
  green = isDefault_ ? 0.4f : 0.6f;
  blue = isDefault_ ? 0.6f : 0.9f;
  return S_OK;
}

QelListValQelUnicodeString* QelLumAnnotation::GetIdentificators() {
  auto* names = new QelListValQelUnicodeString();
  for (const auto& name : navigationNames_) names->Append(QelUnicodeString(name));
  return names;
}

bool QelLumAnnotation::PassesFilter(const QelRovFacetFilterData& filter) const {
  if (filter.DefaultAnnot && !isDefault_) return false;
  if (filter.TolAnnot && (!tolerance_ || !filter.IsInToleranceRange(*tolerance_))) return false;
  return true;
}

namespace {
std::string Number(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", std::abs(value) < 1e-12 ? 0.0 : value);
  return text;
}

std::string Signed(double value) { return (value < 0.0 ? "-" : "+") + Number(std::abs(value)); }

// The characteristic symbol of a tolerance, by the sub-type names the importer and model
// files use; empty for one without a symbol of its own.
std::string Symbol(const std::string& subType) {
  static const std::pair<const char*, const char*> kSymbols[] = {
      {"Position", "\u2316"},          {"Flatness", "\u23E5"},          {"Straightness", "\u23E4"},
      {"Circularity", "\u25CB"},       {"Cylindricity", "\u232D"},      {"Profile of a Line", "\u2312"},
      {"Profile of a Surface", "\u2313"}, {"Angularity", "\u2220"},     {"Perpendicularity", "\u27C2"},
      {"Parallelism", "\u2225"},       {"Concentricity", "\u25CE"},     {"Coaxiality", "\u25CE"},
      {"Symmetry", "\u232F"},          {"Circular Runout", "\u2197"},   {"Total Runout", "\u2330"}};
  for (const auto& [name, symbol] : kSymbols)
    if (subType == name) return symbol;
  return {};
}

std::string SizePrefix(const std::string& subType) {
  if (subType == "Diameter") return "\u2300";
  if (subType == "Spherical Diameter") return "S\u2300";
  if (subType == "Radius") return "R";
  if (subType == "Spherical Radius") return "SR";
  return {};
}
}  // namespace

std::vector<std::string> QelLumAnnotation::Compartments() const {
  if (frame_) {
    std::vector<std::string> out;
    const std::string symbol = Symbol(subTypeName_);
    out.push_back(symbol.empty() ? subTypeName_ : symbol);
    std::string zone = frame_->zoneShape == "diameter"            ? "\u2300"
                       : frame_->zoneShape == "spherical diameter" ? "S\u2300"
                                                                   : "";
    zone += Number(frame_->zone);
    if (frame_->material == "M") zone += " \u24C2";
    if (frame_->material == "L") zone += " \u24C1";
    out.push_back(zone);
    for (const std::string& datum : frame_->datums) out.push_back(datum);
    return out;
  }
  if (dimension_) {
    const bool angle = subTypeName_ == "Angle";
    const std::string unit = angle ? "\u00B0" : "";
    std::string text = SizePrefix(subTypeName_);
    const auto& d = *dimension_;
    if (d.limits && d.upper && d.lower) {
      text += Number(*d.upper) + unit + " / " + Number(*d.lower) + unit;
    } else {
      text += Number(d.nominal) + unit;
      if (d.upper && d.lower && std::abs(*d.upper + *d.lower) < 1e-12 && *d.upper > 0.0) {
        text += " \u00B1" + Number(*d.upper) + unit;
      } else if (d.upper || d.lower) {
        text += " " + Signed(d.upper.value_or(0.0)) + unit + " " + Signed(d.lower.value_or(0.0)) + unit;
      }
    }
    return {text};
  }
  if (typeCode_ == 3 && !navigationNames_.empty() && !navigationNames_.front().empty()) return {navigationNames_.front()};
  return {Alias()};
}

std::string QelLumAnnotation::Label() const {
  std::string text;
  for (const std::string& part : Compartments()) text += (text.empty() ? "" : " | ") + part;
  return text;
}
