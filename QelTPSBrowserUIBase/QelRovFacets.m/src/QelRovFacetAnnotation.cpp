#include "QelRovFacetAnnotation.h"

#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "QelAnnotationComponents.h"
#include "QelAssert.h"
#include "QelILumGeometry.h"
#include "QelILumNamingComponent.h"
#include "QelITPS.h"
#include "QelITPSDimVisu.h"
#include "QelITPSTextVisu.h"
#include "QelITPSType.h"
#include "QelITPSTypeClassifier.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetFilterData.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetPropertyItemCustomAnnot.h"
#include "QelRovFacetPropertyItemTypeAnnot.h"
#include "QelRovFacetServices.h"

namespace {
constexpr const char* kCatalog = "QelRovLumFacets";
constexpr const char* kKindCatalog = "QelTPSLightBase";
constexpr int kNamingComponent = 59;
constexpr int kPropertyCount = 5;
constexpr int kAll = 1;
constexpr int kType = 2;
constexpr int kCustom = 3;
constexpr int kDefaultAnnot = 4;
constexpr int kTolAnnot = 5;
constexpr int kTolRangeMode = 3;
constexpr int kUnclassifiedCode = 4;

constexpr const char* kKindWords[QelRovFacetAnnotation::KindCount] = {
    "Datums", "GeomTolerances", "Dimensions", "Roughness", "Welds", "Notes", "Geometries"};

QelUnicodeString Label(const char* key) { return QelMsgCatalog::BuildMessage(kCatalog, key); }

bool IsTextOrDimensionVisu(QelBaseUnknown* annotation) {
  return QelVar<QelITPSTextVisu>(annotation) || QelVar<QelITPSDimVisu>(annotation);
}

// The classifier reached from one annotation; null after a report when it gives none.
QelVar<QelITPSTypeClassifier> ClassifierFrom(QelBaseUnknown* annotation) {
  QelBaseUnknown_var owner;
  if (QelVar<QelITPS> tps{annotation}) {
    tps->GetTypeServices(owner);
  } else if (QelVar<QelILumGeometry> geometry{annotation}) {
    geometry->GetTypeServices(owner);
  } else {
    QelAssertBool("QelITPS or QelILumGeometry");
    return nullptr;
  }
  QelVar<QelITPSTypeClassifier> classifier(owner.get());
  if (!classifier) QelAssertPointer("QelITPSTypeClassifier");
  return classifier;
}

// Where the rows of one pass are found by label. A label maps to the last child bearing
// it, which is what a search from the end of the children finds, without scanning them
// for each annotation.
struct TypeIndex {
  struct Group {
    QelRovFacetPropertyGroup* group;
    std::unordered_map<std::string, QelRovFacetPropertyItemTypeAnnot*> items;
  };
  std::unordered_map<std::string, Group> groups;
};

// The annotation rows a kind group held before a pass. Passes list the annotations in the
// same order, so the row for the next annotation is usually the one after the last row
// renewed; when it is not (annotations came or went), the rows are indexed by annotation
// once, so a pass stays linear.
// An annotation row made by this facet, or null; exact class only, without a dynamic cast.
QelRovFacetPropertyItemCustomAnnot* AnnotationRow(QelBaseUnknown* entry) {
  QelRovFacetProperty* property = QelRovFacetProperty::From(entry);
  if (!property || property->GetMetaObject() != &QelRovFacetPropertyItemCustomAnnot::MetaObject()) return nullptr;
  return static_cast<QelRovFacetPropertyItemCustomAnnot*>(property);
}

struct PreviousRows {
  QelListValQelBaseUnknown_var rows;
  int next = 1;
  std::unordered_map<QelBaseUnknown*, int> byAnnotation;  // built on the first miss
  std::vector<bool> used;

  void Take(QelListValQelBaseUnknown_var& from) {
    std::swap(rows, from);
    from.RemoveAll();
  }

  // The renewed row for `annotation`, borrowed (the group it is added to holds it), or null.
  QelBaseUnknown* Renew(QelBaseUnknown* annotation, QelRovFacetFilterData* filterData) {
    if (rows.Size() == 0) return nullptr;
    int position = next;
    if (position > rows.Size() || !Matches(position, annotation, filterData)) {
      position = Find(annotation);
      if (position == 0 || !Matches(position, annotation, filterData)) return nullptr;
    }
    if (!used.empty()) used[static_cast<size_t>(position)] = true;
    next = position + 1;
    return rows[position].get();
  }

