#include "QelModelJsonWriter.h"

#include <charconv>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <unordered_map>

#include <nlohmann/json.hpp>

#include "QelAnnotationModel.h"
#include "QelICamera.h"
#include "QelLumAnnotation.h"
#include "QelLumAnnotationSet.h"
#include "QelLumCapture.h"
#include "QelLumView.h"
#include "QelPLMProductOccurrence.h"
#include "QelPLMRepInstance.h"
#include "QelPLMRepReference.h"

namespace {
// A vertex is a float: the shortest decimal that reads back to it, rather than the 17
// digits of the double it widens to, halves a mesh's text and the time to write and read it.
double ShortFloat(float value) {
  char text[32];
  const auto end = std::to_chars(text, text + sizeof text - 1, value).ptr;
  *end = '\0';
  return std::strtod(text, nullptr);
}

using Json = nlohmann::ordered_json;

Json Vec(const QelMathVector& v) { return Json::array({v.x, v.y, v.z}); }

class Writer {
 public:
  Json Product(QelPLMProductOccurrence* p, bool isRoot) {
    Json j;
    j["id"] = Id(p, "p", products_);
    j["alias"] = p->Alias();
    j["icon"] = p->Icon();
    j["shown"] = p->IsShown();
    bool light = false;
    p->IsLightLoadMode(light);
    j["lightLoadMode"] = light;
    if (!isRoot && !p->Placement().IsIdentity()) {
      const QelMathTransformation& t = p->Placement();
      j["placement"] = {{"origin", Vec(t.GetTranslation())}, {"x", Vec(t.GetXAxis())}, {"y", Vec(t.GetYAxis())},
                        {"z", Vec(t.GetZAxis())}};
    }
    if (const auto& shape = p->Shape(); shape && !shape->triangles.empty()) {
      Json vertices = Json::array(), faces = Json::array();
      for (const auto& v : shape->vertices)
        vertices.push_back(Json::array({ShortFloat(v[0]), ShortFloat(v[1]), ShortFloat(v[2])}));
      for (const auto& t : shape->triangles) faces.push_back(Json::array({t[0], t[1], t[2]}));
      j["shape"] = {{"triangles", {{"vertices", std::move(vertices)}, {"faces", std::move(faces)}}}};
    }
    Json reps = Json::array();
    for (const auto& rep : p->RepInstances()) {
      Json r;
      r["id"] = Id(rep.get(), "r", reps_);
      r["alias"] = rep->Alias();
      if (rep->Reference()) r["reference"] = rep->Reference()->Alias();
      r["icon"] = rep->Icon();
      reps.push_back(std::move(r));
    }
    if (!reps.empty()) j["reps"] = std::move(reps);
    Json children = Json::array();
    for (const auto& child : p->Children()) children.push_back(Product(child.get(), false));
    if (!children.empty()) j["children"] = std::move(children);
    return j;
  }

  Json Set(QelLumAnnotationSet* s) {
    Json j;
    j["id"] = Id(s, "s", sets_);
    j["alias"] = s->Alias();
    j["icon"] = s->Icon();
    j["owner"] = Known(s->Owner());
    if (s->Rep()) j["rep"] = Known(s->Rep());
    j["light"] = s->IsLight();
    j["kind"] = s->Kind();
    if (s->RootScope() != QelRootSetScope::None) j["rootSet"] = s->RootScope() == QelRootSetScope::Direct ? "direct" : "arm";
    j["shown"] = s->IsShown();
    Json annotations = Json::array(), views = Json::array(), captures = Json::array();
    for (const auto& a : s->Annotations()) annotations.push_back(Annotation(a.get()));
    for (const auto& v : s->Views()) views.push_back(View(v.get()));
    for (const auto& c : s->Captures()) captures.push_back(Capture(c.get()));
    j["annotations"] = std::move(annotations);
    j["views"] = std::move(views);
    j["captures"] = std::move(captures);
    if (const auto& others = s->OtherElements()) {
      Json list = Json::array();
      for (const auto& link : *others)
        if (QelBaseUnknown* e = link.GetRaw()) list.push_back(Known(e));
      j["otherElements"] = std::move(list);
    }
    return j;
  }

  // Every view is named before any set is written: a view may refer to views (reference
  // or related views) that come later in the model.
  void NameViews(QelAnnotationModel* model) {
    for (const auto& s : model->Sets())
      for (const auto& v : s->Views()) Id(v.get(), "v", views_);
  }

 private:
  using Ids = std::unordered_map<QelBaseUnknown*, std::string>;

  std::string Id(QelBaseUnknown* object, const char* prefix, Ids& ids) {
    QelBaseUnknown* key = object->GetImpl();
    auto [it, added] = ids.emplace(key, std::string());
    if (added) {
      it->second = prefix + std::to_string(ids.size());
      all_.emplace(key, it->second);
    }
    return it->second;
  }

  Json Known(QelBaseUnknown* object) {
    auto it = all_.find(object ? object->GetImpl() : nullptr);
    return it == all_.end() ? Json(nullptr) : Json(it->second);
  }

