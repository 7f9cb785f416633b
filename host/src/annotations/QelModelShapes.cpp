#include "QelModelShapes.h"

#include <cmath>
#include <filesystem>
#include <stdexcept>

#include "QelAnnotationModel.h"
#include "QelMeshFileReader.h"

namespace {
using Json = nlohmann::json;

[[noreturn]] void Refuse(const std::string& at, const std::string& what) { throw std::runtime_error(at + ": " + what); }

double Number(const Json& j, const std::string& at) {
  if (!j.is_number()) Refuse(at, std::string("expected a number, found ") + j.type_name());
  const double v = j.get<double>();
  if (!std::isfinite(v)) Refuse(at, "expected a finite number");
  return v;
}

QelMathVector Vector(const Json& o, const char* key, const std::string& at) {
  auto it = o.find(key);
  const std::string here = at + "." + key;
  if (it == o.end()) Refuse(at, std::string("missing key '") + key + "'");
  if (!it->is_array() || it->size() != 3) Refuse(here, "expected an array of 3 numbers");
  return {Number((*it)[0], here + "[0]"), Number((*it)[1], here + "[1]"), Number((*it)[2], here + "[2]")};
}

void OnlyKeys(const Json& o, const std::string& at, std::initializer_list<const char*> keys) {
  for (auto it = o.begin(); it != o.end(); ++it) {
    bool known = false;
    for (const char* k : keys) known = known || it.key() == k;
    if (!known) Refuse(at, "unknown key '" + it.key() + "'");
  }
}

// A mesh written out in the file: vertices and triangles as index triples into them.
QelMeshShape Triangles(const Json& body, const std::string& here) {
  OnlyKeys(body, here, {"vertices", "faces"});
  QelMeshShape mesh;
  const Json* vertices = body.contains("vertices") ? &body["vertices"] : nullptr;
  const Json* faces = body.contains("faces") ? &body["faces"] : nullptr;
  if (!vertices || !vertices->is_array()) Refuse(here + ".vertices", "expected an array of [x, y, z]");
  if (!faces || !faces->is_array()) Refuse(here + ".faces", "expected an array of [i, j, k]");
  mesh.vertices.reserve(vertices->size());
  for (size_t i = 0; i < vertices->size(); ++i) {
    const std::string at = here + ".vertices[" + std::to_string(i) + "]";
    const Json& v = (*vertices)[i];
    if (!v.is_array() || v.size() != 3) Refuse(at, "expected an array of 3 numbers");
    mesh.vertices.push_back({static_cast<float>(Number(v[0], at + "[0]")), static_cast<float>(Number(v[1], at + "[1]")),
                             static_cast<float>(Number(v[2], at + "[2]"))});
  }
  mesh.triangles.reserve(faces->size());
  for (size_t i = 0; i < faces->size(); ++i) {
    const std::string at = here + ".faces[" + std::to_string(i) + "]";
    const Json& f = (*faces)[i];
    if (!f.is_array() || f.size() != 3) Refuse(at, "expected an array of 3 vertex indices");
    std::array<uint32_t, 3> t{};
    for (size_t k = 0; k < 3; ++k) {
      if (!f[k].is_number_unsigned() || f[k].get<uint64_t>() >= mesh.vertices.size()) {
        Refuse(at + "[" + std::to_string(k) + "]", "expected the index of one of the " +
                                                       std::to_string(mesh.vertices.size()) + " vertices");
      }
      t[k] = static_cast<uint32_t>(f[k].get<uint64_t>());
    }
    mesh.triangles.push_back(t);
  }
  return mesh;
}

QelMeshShape Item(const Json& item, const std::string& at, const std::string& modelPath) {
  if (!item.is_object() || item.size() != 1) {
    Refuse(at, "expected an object with one of 'box', 'cylinder', 'mesh', 'triangles'");
  }
  const std::string kind = item.begin().key();
  const Json& body = item.begin().value();
  const std::string here = at + "." + kind;
  if (!body.is_object()) Refuse(here, std::string("expected an object, found ") + body.type_name());
  if (kind == "box") {
    OnlyKeys(body, here, {"min", "max"});
    const QelMathVector lo = Vector(body, "min", here), hi = Vector(body, "max", here);
    if (lo.x == hi.x || lo.y == hi.y || lo.z == hi.z) Refuse(here, "a box needs a size in x, y and z");
    return QelMeshShape::Box(lo, hi);
  }
  if (kind == "cylinder") {
    OnlyKeys(body, here, {"base", "axis", "radius", "sides"});
    const QelMathVector base = Vector(body, "base", here), axis = Vector(body, "axis", here);
    if (!body.contains("radius")) Refuse(here, "missing key 'radius'");
    const double radius = Number(body["radius"], here + ".radius");
    if (radius <= 0.0) Refuse(here + ".radius", "expected a radius above 0");
    if (axis.SquareNorm() == 0.0) Refuse(here + ".axis", "the axis has no length");
    int sides = 32;
    if (auto it = body.find("sides"); it != body.end()) {
      if (!it->is_number_integer() || it->get<int>() < 3 || it->get<int>() > 1024)
        Refuse(here + ".sides", "expected an integer from 3 to 1024");
      sides = it->get<int>();
    }
    return QelMeshShape::Cylinder(base, axis, radius, sides);
  }
  if (kind == "mesh") {
    OnlyKeys(body, here, {"file"});
    if (!body.contains("file") || !body["file"].is_string()) Refuse(here + ".file", "expected a file name");
    const std::string name = body["file"].get<std::string>();
    std::filesystem::path file(name);
    if (file.is_relative()) file = std::filesystem::path(modelPath).parent_path() / file;
    QelMeshShape mesh;
    std::string reason;
    if (!QelMeshFileReader::Read(file.string(), mesh, reason)) Refuse(here + ".file", file.string() + ": " + reason);
    return mesh;
  }
  if (kind == "triangles") return Triangles(body, here);
  Refuse(at, "unknown shape '" + kind + "' (expected 'box', 'cylinder', 'mesh' or 'triangles')");
}
}  // namespace

std::shared_ptr<const QelMeshShape> QelModelShapes::Read(const Json& value, const std::string& at,
                                                         QelBaseUnknown* product) {
  QelAnnotationModel* model = QelAnnotationModel::Of(product);
  const std::string modelPath = model ? model->SourceName() : std::string();
  auto shape = std::make_shared<QelMeshShape>();
  if (value.is_array()) {
    for (size_t i = 0; i < value.size(); ++i) shape->Append(Item(value[i], at + "[" + std::to_string(i) + "]", modelPath));
  } else {
    shape->Append(Item(value, at, modelPath));
  }
  return shape;
}