 private:
  bool Matches(int position, QelBaseUnknown* annotation, QelRovFacetFilterData* filterData) {
    if (!used.empty() && used[static_cast<size_t>(position)]) return false;
    QelRovFacetPropertyItemCustomAnnot* row = AnnotationRow(rows[position].get());
    return row && row->Renew(annotation, filterData);
  }
  int Find(QelBaseUnknown* annotation) {
    if (used.empty()) {
      used.assign(static_cast<size_t>(rows.Size()) + 1, false);
      for (int position = 1; position < next; ++position) used[static_cast<size_t>(position)] = true;
      byAnnotation.reserve(static_cast<size_t>(rows.Size()));
      for (int position = 1; position <= rows.Size(); ++position) {
        QelRovFacetPropertyItemCustomAnnot* row = AnnotationRow(rows[position].get());
        QelBaseUnknown_var object = row ? row->GetObject() : nullptr;
        if (object) byAnnotation.emplace(object->GetImpl(), position);
      }
    }
    auto found = byAnnotation.find(annotation->GetImpl());
    return found == byAnnotation.end() ? 0 : found->second;
  }
};

std::string LabelOf(QelRovFacetProperty* property) {
  QelUnicodeString name;
  property->GetName(name);
  return name.Utf8();
}
}  // namespace

const QelMetaObject& QelRovFacetAnnotation::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare(
      "QelRovFacetAnnotation", QelMetaKind::Implementation, &QelRovFacet::MetaObject(), "QelTPSBrowserUIBase");
  return meta;
}

const QelMetaObject* QelRovFacetAnnotation::GetMetaObject() const { return &MetaObject(); }

int QelRovFacetAnnotation::KindOfTypeCode(int code) {
  if (code == 3) return 1;
  if (code >= 5 && code <= 9) return code - 3;
  if (code == 13) return 7;
  return 0;
}

QelRovFacetAnnotation::QelRovFacetAnnotation(QelBaseUnknown* group) : QelRovFacet(group) {
  SetFacetName(Label("Annotation"));
  QelBaseUnknown* self = this;
  auto all = QelMakeVar<QelRovFacetPropertyItem>(Label("Annotation.All"), self);
  PropertyList().Append(static_cast<QelBaseUnknown*>(all.get()));
  all->SetFlags(QelRovFacetProperty::FlagsRadio);
  auto type = QelMakeVar<QelRovFacetPropertyGroup>(Label("Annotation.Type"), QelUnicodeString(), self, false);
  PropertyList().Append(static_cast<QelBaseUnknown*>(type.get()));
  type->SetFlags(QelRovFacetProperty::FlagsRadio);
  auto custom = QelMakeVar<QelRovFacetPropertyGroup>(Label("Annotation.Custom"), QelUnicodeString(), self, false);
  PropertyList().Append(static_cast<QelBaseUnknown*>(custom.get()));
  custom->SetFlags(QelRovFacetProperty::FlagsRadio);
  for (const char* word : kKindWords) {
    const std::string key = std::string("QelTPS.SubNode.") + word;
    const QelUnicodeString label = QelMsgCatalog::BuildMessage(kKindCatalog, key.c_str());
    if (label.IsEmpty()) QelAssertBool(key.c_str());
    auto kind = QelMakeVar<QelRovFacetPropertyGroup>(label, QelUnicodeString(), static_cast<QelBaseUnknown*>(custom.get()),
                                                     false);
    custom->AddProperty(static_cast<QelBaseUnknown*>(kind.get()));
  }
  auto defaultAnnot = QelMakeVar<QelRovFacetPropertyItem>(Label("Annotation.DefaultAnnot"), self);
  PropertyList().Append(static_cast<QelBaseUnknown*>(defaultAnnot.get()));
  defaultAnnot->SetFlags(QelRovFacetProperty::FlagsCheckBox);
  auto tolAnnot = QelMakeVar<QelRovFacetPropertyItem>(Label("Annotation.TolAnnot"), self);
  PropertyList().Append(static_cast<QelBaseUnknown*>(tolAnnot.get()));
  tolAnnot->SetFlags(QelRovFacetProperty::FlagsCheckBoxRange);
  tolAnnot->SetRangeMode(kTolRangeMode);
}

QelRovFacetAnnotation::~QelRovFacetAnnotation() = default;

bool QelRovFacetAnnotation::IsProperty(int position, QelBaseUnknown* property) const {
  QelBaseUnknown* entry = const_cast<QelRovFacetAnnotation*>(this)->PropertyList()[position].get();
  return entry && property && entry->IsEqual(property);
}

