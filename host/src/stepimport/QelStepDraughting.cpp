#include "QelStepDraughting.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdlib>
#include <functional>
#include <unordered_set>

#include "QelStepStatementIndex.h"

namespace {
constexpr size_t kMaxSegments = 4000;  // per annotation, as for drawings the translator gives
constexpr size_t npos = std::string_view::npos;

bool IsSpace(char c) { return std::isspace(static_cast<unsigned char>(c)) != 0; }
bool IsWord(char c) { return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_'; }

std::string_view Trim(std::string_view s) {
  while (!s.empty() && IsSpace(s.front())) s.remove_prefix(1);
  while (!s.empty() && IsSpace(s.back())) s.remove_suffix(1);
  return s;
}

// The text inside the parentheses opening at `open`, quotes and nesting respected; empty
// when they do not close.
std::string_view Group(std::string_view s, size_t open) {
  int depth = 0;
  bool quoted = false;
  for (size_t i = open; i < s.size(); ++i) {
    const char c = s[i];
    if (c == '\'') quoted = !quoted;
    if (quoted) continue;
    if (c == '(') ++depth;
    if (c == ')' && --depth == 0) return s.substr(open + 1, i - open - 1);
  }
  return {};
}

// The parameters of the record `type` in a simple or complex instance, or none.
std::optional<std::string_view> Record(std::string_view s, std::string_view type) {
  for (size_t at = s.find(type); at != npos; at = s.find(type, at + 1)) {
    if (at > 0 && (IsWord(s[at - 1]) || s[at - 1] == '\'')) continue;
    size_t p = at + type.size();
    while (p < s.size() && IsSpace(s[p])) ++p;
    if (p < s.size() && s[p] == '(') return Group(s, p);
  }
  return std::nullopt;
}

// The type of a simple instance ("" for a complex one).
std::string_view TypeOf(std::string_view s) {
  s = Trim(s);
  const size_t open = s.find('(');
  return open == npos ? s : Trim(s.substr(0, open));
}

// Top-level parameters of a parameter list.
std::vector<std::string_view> Split(std::string_view s) {
  std::vector<std::string_view> out;
  int depth = 0;
  bool quoted = false;
  size_t begin = 0;
  for (size_t i = 0; i < s.size(); ++i) {
    const char c = s[i];
    if (c == '\'') quoted = !quoted;
    if (quoted) continue;
    if (c == '(') ++depth;
    if (c == ')') --depth;
    if (c == ',' && depth == 0) {
      out.push_back(Trim(s.substr(begin, i - begin)));
      begin = i + 1;
    }
  }
  if (!Trim(s).empty()) out.push_back(Trim(s.substr(begin)));
  return out;
}

std::vector<std::string_view> List(std::string_view parameter) {
  parameter = Trim(parameter);
  if (parameter.empty() || parameter.front() != '(') return {};
  return Split(Group(parameter, 0));
}

long Ref(std::string_view p) {
  p = Trim(p);
  if (p.size() < 2 || p.front() != '#') return -1;
  return std::strtol(std::string(p.substr(1)).c_str(), nullptr, 10);
}

std::string Str(std::string_view p) {
  p = Trim(p);
  if (p.size() < 2 || p.front() != '\'') return {};
  std::string out;
  for (size_t i = 1; i + 1 < p.size(); ++i) {
    out += p[i];
    if (p[i] == '\'' && p[i + 1] == '\'') ++i;
  }
  return out;
}

double Num(std::string_view p) { return std::strtod(std::string(Trim(p)).c_str(), nullptr); }

std::string Upper(std::string s) {
  for (char& c : s) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
  return s;
}

struct Place {
  QelMathPoint origin{};
  QelMathVector x{1, 0, 0}, y{0, 1, 0}, z{0, 0, 1};
  QelMathPoint Apply(const QelMathPoint& p) const { return origin + x * p.x + y * p.y + z * p.z; }
};

class Scanner {
 public:
  explicit Scanner(std::string_view text) : index_(text) {}

  std::string_view At(long id) const { return index_.At(id); }
  std::optional<std::string_view> Args(long id, std::string_view type) const { return Record(At(id), type); }
  const std::vector<long>& Order() const { return index_.Order(); }
  const std::vector<long>& Referrers(long id) const { return index_.Referrers(id); }

  std::vector<double> Triple(long id, std::string_view type) const {
    std::vector<double> out;
    if (auto args = Args(id, type)) {
      const auto p = Split(*args);
      if (p.size() >= 2)
        for (std::string_view v : List(p[1])) out.push_back(Num(v));
    }
    return out;
  }

  std::optional<QelMathVector> Direction(long id) const {
    const auto d = Triple(id, "DIRECTION");
    if (d.size() != 3) return std::nullopt;
    QelMathVector v{d[0], d[1], d[2]};
    const double n = v.Norm();
    if (!(n > 0.0) || !std::isfinite(n)) return std::nullopt;
    return v * (1.0 / n);
  }

  Place Placement(long id) const {
    Place place;
    auto args = Args(id, "AXIS2_PLACEMENT_3D");
    if (!args) return place;
    const auto p = Split(*args);
    if (p.size() < 4) return place;
    const auto o = Triple(Ref(p[1]), "CARTESIAN_POINT");
    if (o.size() == 3) place.origin = {o[0], o[1], o[2]};
    if (auto z = Direction(Ref(p[2]))) place.z = *z;
    QelMathVector x{1, 0, 0};
    if (auto r = Direction(Ref(p[3]))) x = *r;
    x = x - place.z * x.Dot(place.z);  // the reference direction's part across the axis
    if (x.Norm() < 1e-9) x = std::abs(place.z.x) < 0.9 ? QelMathVector{1, 0, 0} : QelMathVector{0, 1, 0};
    x = x - place.z * x.Dot(place.z);
    place.x = x * (1.0 / x.Norm());
    place.y = place.z.Cross(place.x);
    return place;
  }

 private:
  QelStepStatementIndex index_;
};

bool IsDimension(std::string_view s) {
  for (const char* type : {"DIMENSIONAL_SIZE", "ANGULAR_SIZE", "DIMENSIONAL_SIZE_WITH_PATH", "DIMENSIONAL_LOCATION",
                           "ANGULAR_LOCATION", "DIMENSIONAL_LOCATION_WITH_PATH"})
    if (Record(s, type)) return true;
  return false;
}

// The name of a geometric tolerance (a simple instance of one of its kinds, or a complex
// one holding its GEOMETRIC_TOLERANCE record); nothing for anything else.
std::optional<std::string> ToleranceName(std::string_view s) {
  if (auto args = Record(s, "GEOMETRIC_TOLERANCE")) {
    const auto p = Split(*args);
    if (!p.empty()) return Str(p[0]);
  }
  const std::string_view type = TypeOf(s);
  const std::string_view suffix = "_TOLERANCE";
  if (type.size() <= suffix.size() || type.substr(type.size() - suffix.size()) != suffix) return std::nullopt;
  if (type == "PLUS_MINUS_TOLERANCE") return std::nullopt;
  const auto p = Split(Record(s, type).value_or(std::string_view()));
  if (p.size() < 4 || Trim(p[0]).empty() || Trim(p[0]).front() != '\'') return std::nullopt;
  return Str(p[0]);
}

std::string UnitName(std::string_view s);

// Millimetres per unit of a length unit's name; 0 for one not known.
double Millimetres(const std::string& unit) {
  if (unit == "mm") return 1.0;
  if (unit == "cm") return 10.0;
  if (unit == "m") return 1000.0;
  if (unit == "in") return 25.4;
  if (unit == "ft") return 304.8;
  return 0.0;
}

class Resolver {
 public:
  explicit Resolver(const Scanner& scan) : scan_(scan) {
    for (long id : scan_.Order()) {
      const std::string_view s = scan_.At(id);
      if (!IsDimension(s)) continue;
      std::string name;
      for (std::string_view p : Split(Group(s, s.find('(')))) {
        if (!p.empty() && p.front() == '\'') {
          name = Str(p);
          break;
        }
      }
      // A complex instance names its dimension in the record of its kind.
      if (Trim(s).front() == '(') {
        for (const char* type : {"DIMENSIONAL_SIZE", "DIMENSIONAL_LOCATION"})
          if (auto args = Record(s, type))
            for (std::string_view p : Split(*args))
              if (!p.empty() && p.front() == '\'' && name.empty()) name = Str(p);
      }
      dimensionIndex_.emplace(id, names.size());
      names.push_back(name);
      scales.push_back(Scale(id));
      nominals.push_back(Nominal(id));
    }
  }

  // The key of the annotation an entity stands for: itself, the annotation defined on it
  // (a shape aspect), or one defined on the same faces.
  std::string Key(long id, bool viaGeometry = true) const {
    const std::string_view s = scan_.At(id);
    if (s.empty()) return {};
    if (std::string key = Direct(id, s); !key.empty()) return key;
    std::string found;
    for (long r : scan_.Referrers(id)) {
      const std::string_view rs = scan_.At(r);
      if (IsDimension(rs) || ToleranceName(rs)) {
        found = Direct(r, rs);
      } else if (auto rel = Record(rs, "SHAPE_ASPECT_RELATIONSHIP")) {
        const auto p = Split(*rel);
        if (p.size() >= 4 && Ref(p[2]) == id) found = Letter(Ref(p[3]));
      }
      if (!found.empty()) return found;
    }
    if (!viaGeometry) return {};
    // The same faces, named by another entity that resolves: a datum's callout often
    // points at a shape aspect of its own rather than at the datum feature.
    const bool wantsDatum = Upper(Description(s)) == "DATUM";
    std::string fallback;
    for (long face : Faces(id))
      for (long usage : scan_.Referrers(face)) {
        auto args = Record(scan_.At(usage), "GEOMETRIC_ITEM_SPECIFIC_USAGE");
        if (!args) continue;
        const auto p = Split(*args);
        if (p.size() < 3 || Ref(p[2]) == id) continue;
        std::string key = Key(Ref(p[2]), false);
        if (key.empty()) continue;
        if (!wantsDatum || key.rfind("A:", 0) == 0) return key;
        if (fallback.empty()) fallback = key;
      }
    return fallback;
  }

  std::vector<std::string> names;
  std::vector<double> scales;
  std::vector<std::optional<double>> nominals;

 private:
  // Millimetres per unit of a dimension's length value (its characteristic representation's
  // first length measure); 1 when it has none or its unit is not known.
  double Scale(long dimension) const {
    double scale = 1.0;
    Measure(dimension, &scale);
    return scale;
  }

  // The nominal value of a dimension as the file writes it (its characteristic
  // representation's item named 'nominal value', else its first measure), if any.
  std::optional<double> Nominal(long dimension) const { return Measure(dimension, nullptr); }

  std::optional<double> Measure(long dimension, double* scale) const {
    for (long r : scan_.Referrers(dimension)) {
      auto dcr = Record(scan_.At(r), "DIMENSIONAL_CHARACTERISTIC_REPRESENTATION");
      if (!dcr) continue;
      const auto p = Split(*dcr);
      if (p.size() < 2 || Ref(p[0]) != dimension) continue;
      const auto sdr = Split(scan_.Args(Ref(p[1]), "SHAPE_DIMENSION_REPRESENTATION").value_or(std::string_view()));
      if (sdr.size() < 2) continue;
      std::optional<double> first;
      for (std::string_view item : List(sdr[1])) {
        auto measure = scan_.Args(Ref(item), "MEASURE_WITH_UNIT");
        if (!measure) continue;
        const auto m = Split(*measure);
        const size_t open = m.empty() ? npos : m[0].find('(');
        if (m.size() < 2 || open == npos) continue;
        const double value = Num(m[0].substr(open + 1));
        if (scale && m[0].find("LENGTH_MEASURE") != npos) {
          const double mm = Millimetres(UnitName(scan_.At(Ref(m[1]))));
          *scale = mm > 0.0 ? mm : 1.0;
          return value;
        }
        const auto named = Split(scan_.Args(Ref(item), "REPRESENTATION_ITEM").value_or(std::string_view()));
        if (!named.empty() && Str(named[0]) == "nominal value") return value;
        if (!first) first = value;
      }
      if (!scale) return first;
    }
    return std::nullopt;
  }

  std::string Direct(long id, std::string_view s) const {
    if (IsDimension(s)) {
      auto it = dimensionIndex_.find(id);
      return it == dimensionIndex_.end() ? std::string() : "D:" + std::to_string(it->second);
    }
    if (auto name = ToleranceName(s)) return "T:" + *name;
    if (std::string letter = Letter(id); !letter.empty()) return letter;
    if (Record(s, "DATUM_FEATURE")) {
      for (long r : scan_.Referrers(id))
        if (auto rel = Record(scan_.At(r), "SHAPE_ASPECT_RELATIONSHIP")) {
          const auto p = Split(*rel);
          if (p.size() >= 4 && Ref(p[2]) == id)
            if (std::string letter = Letter(Ref(p[3])); !letter.empty()) return letter;
        }
    }
    return {};
  }

  // "A:<letter>" for a DATUM entity.
  std::string Letter(long id) const {
    const std::string_view s = scan_.At(id);
    if (TypeOf(s) != "DATUM") return {};
    const auto p = Split(Record(s, "DATUM").value_or(std::string_view()));
    return p.size() >= 5 ? "A:" + Str(p[4]) : std::string();
  }

  static std::string Description(std::string_view s) {
    const auto p = Split(Group(s, s.find('(')));
    return p.size() >= 2 ? Str(p[1]) : std::string();
  }

  std::vector<long> Faces(long id) const {
    std::vector<long> out;
    for (long usage : scan_.Referrers(id)) {
      auto args = Record(scan_.At(usage), "GEOMETRIC_ITEM_SPECIFIC_USAGE");
      if (!args) continue;
      const auto p = Split(*args);
      if (p.size() < 5 || Ref(p[2]) != id) continue;
      if (long item = Ref(p[4]); item >= 0) out.push_back(item);
      for (std::string_view item : List(p[4])) out.push_back(Ref(item));
    }
    return out;
  }

  const Scanner& scan_;
  std::unordered_map<long, size_t> dimensionIndex_;
};

void Lines(const Scanner& scan, long id, int depth, std::vector<QelModelSegment>& out, bool& placed);

// The lines one statement draws (tessellated curves, polylines, or the items of an
// occurrence or a set), in the coordinates they are given in.
void LinesOf(const Scanner& scan, std::string_view s, int depth, std::vector<QelModelSegment>& out, bool& placed) {
  if (auto args = Record(s, "TESSELLATED_CURVE_SET")) {
    const auto p = Split(*args);
    if (p.size() < 3) return;
    std::vector<QelMathPoint> points;
    if (auto coords = scan.Args(Ref(p[1]), "COORDINATES_LIST")) {
      const auto c = Split(*coords);
      if (c.size() >= 3)
        for (std::string_view xyz : List(c[2])) {
          const auto v = List(xyz);
          if (v.size() >= 2) points.push_back({Num(v[0]), Num(v[1]), v.size() >= 3 ? Num(v[2]) : 0.0});
        }
    }
    for (std::string_view strip : List(p[2])) {
      long previous = -1;
      for (std::string_view index : List(strip)) {
        const long i = std::strtol(std::string(index).c_str(), nullptr, 10);
        const bool valid = i >= 1 && i <= static_cast<long>(points.size());
        if (valid && previous >= 1 && out.size() < kMaxSegments) out.push_back({points[previous - 1], points[i - 1]});
        previous = valid ? i : -1;
      }
    }
    return;
  }
  if (auto args = Record(s, "POLYLINE")) {
    const auto p = Split(*args);
    if (p.size() < 2) return;
    std::optional<QelMathPoint> previous;
    for (std::string_view ref : List(p[1])) {
      const auto xyz = scan.Triple(Ref(ref), "CARTESIAN_POINT");
      if (xyz.size() < 2) continue;
      const QelMathPoint point{xyz[0], xyz[1], xyz.size() >= 3 ? xyz[2] : 0.0};
      if (previous && out.size() < kMaxSegments) out.push_back({*previous, point});
      previous = point;
    }
    return;
  }
  // Occurrences and sets hold their items: follow every reference of their parameters
  // (a complex set gives its items as its only parameter).
  for (const char* type : {"TESSELLATED_ANNOTATION_OCCURRENCE", "ANNOTATION_CURVE_OCCURRENCE", "ANNOTATION_OCCURRENCE",
                           "TESSELLATED_GEOMETRIC_SET", "GEOMETRIC_CURVE_SET", "GEOMETRIC_SET"}) {
    auto args = Record(s, type);
    if (!args) continue;
    for (std::string_view parameter : Split(*args)) {
      if (long ref = Ref(parameter); ref >= 0) Lines(scan, ref, depth + 1, out, placed);
      for (std::string_view item : List(parameter))
        if (long ref = Ref(item); ref >= 0 && TypeOf(scan.At(ref)) != "PRESENTATION_STYLE_ASSIGNMENT")
          Lines(scan, ref, depth + 1, out, placed);
    }
    return;
  }
}

// The lines of an entity's drawing; a repositioned tessellated item is placed in the
// model by its own placement (then `placed` is set).
void Lines(const Scanner& scan, long id, int depth, std::vector<QelModelSegment>& out, bool& placed) {
  if (depth > 8 || out.size() >= kMaxSegments) return;
  const std::string_view s = scan.At(id);
  if (auto args = Record(s, "REPOSITIONED_TESSELLATED_ITEM")) {
    const Place place = scan.Placement(Ref(*args));
    std::vector<QelModelSegment> lines;
    bool inner = false;
    LinesOf(scan, s, depth, lines, inner);
    for (const QelModelSegment& line : lines)
      if (out.size() < kMaxSegments) out.push_back({place.Apply(line.from), place.Apply(line.to)});
    placed = true;
    return;
  }
  LinesOf(scan, s, depth, out, placed);
}

std::string UnitName(std::string_view s) {
  if (auto args = Record(s, "CONVERSION_BASED_UNIT")) {
    const auto p = Split(*args);
    const std::string name = p.empty() ? std::string() : Upper(Str(p[0]));
    if (name == "INCH") return "in";
    if (name == "FOOT") return "ft";
    return {};
  }
  if (auto args = Record(s, "SI_UNIT")) {
    const auto p = Split(*args);
    if (p.size() < 2 || Upper(std::string(p[1])) != ".METRE.") return {};
    const std::string prefix = Upper(std::string(p[0]));
    if (prefix == ".MILLI.") return "mm";
    if (prefix == ".CENTI.") return "cm";
    if (prefix == "$") return "m";
  }
  return {};
}
}  // namespace

QelStepDraughting QelStepDraughting::Scan(std::string_view text) {
  QelStepDraughting out;
  const Scanner scan(text);
  const Resolver resolver(scan);
  out.dimensionNames_ = resolver.names;
  out.dimensionScales_ = resolver.scales;
  out.dimensionNominals_ = resolver.nominals;

  // Which callout an annotation occurrence belongs to, the plane each callout lies in,
  // and the annotation each callout presents (its draughting model item associations).
  std::unordered_map<long, long> calloutOf;
  std::unordered_map<long, long> planeOf;
  std::unordered_map<long, std::string> keyOf;
  std::unordered_map<long, std::string> cameraName;
  for (long id : scan.Order()) {
    const std::string_view s = scan.At(id);
    if (TypeOf(s) == "DRAUGHTING_CALLOUT") {
      const auto p = Split(Record(s, "DRAUGHTING_CALLOUT").value_or(std::string_view()));
      if (p.size() >= 2)
        for (std::string_view item : List(p[1])) calloutOf.emplace(Ref(item), id);
    } else if (auto plane = Record(s, "ANNOTATION_PLANE")) {
      const auto p = Split(*plane);
      if (p.size() >= 4)
        for (std::string_view item : List(p[3])) planeOf.emplace(Ref(item), Ref(p[2]));
    }
  }
  for (long id : scan.Order()) {
    const std::string_view s = scan.At(id);
    auto args = Record(s, "DRAUGHTING_MODEL_ITEM_ASSOCIATION");
    if (!args) args = Record(s, "DRAUGHTING_MODEL_ITEM_ASSOCIATION_WITH_PLACEHOLDER");
    if (!args) continue;
    const auto p = Split(*args);
    if (p.size() < 5) continue;
    long callout = Ref(p[4]);
    if (auto it = calloutOf.find(callout); it != calloutOf.end()) callout = it->second;
    if (keyOf.count(callout)) continue;
    std::string key = resolver.Key(Ref(p[2]));
    if (!key.empty()) keyOf.emplace(callout, std::move(key));
  }
  // Each callout's drawing, placed by its repositioned items or else by its annotation
  // plane (the file gives the lines in the plane's own coordinates).
  for (const auto& [callout, key] : keyOf) {
    const std::string_view s = scan.At(callout);
    const auto p = Split(Record(s, "DRAUGHTING_CALLOUT").value_or(std::string_view()));
    if (p.size() < 2) continue;
    std::vector<QelModelSegment> lines;
    bool placed = false;
    for (std::string_view item : List(p[1])) Lines(scan, Ref(item), 0, lines, placed);
    if (lines.empty()) continue;
    Place place;
    if (auto it = planeOf.find(callout); it != planeOf.end() && !placed) {
      if (auto plane = scan.Args(it->second, "PLANE")) {
        const auto q = Split(*plane);
        if (q.size() >= 2) place = scan.Placement(Ref(q[1]));
      }
    }
    std::vector<QelModelSegment>& drawing = out.drawings_[key];
    for (const QelModelSegment& line : lines) {
      if (drawing.size() >= kMaxSegments) break;
      drawing.push_back({place.Apply(line.from), place.Apply(line.to)});
    }
  }

  // Cameras, then the draughting models (saved views) that hold them.
  for (long id : scan.Order()) {
    const std::string_view s = scan.At(id);
    auto args = Record(s, "CAMERA_MODEL_D3");
    const bool multi = !args;
    if (!args) args = Record(s, "CAMERA_MODEL_D3_MULTI_CLIPPING");
    if (!args) continue;
    const auto p = Split(*args);
    if (p.size() < 3) continue;
    Camera camera;
    const Place place = scan.Placement(Ref(p[1]));
    camera.axis = place.z;
    camera.up = place.y;
    camera.eye = place.origin;
    if (auto volume = scan.Args(Ref(p[2]), "VIEW_VOLUME")) {
      const auto v = Split(*volume);
      if (v.size() >= 7) {
        camera.parallel = Upper(std::string(v[0])) != ".CENTRAL.";
        const auto projection = scan.Triple(Ref(v[1]), "CARTESIAN_POINT");
        // The projection point is given in the camera's own placement.
        if (projection.size() == 3) camera.eye = place.Apply({projection[0], projection[1], projection[2]});
        camera.frontDistance = Num(v[3]);
        camera.frontClipping = Upper(std::string(v[4])) == ".T.";
        camera.backDistance = Num(v[5]);
        camera.backClipping = Upper(std::string(v[6])) == ".T.";
      }
    }
    // A camera with its own clipping planes asks for clipping too.
    if (multi) camera.frontClipping = true;
    cameraName.emplace(id, Str(p[0]));
    out.cameras_[Str(p[0])] = camera;
  }
  for (long id : scan.Order()) {
    const std::string_view s = scan.At(id);
    auto model = Record(s, "DRAUGHTING_MODEL");
    if (!model) continue;
    auto args = Trim(*model).empty() ? Record(s, "REPRESENTATION") : model;
    if (!args) continue;
    const auto p = Split(*args);
    if (p.size() < 2) continue;
    const auto items = List(p[1]);
    std::string camera;
    for (std::string_view item : items)
      if (auto it = cameraName.find(Ref(item)); it != cameraName.end()) camera = it->second;
    if (camera.empty()) continue;
    if (std::find(out.viewNames_.begin(), out.viewNames_.end(), camera) == out.viewNames_.end())
      out.viewNames_.push_back(camera);
    Camera& view = out.cameras_[camera];
    std::unordered_set<std::string> seen(view.shows.begin(), view.shows.end());
    auto show = [&](long callout) {
      auto it = keyOf.find(callout);
      if (it != keyOf.end() && seen.insert(it->second).second) view.shows.push_back(it->second);
    };
    for (std::string_view item : items) {
      const long ref = Ref(item);
      const std::string_view is = scan.At(ref);
      if (TypeOf(is) == "DRAUGHTING_CALLOUT") show(ref);
      else if (auto plane = Record(is, "ANNOTATION_PLANE")) {
        const auto q = Split(*plane);
        if (q.size() >= 4)
          for (std::string_view c : List(q[3])) show(Ref(c));
      } else if (auto it = calloutOf.find(ref); it != calloutOf.end()) {
        show(it->second);
      }
    }
    // The view may also be known by its draughting model's own name.
    const std::string name = Str(p[0]);
    if (!name.empty() && name != camera && !out.cameras_.count(name)) out.cameras_[name] = view;
  }
  return out;
}

std::optional<double> QelStepDraughting::DimensionNominal(size_t n) const {
  return n < dimensionNominals_.size() ? dimensionNominals_[n] : std::nullopt;
}

double QelStepDraughting::DimensionScale(size_t n) const {
  return n < dimensionScales_.size() ? dimensionScales_[n] : 1.0;
}

const QelStepDraughting::Camera* QelStepDraughting::FindCamera(const std::string& viewName) const {
  auto it = cameras_.find(viewName);
  return it == cameras_.end() ? nullptr : &it->second;
}

const std::vector<QelModelSegment>& QelStepDraughting::Drawing(const std::string& key) const {
  static const std::vector<QelModelSegment> none;
  auto it = drawings_.find(key);
  return it == drawings_.end() ? none : it->second;
}
