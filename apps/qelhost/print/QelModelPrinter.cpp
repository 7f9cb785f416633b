#include "QelModelPrinter.h"

#include <cstdio>
#include <functional>
#include <string>

#include "QelAnnotationComponents.h"
#include "QelAnnotationLabel.h"
#include "QelIAlias.h"
#include "QelILumCapture.h"
#include "QelILumCollection.h"
#include "QelILumGeometry.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelILumNamingComponent.h"
#include "QelILumSet.h"
#include "QelILumSetComponent.h"
#include "QelIPLMNavOccurrence.h"
#include "QelITPS.h"
#include "QelITPSDimVisu.h"
#include "QelITPSExtractionView.h"
#include "QelITPSLightSet.h"
#include "QelITPSTextVisu.h"
#include "QelITPSType.h"
#include "QelITPSTypeClassifier.h"
#include "QelITPSView.h"
#include "QelModelBuilder.h"
#include "QelRovFacetServices.h"

namespace {
std::string AliasOf(QelBaseUnknown* object) {
  QelUnicodeString alias;
  if (QelVar<QelIAlias> named{object}) named->GetAlias(alias);
  return alias.IsEmpty() ? std::string("(no name)") : alias.Utf8();
}

const char* State(QelBaseUnknown* object) {
  return QelRovFacetServices::IsDisplayEnabled(object) == S_OK ? "[shown]" : "[hidden]";
}

std::string Number(double v) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", v);
  return text;
}

std::string Vector(const QelMathVector& v) { return "(" + Number(v.x) + ", " + Number(v.y) + ", " + Number(v.z) + ")"; }

struct Printer {
  std::ostream& out;
  std::function<void(QelBaseUnknown*)> onObject;  // told of every object the walk reaches
  QelVar<QelILumSetComponent> sets;
  QelVar<QelILumNamingComponent> naming;
  QelListValQelBaseUnknown_var allSets;

  void Line(int depth, const std::string& text) { out << std::string(2 * depth, ' ') << text << '\n'; }

  void Product(QelBaseUnknown* product, int depth) {
    if (onObject) onObject(product);
    std::string text = "product " + AliasOf(product) + " " + State(product);
    bool light = false;
    if (QelVar<QelILumLightLoadModeObservable> observable{product}) observable->IsLightLoadMode(light);
    if (light) text += " light-load mode";
    if (depth == 0)
      if (const std::string unit = QelAnnotationLabel::LengthUnit(product); !unit.empty()) text += ", lengths in " + unit;
    QelMathTransformation placement;
    if (QelVar<QelIPLMNavOccurrence> occurrence{product};
        occurrence && occurrence->GetPlacement(placement) == S_OK && !placement.IsIdentity()) {
      text += ", placed at " + Vector(placement.GetTranslation());
      const QelMathTransformation translationOnly = QelMathTransformation::Translation(placement.GetTranslation());
      if (!(placement == translationOnly))
        text += " with axes " + Vector(placement.GetXAxis()) + " " + Vector(placement.GetYAxis()) + " " +
                Vector(placement.GetZAxis());
    }
    Line(depth, text);
    for (const auto& set : allSets) {
      QelBaseUnknown_var owner;
      if (sets && sets->GetSetOwner(set.get(), owner) == S_OK && owner->IsEqual(product)) Set(set.get(), depth + 1);
    }
    QelListValQelBaseUnknown_var children;
    if (QelVar<QelIPLMNavOccurrence> occurrence{product}) occurrence->ListChildren(children);
    for (const auto& child : children) Product(child.get(), depth + 1);
  }

  void Set(QelBaseUnknown* set, int depth) {
    if (onObject) onObject(set);
    std::string text = "set " + AliasOf(set) + " " + State(set);
    if (QelVar<QelITPSLightSet>(set)) text += " light";
    Line(depth, text);
    QelVar<QelILumSet> lumSet(set);
    if (!lumSet) return;
    QelVar<QelILumCollection> list;
    lumSet->GetElements(list);
    Each(list, [&](QelBaseUnknown* a) { Annotation(a, depth + 1); });
    lumSet->GetViews(list);
    Each(list, [&](QelBaseUnknown* v) { View(v, depth + 1); });
    lumSet->GetCaptures(list);
    Each(list, [&](QelBaseUnknown* c) { Capture(c, depth + 1); });
  }

  template <class Fn>
  void Each(const QelVar<QelILumCollection>& list, Fn fn) {
    uint32_t count = 0;
    if (list) list->GetCount(count);
    for (uint32_t i = 0; i < count; ++i) {
      QelBaseUnknown_var item;
      if (list->GetItem(i, item) == S_OK) fn(item.get());
    }
  }

