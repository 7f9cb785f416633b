#include "FacetModel.h"

#include "QelDelayedDestruction.h"
#include "QelDlgNotify.h"
#include "QelIAlias.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetServices.h"

FacetModel::FacetModel(const QelBaseUnknown_var& model) : root(model) {
  QelApplicationFrame::CreateFrame();
  editor = Make<QelFrmEditor>(root.get());
  group = Make<TestFacetGroup>(editor.get());
  other = Make<TestFacet>(group.get());
  if (root) SetUIActive({root.get()});
  if (root)
    callback = QelRovFacetServices::AddDisplayChangeCallback(root.get(), group.get(), [this](QelBaseUnknown*, QelBaseUnknown* object) {
      changes.push_back((Shown(QelBaseUnknown_var(object)) ? "+" : "-") + LabelOf(object));
    });
}

FacetModel::~FacetModel() {
  QelDlgNotify::ClearAnswers();
  QelDelayedDestruction::FlushIdle();
  if (callback) QelCallbackManager::Get().RemoveCallback(callback);
}

void FacetModel::SetUIActive(const std::vector<QelBaseUnknown*>& objects) {
  auto path = Make<QelPathElement>();
  for (QelBaseUnknown* object : objects) path->AddChildElement(object);
  editor->SetUIActivePath(path.get());
}

std::vector<std::string> FacetModel::TakeChanges() { return std::exchange(changes, {}); }

QelRovFacetProperty* PropertyOf(QelRovFacet* facet, int position) {
  QelListValQelBaseUnknown_var properties;
  facet->GetProperties(properties);
  return QelSysDynamicCast<QelRovFacetProperty>(properties[position].get());
}

std::string LabelOf(QelBaseUnknown* object) {
  QelUnicodeString label;
  if (auto* property = QelSysDynamicCast<QelRovFacetProperty>(object))
    property->GetName(label);
  else if (QelVar<QelIAlias> named{object})
    named->GetAlias(label);
  return label.Utf8();
}

std::vector<std::string> ChildLabels(QelBaseUnknown* object) {
  std::vector<std::string> labels;
  auto* group = QelSysDynamicCast<QelRovFacetPropertyGroup>(object);
  if (!group) return labels;
  for (const auto& child : group->GetPropertyList()) labels.push_back(LabelOf(child.get()));
  return labels;
}

bool Shown(const QelBaseUnknown_var& object) { return QelRovFacetServices::IsDisplayEnabled(object.get()) == S_OK; }
