#include "QelModelLoader.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <initializer_list>
#include <limits>
#include <new>
#include <stdexcept>
#include <string_view>
#include <unordered_map>
#include <vector>

#include <nlohmann/json.hpp>

#include "QelModelBuilder.h"
#include "QelModelJsonReader.h"
#include "QelModelShapes.h"
#include "QelTPSTypeClassifier.h"

namespace {
using Json = nlohmann::json;

// Larger files are refused before anything is read (docs/model-format.md).
constexpr uint64_t kMaxFileBytes = uint64_t{1} << 30;

// A position in the document, formatted only when something is wrong.
struct Where {
  const Where* parent = nullptr;
  const char* key = nullptr;
  int index = -1;

  Where Key(const char* k) const { return Where{this, k, -1}; }
  Where At(int i) const { return Where{this, nullptr, i}; }
  std::string Text() const {
    std::string head = parent ? parent->Text() : "$";
    if (key) return head + "." + key;
    if (index >= 0) return head + "[" + std::to_string(index) + "]";
    return head;
  }
};

struct Refused : std::runtime_error {
  Refused(const Where& where, const std::string& what) : std::runtime_error(where.Text() + ": " + what) {}
};

const char* TypeName(const Json& j) { return j.type_name(); }

const Json& Require(const Json& object, const char* key, const Where& where) {
  auto it = object.find(key);
  if (it == object.end()) throw Refused(where, std::string("missing key '") + key + "'");
  return *it;
}

void CheckKeys(const Json& object, const Where& where, std::initializer_list<std::string_view> allowed) {
  for (auto it = object.begin(); it != object.end(); ++it) {
    bool known = false;
    for (std::string_view k : allowed) known = known || it.key() == k;
    if (!known) throw Refused(where, "unknown key '" + it.key() + "'");
  }
}

const Json& Object(const Json& j, const Where& where) {
  if (!j.is_object()) throw Refused(where, std::string("expected an object, found ") + TypeName(j));
  return j;
}

const Json& Array(const Json& j, const Where& where) {
  if (!j.is_array()) throw Refused(where, std::string("expected an array, found ") + TypeName(j));
  return j;
}

std::string String(const Json& j, const Where& where) {
  if (!j.is_string()) throw Refused(where, std::string("expected a string, found ") + TypeName(j));
  return j.get<std::string>();
}

bool Bool(const Json& j, const Where& where) {
  if (!j.is_boolean()) throw Refused(where, std::string("expected true or false, found ") + TypeName(j));
  return j.get<bool>();
}

double Number(const Json& j, const Where& where) {
  if (!j.is_number()) throw Refused(where, std::string("expected a number, found ") + TypeName(j));
  return j.get<double>();
}

// Read wide, so that a value beyond the range of int is refused instead of wrapped.
int64_t Integer(const Json& j, const Where& where) {
  if (!j.is_number_integer()) throw Refused(where, std::string("expected an integer, found ") + TypeName(j));
  if (j.is_number_unsigned() && j.get<uint64_t>() > uint64_t(std::numeric_limits<int64_t>::max())) {
    throw Refused(where, "integer out of range: " + j.dump());
  }
  return j.get<int64_t>();
}

int SmallInteger(const Json& j, const Where& where) {
  const int64_t value = Integer(j, where);
  if (value < std::numeric_limits<int>::min() || value > std::numeric_limits<int>::max()) {
    throw Refused(where, "integer out of range: " + std::to_string(value));
  }
  return static_cast<int>(value);
}

QelMathVector Vector(const Json& j, const Where& where) {
  if (!j.is_array() || j.size() != 3) throw Refused(where, "expected an array of 3 numbers");
  return {Number(j[0], where.At(0)), Number(j[1], where.At(1)), Number(j[2], where.At(2))};
}

std::string OptString(const Json& o, const char* key, const Where& where, std::string fallback) {
  auto it = o.find(key);
  return it == o.end() ? fallback : String(*it, where.Key(key));
}

bool OptBool(const Json& o, const char* key, const Where& where, bool fallback) {
  auto it = o.find(key);
  return it == o.end() ? fallback : Bool(*it, where.Key(key));
}

// A product's placement in its father: the images of the axes and of the origin.
QelMathTransformation Placement(const Json& j, const Where& where) {
  const Json& p = Object(j, where);
  CheckKeys(p, where, {"origin", "x", "y", "z"});
  auto read = [&](const char* key, const QelMathVector& fallback) {
    auto it = p.find(key);
    if (it == p.end()) return fallback;
    Where at = where.Key(key);
    QelMathVector v = Vector(*it, at);
    // The reader already refuses literals beyond a double; an infinite axis would poison every point below.
    if (!std::isfinite(v.x) || !std::isfinite(v.y) || !std::isfinite(v.z)) throw Refused(at, "expected finite numbers");
    return v;
  };
  QelMathTransformation t(read("x", {1, 0, 0}), read("y", {0, 1, 0}), read("z", {0, 0, 1}), read("origin", {}));
  // Relative to the axes' lengths, so that a small but sound scale is not taken for a flat one.
  const double scale = t.GetXAxis().Norm() * t.GetYAxis().Norm() * t.GetZAxis().Norm();
  if (std::abs(t.Determinant()) <= 1e-12 * scale) {
    throw Refused(where, "degenerate placement: the x, y and z axes do not span space (determinant 0)");
  }
  return t;
}

class Loader {
 public:
  Loader(QelModelBuilder& builder, const std::string& text, const std::vector<QelModelJsonReader::SetLists>& lists)
      : builder_(builder), text_(text), lists_(lists) {}