  Json Annotation(QelLumAnnotation* a) {
    Json j;
    j["id"] = Id(a, "a", annotations_);
    j["alias"] = a->Alias();
    if (!a->NavigationNames().empty()) j["names"] = a->NavigationNames();
    j["icon"] = a->Icon();
    j["type"] = a->TypeName();
    j["subType"] = a->SubTypeName();
    j["code"] = a->TypeCode();
    j["geometry"] = a->IsGeometry();
    if (a->Visu() != QelAnnotationVisu::None) j["visu"] = a->Visu() == QelAnnotationVisu::Text ? "text" : "dimension";
    j["tolerance"] = a->Tolerance() ? Json(*a->Tolerance()) : Json(nullptr);
    j["default"] = a->IsDefault();
    j["shown"] = a->IsShown();
    QelMathPoint anchor;
    a->GetAnchor(anchor);
    j["anchor"] = Vec(anchor);
    int count = 0;
    a->GetSegmentCount(count);
    if (count > 0) {
      Json segments = Json::array();
      for (int i = 0; i < count; ++i) {
        QelMathPoint from, to;
        a->GetSegment(i, from, to);
        segments.push_back(Json::array({Vec(from), Vec(to)}));
      }
      j["segments"] = std::move(segments);
    }
    if (a->Leader()) j["leader"] = Vec(*a->Leader());
    if (const auto& f = a->Frame()) {
      Json frame = {{"zone", f->zone}, {"datums", f->datums}};
      if (!f->zoneShape.empty()) frame["zoneShape"] = f->zoneShape;
      if (!f->material.empty()) frame["material"] = f->material;
      j["frame"] = std::move(frame);
    }
    if (const auto& d = a->Dimension()) {
      Json dimension = {{"nominal", d->nominal}};
      if (d->upper) dimension[d->limits ? "max" : "upper"] = *d->upper;
      if (d->lower) dimension[d->limits ? "min" : "lower"] = *d->lower;
      j["dimension"] = std::move(dimension);
    }
    return j;
  }

  Json Links(const std::vector<QelBaseUnknown_WR>& links) {
    Json list = Json::array();
    for (const auto& link : links)
      if (QelBaseUnknown* e = link.GetRaw()) list.push_back(Known(e));
    return list;
  }

  Json View(QelLumView* v) {
    Json j;
    j["id"] = Id(v, "v", views_);
    j["alias"] = v->Alias();
    j["icon"] = v->Icon();
    if (const auto& plane = v->Plane()) {
      j["plane"] = {{"origin", Vec(plane->GetOrigin())}, {"normal", Vec(plane->GetNormal())},
                    {"first", Vec(plane->GetFirstDirection())}, {"second", Vec(plane->GetSecondDirection())}};
    } else {
      j["plane"] = nullptr;
    }
    j["elements"] = Links(v->Elements());
    j["extraction"] = v->IsExtraction();
    if (!v->ReferenceViews().empty()) j["references"] = Links(v->ReferenceViews());
    if (!v->RelatedViews().empty()) j["related"] = Links(v->RelatedViews());
    j["shown"] = v->IsShown();
    return j;
  }

  Json Capture(QelLumCapture* c) {
    Json j;
    j["id"] = Id(c, "c", captures_);
    j["alias"] = c->Alias();
    j["icon"] = c->Icon();
    if (c->LinkedView()) j["view"] = Known(c->LinkedView());
    if (QelICamera* camera = c->Camera()) {
      QelMathPoint origin, target;
      QelMathVector zenith;
      camera->GetOrigin(origin);
      camera->GetTarget(target);
      camera->GetZenith(zenith);
      j["camera"] = {{"origin", Vec(origin)}, {"target", Vec(target)}, {"zenith", Vec(zenith)}};
    }
    j["shown"] = c->IsShown();
    return j;
  }

  Ids products_, reps_, sets_, annotations_, views_, captures_, all_;
};
}  // namespace

bool QelModelJsonWriter::Write(QelBaseUnknown* root, std::ostream& out, bool indented) {
  QelAnnotationModel* model = QelAnnotationModel::Of(root);
  if (!model || !model->Root() || !root || model->Root()->GetImpl() != root->GetImpl()) return false;
  Writer writer;
  Json doc;
  doc["format"] = "qel-product-model";
  doc["version"] = 1;
  if (!model->LengthUnit().empty()) doc["unit"] = model->LengthUnit();
  doc["root"] = writer.Product(model->Root(), true);
  writer.NameViews(model);
  Json sets = Json::array();
  for (const auto& s : model->Sets()) sets.push_back(writer.Set(s.get()));
  doc["sets"] = std::move(sets);
  if (!model->NotRead().empty()) {
    Json notRead = Json::array();
    for (const QelModelNotRead& n : model->NotRead()) {
      Json item = {{"kind", n.kind}, {"count", n.count}};
      if (!n.entities.empty()) item["entities"] = n.entities;
      notRead.push_back(std::move(item));
    }
    doc["notRead"] = std::move(notRead);
  }
  out << doc.dump(indented ? 1 : -1) << '\n';
  return static_cast<bool>(out);
}

bool QelModelJsonWriter::WriteFile(QelBaseUnknown* root, const std::string& path, std::string& error) {
  const std::string temporary = path + ".part";
  {
    std::ofstream out(temporary, std::ios::binary | std::ios::trunc);
    if (!out) {
      error = path + ": cannot create the file";
      return false;
    }
    if (!Write(root, out)) {
      out.close();
      std::remove(temporary.c_str());
      error = path + ": the model could not be written";
      return false;
    }
  }
  std::error_code failed;
  std::filesystem::rename(temporary, path, failed);
  if (failed) {
    std::remove(temporary.c_str());
    error = path + ": cannot write the file (" + failed.message() + ")";
    return false;
  }
  return true;
}