void QelRovFacetAnnotation::Refresh() {
  if (PropertyList().Size() != kPropertyCount) {
    QelAssertBool("5 properties");
    return;
  }
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) {
    ClearDynamicProperties();
    return;
  }
  if (!filterData) {
    QelAssertPointer("QelRovFacetFilterData");
    return;
  }
  constexpr QelCheckState choices[] = {Unchecked, Unchecked, Checked};
  for (int position = kAll; position <= kCustom; ++position)
    if (QelRovFacetProperty* choice = PropertyAt(position)) choice->SetCheckState(choices[position - 1]);
  QelRovFacetProperty* defaultAnnot = PropertyAt(kDefaultAnnot);
  QelRovFacetProperty* tolAnnot = PropertyAt(kTolAnnot);
  if (!defaultAnnot || !tolAnnot) return;
  defaultAnnot->SetCheckState(filterData->DefaultAnnot ? Checked : Unchecked);
  tolAnnot->SetCheckState(filterData->TolAnnot ? Checked : Unchecked);
  ClearTypeRows();
  BuildDynamicProperties(root.get(), filterData);
}

void QelRovFacetAnnotation::Rebuild() {
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) {
    ClearDynamicProperties();
    return;
  }
  ClearTypeRows();
  BuildDynamicProperties(root.get(), filterData);
}

void QelRovFacetAnnotation::BuildDynamicProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData) {
  QelListValQelBaseUnknown_var annotations;
  if (root) QelRovFacetServices::ListAnnotationsOfVisibleSets(root, annotations);
  std::vector<signed char> visu(static_cast<size_t>(annotations.Size()), -1);
  BuildTypeRows(root, filterData, &annotations, &visu);
  BuildKindRows(root, filterData, &annotations, &visu);
}

HRESULT QelRovFacetAnnotation::BuildTypeProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData) {
  return BuildTypeRows(root, filterData, nullptr, nullptr);
}

void QelRovFacetAnnotation::ClearTypeRows() {
  if (QelRovFacetPropertyGroup* type = PropertyGroupAt(kType)) type->RemoveAllProperties();
}

HRESULT QelRovFacetAnnotation::BuildKindProperties(QelBaseUnknown* root, QelRovFacetFilterData* filterData) {
  return BuildKindRows(root, filterData, nullptr, nullptr);
}

void QelRovFacetAnnotation::ClearDynamicProperties() {
  QelRovFacetPropertyGroup* type = PropertyGroupAt(kType);
  if (!type) return;
  type->RemoveAllProperties();
  ClearKindRows();
}

void QelRovFacetAnnotation::ClearKindRows() {
  QelRovFacetPropertyGroup* custom = PropertyGroupAt(kCustom);
  if (!custom) return;
  const QelListValQelBaseUnknown_var& kinds = custom->GetPropertyList();
  if (kinds.Size() != KindCount) {
    QelAssertBool("7 kind groups");
    return;
  }
  for (const QelBaseUnknown_var& entry : kinds) {
    auto* kind = QelSysDynamicCast<QelRovFacetPropertyGroup>(entry.get());
    if (!kind) {
      QelAssertPointer("QelRovFacetPropertyGroup");
      continue;
    }
    kind->RemoveAllProperties();
  }
}