  // The root's own attributes, read before the builder exists.
  static QelModelProductDesc RootDesc(const Json& doc) {
    Where top;
    Object(doc, top);
    if (String(Require(doc, "format", top), top.Key("format")) != "qel-product-model") {
      throw Refused(top.Key("format"), "expected \"qel-product-model\"");
    }
    Where at = top.Key("root");
    const Json& root = Object(Require(doc, "root", top), at);
    return QelModelProductDesc{.alias = OptString(root, "alias", at, "Root"),
                               .icon = OptString(root, "icon", at, "I_Product"),
                               .shown = OptBool(root, "shown", at, true),
                               .lightLoadMode = OptBool(root, "lightLoadMode", at, false)};
  }

  void Load(const Json& doc) {
    Where top;
    CheckKeys(doc, top, {"format", "version", "unit", "root", "sets", "notRead"});
    if (auto it = doc.find("unit"); it != doc.end()) builder_.SetLengthUnit(String(*it, top.Key("unit")));
    if (String(Require(doc, "format", top), top.Key("format")) != "qel-product-model") {
      throw Refused(top.Key("format"), "expected \"qel-product-model\"");
    }
    if (Integer(Require(doc, "version", top), top.Key("version")) != 1) {
      throw Refused(top.Key("version"), "unsupported version (this host reads version 1)");
    }
    Where rootAt = top.Key("root");
    const Json& root = Object(Require(doc, "root", top), rootAt);
    if (root.contains("placement")) {
      throw Refused(rootAt.Key("placement"), "the root product has no father to be placed in");
    }
    Product(root, rootAt, builder_.Root().get());
    if (auto notRead = doc.find("notRead"); notRead != doc.end()) NotRead(*notRead, top.Key("notRead"));
    auto it = doc.find("sets");
    if (it == doc.end()) return;
    Where setsAt = top.Key("sets");
    const Json& sets = Array(*it, setsAt);
    for (size_t i = 0; i < sets.size(); ++i) Set(sets[i], setsAt.At(static_cast<int>(i)), i);
  }

 private:
  void NotRead(const Json& list, const Where& where) {
    std::vector<QelModelNotRead> out;
    for (size_t i = 0; i < Array(list, where).size(); ++i) {
      const Where at = where.At(static_cast<int>(i));
      const Json& item = Object(list[i], at);
      CheckKeys(item, at, {"kind", "count", "entities"});
      QelModelNotRead entry{.kind = String(Require(item, "kind", at), at.Key("kind"))};
      if (auto ids = item.find("entities"); ids != item.end()) {
        for (size_t k = 0; k < Array(*ids, at.Key("entities")).size(); ++k)
          entry.entities.push_back(String((*ids)[k], at.Key("entities").At(static_cast<int>(k))));
      }
      const int64_t count = Integer(Require(item, "count", at), at.Key("count"));
      if (count < 1 || static_cast<uint64_t>(count) < entry.entities.size()) {
        throw Refused(at.Key("count"), "expected at least 1 and at least the number of entities");
      }
      entry.count = static_cast<size_t>(count);
      out.push_back(std::move(entry));
    }
    builder_.SetNotRead(std::move(out));
  }

