#include "QelModelScene.h"

#include <unordered_map>

#include "QelAnnotationModel.h"
#include "QelIVisuObjectFilter.h"
#include "QelLumAnnotation.h"
#include "QelLumAnnotationSet.h"
#include "QelPLMProductOccurrence.h"

QelModelScene::QelModelScene(QelBaseUnknown* root) : root_(root) {}

void* QelModelScene::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIVisuSceneSource>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

QelRenderColor QelModelScene::KindColor(const std::string& typeName) {
  static const std::unordered_map<std::string, QelRenderColor> colors = {
      {"Datum", {0.10f, 0.35f, 0.90f}},          {"Geometrical Tolerance", {0.85f, 0.10f, 0.10f}},
      {"Dimension", {0.05f, 0.60f, 0.15f}},      {"Roughness", {0.75f, 0.45f, 0.00f}},
      {"Weld", {0.55f, 0.15f, 0.70f}},           {"Note", {0.00f, 0.55f, 0.60f}},
      {"Semantic Text", {0.00f, 0.55f, 0.60f}},  {"Annotated Geometry", {0.80f, 0.10f, 0.55f}},
  };
  auto it = colors.find(typeName);
  return it == colors.end() ? QelRenderColor{0.15f, 0.15f, 0.15f} : it->second;
}

namespace {
// Shape colours by depth in the tree, so that neighbouring parts can be told apart.
constexpr QelRenderColor kPartColors[] = {
    {0.62f, 0.66f, 0.72f}, {0.80f, 0.72f, 0.55f}, {0.55f, 0.72f, 0.62f}, {0.72f, 0.60f, 0.72f}, {0.60f, 0.70f, 0.85f}};

void CollectProducts(QelPLMProductOccurrence* product, const QelMathTransformation& toRoot, int& index,
                     QelRenderScene& scene, QelIVisuObjectFilter* filter,
                     std::unordered_map<QelBaseUnknown*, QelMathTransformation>& placed) {
  placed[product] = toRoot;
  const bool shown = product->IsShown() && !(filter && filter->IsFilteredOut(product));
  if (shown && product->Shape()) {
    scene.meshes.push_back({product->Shape(), toRoot, kPartColors[index % std::size(kPartColors)]});
    ++index;
  }
  // A hidden product hides its children's shapes too, but their placements are still known
  // for the annotation sets they own.
  for (const auto& child : product->Children()) {
    const size_t before = scene.meshes.size();
    CollectProducts(child.get(), toRoot * child->Placement(), index, scene, filter, placed);
    if (!shown) scene.meshes.resize(before);
  }
}
}  // namespace

void QelModelScene::CollectScene(QelRenderScene& scene, QelIVisuObjectFilter* filter) {
  auto* root = QelSysDynamicCast<QelPLMProductOccurrence>(root_.GetRaw());
  QelAnnotationModel* model = root ? QelAnnotationModel::Of(root) : nullptr;
  if (!model) return;
  std::unordered_map<QelBaseUnknown*, QelMathTransformation> placed;
  int index = 0;
  CollectProducts(root, QelMathTransformation(), index, scene, filter, placed);
  for (const auto& set : model->Sets()) {
    // A filter may keep in what the display hides (a capture's preview), never the reverse.
    const auto drawn = [filter](QelModelObject* object) {
      if (filter && filter->IsFilteredOut(object)) return false;
      return object->IsShown() || (filter && filter->IsKeptIn(object));
    };
    if (!drawn(set.get())) continue;
    QelBaseUnknown* owner = set->Owner();
    auto at = placed.find(owner ? owner->GetImpl() : nullptr);
    const QelMathTransformation toRoot = at == placed.end() ? QelMathTransformation() : at->second;
    for (const auto& annotation : set->Annotations()) {
      if (!drawn(annotation.get())) continue;
      QelRenderAnnotation mark;
      QelMathPoint anchor;
      annotation->GetAnchor(anchor);
      mark.anchor = toRoot.Apply(anchor);
      int count = 0;
      annotation->GetSegmentCount(count);
      for (int i = 0; i < count; ++i) {
        QelMathPoint from, to;
        if (annotation->GetSegment(i, from, to) != S_OK) continue;
        mark.segments.push_back(toRoot.Apply(from));
        mark.segments.push_back(toRoot.Apply(to));
      }
      // The leader to the annotated geometry is drawn like the annotation's own lines.
      if (const auto& leader = annotation->Leader()) {
        mark.segments.push_back(mark.anchor);
        mark.segments.push_back(toRoot.Apply(*leader));
      }
      mark.color = KindColor(annotation->TypeName());
      mark.text = annotation->Label();
      // A tolerance frame and a datum letter are drawn as boxes; other labels as one.
      if (annotation->Frame()) mark.compartments = annotation->Compartments();
      scene.annotations.push_back(std::move(mark));
    }
  }
}