  void Annotation(QelBaseUnknown* annotation, int depth) {
    if (onObject) onObject(annotation);
    QelUnicodeString type, subType;
    if (naming) {
      naming->GetTypeName(annotation, type);
      naming->GetSubTypeName(annotation, subType);
    }
    int code = 0;
    QelBaseUnknown_var owner;
    double tolerance = 0;
    bool hasTolerance = false, isDefault = false;
    if (QelVar<QelITPS> tps{annotation}) {
      tps->GetTypeServices(owner);
      hasTolerance = tps->GetToleranceValue(tolerance) == S_OK;
      tps->IsDefaultAnnotation(isDefault);
    } else if (QelVar<QelILumGeometry> geometry{annotation}) {
      geometry->GetTypeServices(owner);
      hasTolerance = geometry->GetToleranceValue(tolerance) == S_OK;
      geometry->IsDefaultAnnotation(isDefault);
    }
    if (QelVar<QelITPSTypeClassifier> classifier{owner.get()}) {
      QelBaseUnknown_var typeObject;
      classifier->GetType(annotation, typeObject);
      if (QelVar<QelITPSType> t{typeObject.get()}) t->GetTypeCode(code);
    }
    std::string text = "annotation " + AliasOf(annotation) + " " + State(annotation) + " " + type.Utf8() + " / " +
                       subType.Utf8() + ", code " + std::to_string(code);
    if (hasTolerance) text += ", tolerance " + Number(tolerance);
    if (isDefault) text += ", default";
    if (QelVar<QelITPSTextVisu>(annotation)) text += ", text display";
    if (QelVar<QelITPSDimVisu>(annotation)) text += ", dimension display";
    if (const std::string label = QelAnnotationLabel::Text(annotation); !label.empty())
      text += ", reads \"" + label + "\"";
    Line(depth, text);
  }

  void View(QelBaseUnknown* view, int depth) {
    if (onObject) onObject(view);
    QelVar<QelITPSView> tpsView(view);
    std::string text = "view " + AliasOf(view) + " " + State(view);
    if (QelVar<QelITPSExtractionView>(view)) text += " extraction";
    QelMathPlane* plane = nullptr;
    if (tpsView && tpsView->GetPlane(plane) == S_OK && plane) {
      text += ", normal " + Vector(plane->GetNormal());
      delete plane;
    }
    QelVar<QelILumCollection> elements;
    if (tpsView) tpsView->GetElements(elements);
    std::string names;
    Each(elements, [&](QelBaseUnknown* e) { names += (names.empty() ? "" : ", ") + AliasOf(e); });
    if (!names.empty()) text += ", shows " + names;
    Line(depth, text);
  }

  void Capture(QelBaseUnknown* capture, int depth) {
    if (onObject) onObject(capture);
    std::string text = "capture " + AliasOf(capture) + " " + State(capture);
    QelVar<QelILumCapture> lumCapture(capture);
    bool linked = false;
    QelBaseUnknown_var view;
    if (lumCapture && lumCapture->IsLinkedToView(linked) == S_OK && linked && lumCapture->GetLinkedView(view) == S_OK) {
      text += ", view " + AliasOf(view.get());
    }
    QelVar<QelICamera> camera;
    if (lumCapture && lumCapture->GetCamera(camera) == S_OK && camera) {
      QelMathPoint origin, target;
      camera->GetOrigin(origin);
      camera->GetTarget(target);
      text += ", camera " + Vector(origin) + " -> " + Vector(target);
    } else {
      text += ", no camera";
    }
    Line(depth, text);
  }
};
}  // namespace

namespace {
void Walk(QelBaseUnknown* root, std::ostream& out, std::function<void(QelBaseUnknown*)> onObject) {
  Printer printer{out, std::move(onObject), nullptr, nullptr, {}};
  QelBaseUnknown_var component;
  QelLumInstantiateComponentBase(62, component);
  printer.sets = QelVar<QelILumSetComponent>(component.get());
  QelLumInstantiateComponentBase(59, component);
  printer.naming = QelVar<QelILumNamingComponent>(component.get());
  QelRovFacetServices::ListAllSets(root, printer.allSets, false);
  // What the source file held and the model lacks comes first: a reviewer must not take
  // the tree below for the whole file.
  for (const QelModelNotRead& missing : QelModelBuilder::NotRead(root)) {
    std::string text = "not read: " + std::to_string(missing.count) + " " + missing.kind;
    for (size_t i = 0; i < missing.entities.size(); ++i) text += (i ? ", " : " (") + missing.entities[i];
    if (!missing.entities.empty()) text += missing.entities.size() < missing.count ? ", ...)" : ")";
    printer.Line(0, text);
  }
  printer.Product(root, 0);
}
}  // namespace

void QelModelPrinter::Print(QelBaseUnknown* root, std::ostream& out) { Walk(root, out, nullptr); }

QelListValQelBaseUnknown_var QelModelPrinter::FindByAlias(QelBaseUnknown* root, const std::string& alias) {
  QelListValQelBaseUnknown_var found;
  std::ostream discard(nullptr);  // a stream without buffer drops what the walk prints
  Walk(root, discard, [&](QelBaseUnknown* object) {
    QelUnicodeString name;
    if (QelVar<QelIAlias> named{object}; named && named->GetAlias(name) == S_OK && name.Utf8() == alias)
      found.Append(object);
  });
  return found;
}