  enum class Kind { Product, Rep, Set, Annotation, View, Capture };
  // One per identifier of the file, so kept small: the set of a set's member, to check
  // references that must stay within one set.
  struct Entry {
    QelBaseUnknown_var object;
    QelBaseUnknown* set;
    Kind kind;
  };

  void Declare(const Json& object, const Where& where, QelBaseUnknown* made, Kind kind, QelBaseUnknown* set = nullptr) {
    Where idAt = where.Key("id");
    std::string id = String(Require(object, "id", where), idAt);
    if (id.empty()) throw Refused(idAt, "empty identifier");
    if (!ids_.emplace(std::move(id), Entry{QelBaseUnknown_var(made), set, kind}).second) {
      throw Refused(idAt, "duplicate identifier '" + object.at("id").get<std::string>() + "'");
    }
  }

  const Entry& Lookup(const Json& ref, const Where& where, Kind kind, const char* what) {
    std::string id = String(ref, where);
    auto it = ids_.find(id);
    if (it == ids_.end()) throw Refused(where, std::string("unknown ") + what + " '" + id + "'");
    if (it->second.kind != kind) throw Refused(where, "'" + id + "' is not a " + what);
    return it->second;
  }

  void Product(const Json& p, const Where& where, QelBaseUnknown* made) {
    CheckKeys(p, where, {"id", "alias", "icon", "shown", "lightLoadMode", "placement", "shape", "reps", "children"});
    Declare(p, where, made, Kind::Product);
    if (auto it = p.find("shape"); it != p.end())
      builder_.SetShape(QelBaseUnknown_var(made), QelModelShapes::Read(*it, where.Key("shape").Text(), made));
    if (auto it = p.find("reps"); it != p.end()) {
      Where repsAt = where.Key("reps");
      const Json& reps = Array(*it, repsAt);
      for (size_t i = 0; i < reps.size(); ++i) {
        Where at = repsAt.At(static_cast<int>(i));
        const Json& r = Object(reps[i], at);
        CheckKeys(r, at, {"id", "alias", "reference", "icon"});
        QelModelRepInstanceDesc desc{.alias = OptString(r, "alias", at, ""),
                                     .referenceAlias = OptString(r, "reference", at, ""),
                                     .icon = OptString(r, "icon", at, "I_RepInstance")};
        Declare(r, at, builder_.AddRepInstance(QelBaseUnknown_var(made), desc).get(), Kind::Rep);
      }
    }
    if (auto it = p.find("children"); it != p.end()) {
      Where childrenAt = where.Key("children");
      const Json& children = Array(*it, childrenAt);
      for (size_t i = 0; i < children.size(); ++i) {
        Where at = childrenAt.At(static_cast<int>(i));
        const Json& c = Object(children[i], at);
        QelModelProductDesc desc{.alias = OptString(c, "alias", at, ""),
                                 .icon = OptString(c, "icon", at, "I_Product"),
                                 .shown = OptBool(c, "shown", at, true),
                                 .lightLoadMode = OptBool(c, "lightLoadMode", at, false)};
        if (auto placement = c.find("placement"); placement != c.end()) {
          desc.placement = Placement(*placement, at.Key("placement"));
        }
        QelBaseUnknown_var child = builder_.AddProduct(QelBaseUnknown_var(made), desc);
        Product(c, at, child.get());
      }
    }
  }