HRESULT QelRovFacetAnnotation::BuildTypeRows(QelBaseUnknown* root, QelRovFacetFilterData* filterData,
                                             const QelListValQelBaseUnknown_var* listed,
                                             std::vector<signed char>* visu) {
  if (!root || !filterData || PropertyList().Size() != kPropertyCount) {
    QelAssertBool("root, filter data and 5 properties");
    return E_UNEXPECTED;
  }
  QelRovFacetPropertyGroup* type = PropertyGroupAt(kType);
  if (!type) return E_UNEXPECTED;

  // Rows left from an earlier pass are emptied and indexed, so that this pass finds them.
  TypeIndex index;
  for (const QelBaseUnknown_var& entry : type->GetPropertyList()) {
    auto* group = QelSysDynamicCast<QelRovFacetPropertyGroup>(entry.get());
    if (!group) {
      QelAssertPointer("QelRovFacetPropertyGroup");
      continue;
    }
    TypeIndex::Group& indexed = index.groups[LabelOf(group)];
    indexed = {group, {}};
    for (const QelBaseUnknown_var& child : group->GetPropertyList()) {
      auto* item = QelSysDynamicCast<QelRovFacetPropertyItemTypeAnnot>(child.get());
      if (!item) {
        QelAssertPointer("QelRovFacetPropertyItemTypeAnnot");
        continue;
      }
      item->ClearAnnotations();
      indexed.items[LabelOf(item)] = item;
    }
  }

  QelListValQelBaseUnknown_var own;
  if (!listed) QelRovFacetServices::ListAnnotationsOfVisibleSets(root, own);
  const QelListValQelBaseUnknown_var& annotations = listed ? *listed : own;
  if (annotations.Size() == 0) return S_OK;
  QelBaseUnknown_var made;
  QelLumInstantiateComponentBase(kNamingComponent, made);
  QelVar<QelILumNamingComponent> naming(made.get());
  if (!naming) {
    QelAssertPointer("QelILumNamingComponent");
    return E_UNEXPECTED;
  }
  for (int position = 1; position <= annotations.Size(); ++position) {
    const QelBaseUnknown_var& annotation = annotations[position];
    if (!annotation) {
      QelAssertNullHandler();
      continue;
    }
    const bool isVisu = IsTextOrDimensionVisu(annotation.get());
    if (visu) (*visu)[static_cast<size_t>(position - 1)] = isVisu ? 1 : 0;
    if (isVisu) continue;
    QelUnicodeString typeName;
    QelUnicodeString subTypeName;
    naming->GetTypeName(annotation.get(), typeName);
    naming->GetSubTypeName(annotation.get(), subTypeName);
    TypeIndex::Group& group = index.groups[typeName.Utf8()];
    if (!group.group) {
      auto created = QelMakeVar<QelRovFacetPropertyGroup>(typeName, QelUnicodeString(),
                                                       static_cast<QelBaseUnknown*>(type), false);
      type->AddProperty(static_cast<QelBaseUnknown*>(created.get()));
      group.group = created.get();
    }
    QelRovFacetPropertyItemTypeAnnot*& item = group.items[subTypeName.Utf8()];
    if (!item) {
      auto created = QelMakeVar<QelRovFacetPropertyItemTypeAnnot>(subTypeName, filterData,
                                                               static_cast<QelBaseUnknown*>(group.group));
      group.group->AddProperty(static_cast<QelBaseUnknown*>(created.get()));
      item = created.get();
    }
    item->AddAnnotation(annotation.get());
  }
  naming = nullptr;
  type->RefreshCheckState();
  return S_OK;
}

HRESULT QelRovFacetAnnotation::BuildKindRows(QelBaseUnknown* root, QelRovFacetFilterData* filterData,
                                             const QelListValQelBaseUnknown_var* listed,
                                             const std::vector<signed char>* visu) {
  if (!root || !filterData || PropertyList().Size() != kPropertyCount) {
    QelAssertBool("root, filter data and 5 properties");
    return E_UNEXPECTED;
  }
  QelRovFacetPropertyGroup* custom = PropertyGroupAt(kCustom);
  if (!custom) return E_UNEXPECTED;
  const QelListValQelBaseUnknown_var& kinds = custom->GetPropertyList();
  if (kinds.Size() != KindCount) {
    QelAssertBool("7 kind groups");
    return E_UNEXPECTED;
  }
  // Resolved once: the annotations of a pass land in these seven groups. The rows of the
  // previous pass are taken out, to be renewed where their annotation comes again.
  QelRovFacetPropertyGroup* kindGroups[KindCount + 1] = {};
  PreviousRows previous[KindCount + 1];
  for (int kindIndex = 1; kindIndex <= KindCount; ++kindIndex) {
    kindGroups[kindIndex] = QelSysDynamicCast<QelRovFacetPropertyGroup>(kinds[kindIndex].get());
    if (!kindGroups[kindIndex]) continue;
    previous[kindIndex].Take(kindGroups[kindIndex]->GetPropertyList());
    kindGroups[kindIndex]->GetPropertyList().Reserve(previous[kindIndex].rows.Size());
  }
  QelListValQelBaseUnknown_var own;
  if (!listed) QelRovFacetServices::ListAnnotationsOfVisibleSets(root, own);
  const QelListValQelBaseUnknown_var& annotations = listed ? *listed : own;
  if (annotations.Size() == 0) return S_OK;
  QelVar<QelITPSTypeClassifier> classifier;
  for (int position = 1; position <= annotations.Size(); ++position) {
    const QelBaseUnknown_var& annotation = annotations[position];
    if (!annotation) {
      QelAssertNullHandler();
      continue;
    }
    if (!classifier) {
      classifier = ClassifierFrom(annotation.get());
      if (!classifier) continue;
    }
    QelBaseUnknown_var typeObject;
    classifier->GetType(annotation.get(), typeObject);
    QelVar<QelITPSType> type(typeObject.get());
    if (!type) {
      const QelMetaObject* meta = annotation->GetMetaObject();
      QelAssertPointer(meta ? meta->Name() : "annotation");
      continue;
    }
    int code = 0;
    type->GetTypeCode(code);
    type = nullptr;
    typeObject = nullptr;
    if (code == kUnclassifiedCode) continue;
    const signed char known = visu ? (*visu)[static_cast<size_t>(position - 1)] : -1;
    if (known == 1 || (known < 0 && IsTextOrDimensionVisu(annotation.get()))) continue;
    const int kindIndex = KindOfTypeCode(code);
    if (kindIndex == 0) {
      QelAssertBool("annotation type code of a kind");
      continue;
    }
    QelRovFacetPropertyGroup* kind = kindGroups[kindIndex];
    if (!kind) {
      QelAssertPointer("QelRovFacetPropertyGroup");
      continue;
    }
    if (QelBaseUnknown* renewed = previous[kindIndex].Renew(annotation.get(), filterData)) {
      kind->AddProperty(renewed);
      continue;
    }
    auto item = QelMakeVar<QelRovFacetPropertyItemCustomAnnot>(annotation.get(), filterData,
                                                               static_cast<QelBaseUnknown*>(kind));
    kind->AddProperty(static_cast<QelBaseUnknown*>(item.get()));
  }
  classifier = nullptr;
  custom->RefreshCheckState();
  return S_OK;
}