  void Set(const Json& j, const Where& where, size_t index) {
    const Json& s = Object(j, where);
    CheckKeys(s, where, {"id", "alias", "icon", "owner", "rep", "light", "kind", "rootSet", "shown", "annotations",
                         "views", "captures", "otherElements"});
    QelModelSetDesc desc{.alias = OptString(s, "alias", where, ""), .icon = OptString(s, "icon", where, "I_AnnotationSet")};
    QelBaseUnknown* owner =
        Lookup(Require(s, "owner", where), where.Key("owner"), Kind::Product, "product").object.get();
    if (auto it = s.find("rep"); it != s.end()) {
      desc.rep = Lookup(*it, where.Key("rep"), Kind::Rep, "rep instance").object.get();
    }
    desc.light = OptBool(s, "light", where, false);
    if (auto it = s.find("kind"); it != s.end()) desc.kind = SmallInteger(*it, where.Key("kind"));
    if (auto it = s.find("rootSet"); it != s.end()) {
      std::string scope = String(*it, where.Key("rootSet"));
      if (scope == "direct") desc.rootScope = QelRootSetScope::Direct;
      else if (scope == "arm") desc.rootScope = QelRootSetScope::ARM;
      else throw Refused(where.Key("rootSet"), "expected \"direct\" or \"arm\", found \"" + scope + "\"");
    }
    desc.shown = OptBool(s, "shown", where, true);
    QelBaseUnknown_var set = builder_.AddSet(QelBaseUnknown_var(owner), desc);
    if (!set) throw Refused(where.Key("rep"), "the rep instance does not belong to the owner");
    Declare(s, where, set.get(), Kind::Set);
    Each(s, index, 0, where, [&](const Json& a, const Where& at) { Annotation(set.get(), a, at); });
    Each(s, index, 1, where, [&](const Json& v, const Where& at) { View(set.get(), v, at); });
    Each(s, index, 2, where, [&](const Json& c, const Where& at) { Capture(set.get(), c, at); });
    if (auto it = s.find("otherElements"); it != s.end()) {
      Where at = where.Key("otherElements");
      std::vector<QelBaseUnknown*> others;
      const Json& list = Array(*it, at);
      for (size_t i = 0; i < list.size(); ++i) {
        others.push_back(AnyOf(list[i], at.At(static_cast<int>(i)), set.get()));
      }
      builder_.SetOtherElements(set, others);
    }
  }

  // An element of the views component's second list: a view or capture of the set.
  QelBaseUnknown* AnyOf(const Json& ref, const Where& where, QelBaseUnknown* set) {
    std::string id = String(ref, where);
    auto it = ids_.find(id);
    if (it == ids_.end()) throw Refused(where, "unknown view or capture '" + id + "'");
    if (it->second.kind != Kind::View && it->second.kind != Kind::Capture) {
      throw Refused(where, "'" + id + "' is not a view or capture");
    }
    if (it->second.set != set) throw Refused(where, "'" + id + "' belongs to another set");
    return it->second.object.get();
  }

  // The elements of one of the set's lists, which the reader left as ranges of the text:
  // each is parsed, loaded and dropped before the next.
  template <class Fn>
  void Each(const Json& s, size_t index, int list, const Where& where, Fn fn) {
    const char* key = QelModelJsonReader::kListKeys[list];
    auto it = s.find(key);
    if (it == s.end()) return;
    Where listAt = where.Key(key);
    Array(*it, listAt);
    if (index >= lists_.size()) return;
    const std::vector<QelModelJsonReader::Range>& ranges = lists_[index].lists[list];
    for (size_t i = 0; i < ranges.size(); ++i) {
      Where at = listAt.At(static_cast<int>(i));
      const Json element = Json::parse(text_.data() + ranges[i].begin, text_.data() + ranges[i].end);
      fn(Object(element, at), at);
    }
  }

  void Annotation(QelBaseUnknown* set, const Json& a, const Where& where) {
    CheckKeys(a, where, {"id", "alias", "names", "icon", "type", "subType", "code", "geometry", "visu", "tolerance",
                         "default", "shown", "anchor", "segments", "leader", "frame", "dimension"});
    QelModelAnnotationDesc desc;
    desc.alias = OptString(a, "alias", where, "");
    desc.icon = OptString(a, "icon", where, "I_Annotation");
    desc.typeName = String(Require(a, "type", where), where.Key("type"));
    desc.subTypeName = String(Require(a, "subType", where), where.Key("subType"));
    Where codeAt = where.Key("code");
    const int64_t code = Integer(Require(a, "code", where), codeAt);
    if (code < QelTPSTypeClassifier::kFirstTypeCode || code > QelTPSTypeClassifier::kLastTypeCode) {
      throw Refused(codeAt, "unknown type code " + std::to_string(code) + " (known codes are 1 to 13)");
    }
    desc.typeCode = static_cast<int>(code);
    desc.geometry = OptBool(a, "geometry", where, false);
    if (auto it = a.find("names"); it != a.end()) {
      Where at = where.Key("names");
      const Json& names = Array(*it, at);
      for (size_t i = 0; i < names.size(); ++i) desc.navigationNames.push_back(String(names[i], at.At(static_cast<int>(i))));
    }
    if (auto it = a.find("visu"); it != a.end()) {
      std::string visu = String(*it, where.Key("visu"));
      if (visu == "text") desc.visu = QelAnnotationVisu::Text;
      else if (visu == "dimension") desc.visu = QelAnnotationVisu::Dimension;
      else throw Refused(where.Key("visu"), "expected \"text\" or \"dimension\", found \"" + visu + "\"");
    }
    if (auto it = a.find("tolerance"); it != a.end() && !it->is_null()) {
      desc.tolerance = Number(*it, where.Key("tolerance"));
    }
    desc.isDefault = OptBool(a, "default", where, false);
    desc.shown = OptBool(a, "shown", where, true);
    if (auto it = a.find("anchor"); it != a.end()) desc.anchor = Vector(*it, where.Key("anchor"));
    if (auto it = a.find("segments"); it != a.end()) {
      Where at = where.Key("segments");
      const Json& segments = Array(*it, at);
      for (size_t i = 0; i < segments.size(); ++i) {
        Where segAt = at.At(static_cast<int>(i));
        if (!segments[i].is_array() || segments[i].size() != 2) throw Refused(segAt, "expected [from, to]");
        desc.segments.push_back({Vector(segments[i][0], segAt.At(0)), Vector(segments[i][1], segAt.At(1))});
      }
    }
    if (auto it = a.find("leader"); it != a.end()) desc.leader = Vector(*it, where.Key("leader"));
    if (auto it = a.find("frame"); it != a.end()) {
      Where at = where.Key("frame");
      const Json& f = Object(*it, at);
      CheckKeys(f, at, {"zone", "zoneShape", "material", "datums"});
      QelModelToleranceFrame frame;
      frame.zone = Number(Require(f, "zone", at), at.Key("zone"));
      frame.zoneShape = OptString(f, "zoneShape", at, "");
      if (!frame.zoneShape.empty() && frame.zoneShape != "diameter" && frame.zoneShape != "spherical diameter") {
        throw Refused(at.Key("zoneShape"), "expected \"diameter\" or \"spherical diameter\"");
      }
      frame.material = OptString(f, "material", at, "");
      if (!frame.material.empty() && frame.material != "M" && frame.material != "L") {
        throw Refused(at.Key("material"), "expected \"M\" or \"L\"");
      }
      if (auto d = f.find("datums"); d != f.end()) {
        Where datumsAt = at.Key("datums");
        const Json& datums = Array(*d, datumsAt);
        for (size_t i = 0; i < datums.size(); ++i) frame.datums.push_back(String(datums[i], datumsAt.At(static_cast<int>(i))));
      }
      desc.frame = std::move(frame);
    }
    if (auto it = a.find("dimension"); it != a.end()) {
      Where at = where.Key("dimension");
      const Json& d = Object(*it, at);
      CheckKeys(d, at, {"nominal", "upper", "lower", "min", "max"});
      QelModelDimensionValue value;
      value.nominal = Number(Require(d, "nominal", at), at.Key("nominal"));
      const bool deviations = d.contains("upper") || d.contains("lower");
      value.limits = d.contains("min") || d.contains("max");
      if (deviations && value.limits) throw Refused(at, "give deviations (upper, lower) or limits (min, max), not both");
      for (const char* key : {"upper", "max"})
        if (auto u = d.find(key); u != d.end()) value.upper = Number(*u, at.Key(key));
      for (const char* key : {"lower", "min"})
        if (auto l = d.find(key); l != d.end()) value.lower = Number(*l, at.Key(key));
      desc.dimension = value;
    }
    QelBaseUnknown_var made = builder_.AddAnnotation(QelBaseUnknown_var(set), desc);
    Declare(a, where, made.get(), Kind::Annotation, set);
  }