HRESULT QelRovFacetAnnotation::ApplyPropertyChange(QelBaseUnknown* property) {
  if (!property || PropertyList().Size() != kPropertyCount) {
    QelAssertPointer(property ? "5 properties" : "property");
    return E_UNEXPECTED;
  }
  QelBaseUnknown_var root;
  QelRovFacetFilterData* filterData = nullptr;
  QelRovFacetGroup::GetRootAndFilterData(FacetGroupRef(), root, filterData);
  if (!root) return S_FALSE;
  if (!filterData) {
    QelAssertPointer("QelRovFacetFilterData");
    return E_UNEXPECTED;
  }
  if (IsProperty(kAll, property)) {
    QelListValQelBaseUnknown_var annotations;
    QelRovFacetServices::ListAnnotationsOfVisibleSets(root.get(), annotations);
    QelRovFacetServices::EnableDisableDisplay(annotations, 1, filterData);
    return S_OK;
  }
  const bool isDefault = IsProperty(kDefaultAnnot, property);
  const bool isTolerance = IsProperty(kTolAnnot, property);
  if (!isDefault && !isTolerance) return S_OK;
  auto* changed = QelSysDynamicCast<QelRovFacetProperty>(property);
  const QelCheckState state = changed ? changed->GetCheckState() : PartiallyChecked;
  if (state != Checked && state != Unchecked) {
    QelAssertBool("Checked or Unchecked");
    return E_UNEXPECTED;
  }
  if (isDefault) {
    filterData->DefaultAnnot = state == Checked;
  } else {
    filterData->TolAnnot = state == Checked;
    QelPropertyOperator leftOp = QelPropertyOperatorLessOrEqual;
    QelPropertyOperator rightOp = QelPropertyOperatorLessOrEqual;
    double* left = nullptr;
    double* right = nullptr;
    if (changed->GetToleranceValues(leftOp, left, rightOp, right) != S_OK) {
      QelAssertBool("GetToleranceValues");
      leftOp = rightOp = QelPropertyOperatorLessOrEqual;
      left = right = nullptr;
    }
    filterData->SetToleranceValues(leftOp, left, rightOp, right);
  }
  // The current choice is applied again, now through the changed filter data.
  for (int position = kAll; position <= kCustom; ++position) {
    QelRovFacetProperty* choice = QelSysDynamicCast<QelRovFacetProperty>(PropertyList()[position].get());
    if (!choice || choice->GetCheckState() != Checked) continue;
    if (position == kAll)
      ApplyPropertyChange(PropertyList()[kAll].get());
    else
      choice->ApplyCheckState();
    return S_OK;
  }
  QelAssertPointer("checked choice");
  return E_UNEXPECTED;
}