  std::vector<QelBaseUnknown*> Refs(const Json& v, const char* key, const Where& where, Kind kind, const char* what,
                                    QelBaseUnknown* set) {
    std::vector<QelBaseUnknown*> out;
    auto it = v.find(key);
    if (it == v.end()) return out;
    Where at = where.Key(key);
    const Json& list = Array(*it, at);
    for (size_t i = 0; i < list.size(); ++i) {
      Where refAt = at.At(static_cast<int>(i));
      const Entry& found = Lookup(list[i], refAt, kind, what);
      if (set && found.set != set) throw Refused(refAt, "'" + list[i].get<std::string>() + "' belongs to another set");
      out.push_back(found.object.get());
    }
    return out;
  }

  void View(QelBaseUnknown* set, const Json& v, const Where& where) {
    CheckKeys(v, where, {"id", "alias", "icon", "plane", "elements", "extraction", "references", "related", "shown"});
    QelModelViewDesc desc;
    desc.alias = OptString(v, "alias", where, "");
    desc.icon = OptString(v, "icon", where, "I_AnnotationView");
    if (auto it = v.find("plane"); it != v.end()) {
      Where at = where.Key("plane");
      if (it->is_null()) {
        desc.plane.reset();
      } else {
        const Json& p = Object(*it, at);
        CheckKeys(p, at, {"origin", "normal", "first", "second"});
        desc.plane = QelMathPlane(Vector(Require(p, "origin", at), at.Key("origin")),
                                  Vector(Require(p, "normal", at), at.Key("normal")),
                                  Vector(Require(p, "first", at), at.Key("first")),
                                  Vector(Require(p, "second", at), at.Key("second")));
      }
    }
    desc.elements = Refs(v, "elements", where, Kind::Annotation, "annotation", set);
    desc.extraction = OptBool(v, "extraction", where, false);
    desc.referenceViews = Refs(v, "references", where, Kind::View, "view", nullptr);
    desc.relatedViews = Refs(v, "related", where, Kind::View, "view", nullptr);
    desc.shown = OptBool(v, "shown", where, true);
    QelBaseUnknown_var made = builder_.AddView(QelBaseUnknown_var(set), desc);
    Declare(v, where, made.get(), Kind::View, set);
  }

  void Capture(QelBaseUnknown* set, const Json& c, const Where& where) {
    CheckKeys(c, where, {"id", "alias", "icon", "view", "camera", "shown"});
    QelModelCaptureDesc desc;
    desc.alias = OptString(c, "alias", where, "");
    desc.icon = OptString(c, "icon", where, "I_Capture");
    if (auto it = c.find("view"); it != c.end() && !it->is_null()) {
      const Entry& view = Lookup(*it, where.Key("view"), Kind::View, "view");
      if (view.set != set) throw Refused(where.Key("view"), "the view belongs to another set");
      desc.view = view.object.get();
    }
    if (auto it = c.find("camera"); it != c.end() && !it->is_null()) {
      Where at = where.Key("camera");
      const Json& cam = Object(*it, at);
      CheckKeys(cam, at, {"origin", "target", "zenith"});
      desc.camera = QelModelCameraDesc{Vector(Require(cam, "origin", at), at.Key("origin")),
                                       Vector(Require(cam, "target", at), at.Key("target")),
                                       Vector(Require(cam, "zenith", at), at.Key("zenith"))};
    }
    desc.shown = OptBool(c, "shown", where, true);
    QelBaseUnknown_var made = builder_.AddCapture(QelBaseUnknown_var(set), desc);
    Declare(c, where, made.get(), Kind::Capture, set);
  }

  QelModelBuilder& builder_;
  const std::string& text_;
  const std::vector<QelModelJsonReader::SetLists>& lists_;
  std::unordered_map<std::string, Entry> ids_;
};

// The parser quotes what it last read, which for a binary file is raw bytes: escape what
// a terminal would not show as text.
std::string Printable(const std::string& text) {
  std::string out;
  for (unsigned char c : text) {
    if (c >= 0x20 && c < 0x7F) {
      out += static_cast<char>(c);
    } else {
      char escaped[5];
      std::snprintf(escaped, sizeof escaped, "\\x%02X", c);
      out += escaped;
    }
  }
  return out;
}

// 1-based line and column of a byte offset, for syntax errors.
std::string LineAndColumn(const std::string& text, size_t offset) {
  size_t line = 1, column = 1;
  for (size_t i = 0; i < offset && i < text.size(); ++i) {
    if (text[i] == '\n') {
      ++line;
      column = 1;
    } else {
      ++column;
    }
  }
  return std::to_string(line) + ":" + std::to_string(column);
}
}  // namespace

HRESULT QelModelLoader::LoadText(const std::string& text, const std::string& sourceName, QelBaseUnknown_var& root,
                                 std::string& error) {
  root = nullptr;
  error.clear();
  try {
    Json doc;
    std::vector<QelModelJsonReader::SetLists> lists;
    try {
      QelModelJsonReader::Read(text, doc, lists);
    } catch (const Json::parse_error& e) {
      // The parser's own text starts with its exception name; keep only the explanation.
      std::string what = e.what();
      if (size_t cut = what.find("parse error"); cut != std::string::npos) what = what.substr(cut);
      error = sourceName + ":" + LineAndColumn(text, e.byte > 0 ? e.byte - 1 : 0) + ": syntax error: " + Printable(what);
      return E_FAIL;
    }
    QelModelBuilder builder(Loader::RootDesc(doc));
    builder.SetSourceName(sourceName);
    Loader(builder, text, lists).Load(doc);
    root = builder.Finish();
    return S_OK;
  } catch (const std::bad_alloc&) {
    error = sourceName + ": not enough memory to load the model";
  } catch (const std::exception& e) {
    error = sourceName + ": " + e.what();
  }
  root = nullptr;
  return E_FAIL;
}

namespace {
// Reads a regular file of at most kMaxFileBytes into `text`. Opened without blocking and
// checked on the open descriptor, so a pipe or a device cannot stall or flood the reader.
bool ReadModelFile(const std::string& path, std::string& text, std::string& error) {
  const int fd = ::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
  if (fd < 0) {
    error = path + ": cannot open the file";
    return false;
  }
  struct Closer {
    int fd;
    ~Closer() { ::close(fd); }
  } closer{fd};
  struct stat info {};
  if (::fstat(fd, &info) != 0) {
    error = path + ": cannot read the file";
    return false;
  }
  if (S_ISDIR(info.st_mode)) {
    error = path + ": is a folder, not a model file";
    return false;
  }
  if (!S_ISREG(info.st_mode)) {
    error = path + ": not a regular file (a model is read from a regular file)";
    return false;
  }
  const auto tooLarge = [&](uint64_t bytes) {
    error = path + ": the file is too large (" + std::to_string(bytes) + " bytes; a model file may have at most " +
            std::to_string(kMaxFileBytes) + " bytes)";
    return false;
  };
  if (static_cast<uint64_t>(info.st_size) > kMaxFileBytes) return tooLarge(static_cast<uint64_t>(info.st_size));
  text.resize(static_cast<size_t>(info.st_size));
  size_t got = 0;
  char more[4096];
  for (;;) {
    // The file may have changed since fstat: read what is there, into the text while it
    // fits and then in small steps, so that the text is never copied to grow.
    const bool inText = got < text.size();
    const ssize_t n = inText ? ::read(fd, text.data() + got, text.size() - got) : ::read(fd, more, sizeof more);
    if (n < 0 && errno == EINTR) continue;
    if (n < 0) {
      error = path + ": cannot read the file";
      return false;
    }
    if (n == 0) break;
    if (!inText) {
      if (got + static_cast<size_t>(n) > kMaxFileBytes) return tooLarge(got + static_cast<size_t>(n));
      text.append(more, static_cast<size_t>(n));
    }
    got += static_cast<size_t>(n);
  }
  text.resize(got);
  return true;
}
}  // namespace

HRESULT QelModelLoader::LoadFile(const std::string& path, QelBaseUnknown_var& root, std::string& error) {
  root = nullptr;
  error.clear();
  try {
    std::string text;
    if (!ReadModelFile(path, text, error)) return E_FAIL;
    return LoadText(text, path, root, error);
  } catch (const std::bad_alloc&) {
    error = path + ": not enough memory to read the file";
  } catch (const std::exception& e) {
    error = path + ": " + e.what();
  }
  root = nullptr;
  return E_FAIL;
}
