#include "QelStepPmiReader.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <map>
#include <set>
#include <tuple>

#include <BRepBndLib.hxx>
#include <BRep_Tool.hxx>
#include <Bnd_Box.hxx>
#include <Geom_Curve.hxx>
#include <Geom_Line.hxx>
#include <TCollection_HAsciiString.hxx>
#include <TopExp_Explorer.hxx>
#include <TopoDS.hxx>
#include <TopoDS_Edge.hxx>
#include <TDF_LabelSequence.hxx>
#include <TDF_Tool.hxx>
#include <XCAFDimTolObjects_DatumObject.hxx>
#include <XCAFDimTolObjects_DimensionObject.hxx>
#include <XCAFDimTolObjects_GeomToleranceObject.hxx>
#include <XCAFDoc_Datum.hxx>
#include <XCAFDoc_DimTolTool.hxx>
#include <XCAFDoc_Dimension.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>
#include <XCAFDoc_GeomTolerance.hxx>
#include <XCAFDoc_View.hxx>
#include <XCAFDoc_ViewTool.hxx>
#include <XCAFView_Object.hxx>

#include "QelModelObject.h"

namespace {
std::string Entry(const TDF_Label& label) {
  TCollection_AsciiString entry;
  TDF_Tool::Entry(label, entry);
  return entry.ToCString();
}

std::string Text(const Handle(TCollection_HAsciiString)& text) { return text.IsNull() ? std::string() : text->ToCString(); }

QelMathPoint Point(const gp_Pnt& p) { return {p.X(), p.Y(), p.Z()}; }
QelMathVector Vector(const gp_Dir& d) { return {d.X(), d.Y(), d.Z()}; }

// "linear distance" -> "Linear Distance": the file's own words, as a sub-type name reads.
std::string Capitalised(std::string text) {
  bool start = true;
  for (char& c : text) {
    if (start) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    start = c == ' ' || c == '_';
    if (c == '_') c = ' ';
  }
  return text;
}

const char* ToleranceName(XCAFDimTolObjects_GeomToleranceType type) {
  switch (type) {
    case XCAFDimTolObjects_GeomToleranceType_Angularity: return "Angularity";
    case XCAFDimTolObjects_GeomToleranceType_CircularRunout: return "Circular Runout";
    case XCAFDimTolObjects_GeomToleranceType_CircularityOrRoundness: return "Circularity";
    case XCAFDimTolObjects_GeomToleranceType_Coaxiality: return "Coaxiality";
    case XCAFDimTolObjects_GeomToleranceType_Concentricity: return "Concentricity";
    case XCAFDimTolObjects_GeomToleranceType_Cylindricity: return "Cylindricity";
    case XCAFDimTolObjects_GeomToleranceType_Flatness: return "Flatness";
    case XCAFDimTolObjects_GeomToleranceType_Parallelism: return "Parallelism";
    case XCAFDimTolObjects_GeomToleranceType_Perpendicularity: return "Perpendicularity";
    case XCAFDimTolObjects_GeomToleranceType_Position: return "Position";
    case XCAFDimTolObjects_GeomToleranceType_ProfileOfLine: return "Profile of a Line";
    case XCAFDimTolObjects_GeomToleranceType_ProfileOfSurface: return "Profile of a Surface";
    case XCAFDimTolObjects_GeomToleranceType_Straightness: return "Straightness";
    case XCAFDimTolObjects_GeomToleranceType_Symmetry: return "Symmetry";
    case XCAFDimTolObjects_GeomToleranceType_TotalRunout: return "Total Runout";
    default: return "Geometrical Tolerance";
  }
}

// Empty for a type the file did not state: the caller falls back to the file's name for it.
std::string DimensionName(XCAFDimTolObjects_DimensionType type) {
  switch (type) {
    case XCAFDimTolObjects_DimensionType_Location_CurvedDistance: return "Curved Distance";
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromCenterToOuter:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromCenterToInner:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromOuterToCenter:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromOuterToOuter:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromOuterToInner:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromInnerToCenter:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromInnerToOuter:
    case XCAFDimTolObjects_DimensionType_Location_LinearDistance_FromInnerToInner: return "Linear Distance";
    case XCAFDimTolObjects_DimensionType_Location_Angular:
    case XCAFDimTolObjects_DimensionType_Size_Angular: return "Angle";
    case XCAFDimTolObjects_DimensionType_Location_Oriented: return "Oriented Distance";
    case XCAFDimTolObjects_DimensionType_Location_WithPath:
    case XCAFDimTolObjects_DimensionType_Size_WithPath: return "Distance Along a Path";
    case XCAFDimTolObjects_DimensionType_Size_CurveLength: return "Curve Length";
    case XCAFDimTolObjects_DimensionType_Size_Diameter: return "Diameter";
    case XCAFDimTolObjects_DimensionType_Size_SphericalDiameter: return "Spherical Diameter";
    case XCAFDimTolObjects_DimensionType_Size_Radius: return "Radius";
    case XCAFDimTolObjects_DimensionType_Size_SphericalRadius: return "Spherical Radius";
    case XCAFDimTolObjects_DimensionType_Size_ToroidalMinorDiameter:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalMajorDiameter:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalHighMajorDiameter:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalLowMajorDiameter: return "Toroidal Diameter";
    case XCAFDimTolObjects_DimensionType_Size_ToroidalMinorRadius:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalMajorRadius:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalHighMajorRadius:
    case XCAFDimTolObjects_DimensionType_Size_ToroidalLowMajorRadius: return "Toroidal Radius";
    case XCAFDimTolObjects_DimensionType_Size_Thickness: return "Thickness";
    default: return {};
  }
}

std::string Number(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}

// The lines of an annotation's graphic presentation (its frame, leaders and text strokes)
// as segments: a straight edge as one, a curved one as kCurvePieces. A presentation of
// more than kMaxSegments is cut there, so one odd annotation cannot swamp a picture.
constexpr int kCurvePieces = 12;
constexpr size_t kMaxSegments = 4000;

std::vector<QelModelSegment> Segments(const TopoDS_Shape& presentation) {
  std::vector<QelModelSegment> out;
  if (presentation.IsNull()) return out;
  for (TopExp_Explorer edges(presentation, TopAbs_EDGE); edges.More() && out.size() < kMaxSegments; edges.Next()) {
    const TopoDS_Edge& edge = TopoDS::Edge(edges.Current());
    TopLoc_Location location;
    double first = 0.0, last = 0.0;
    const Handle(Geom_Curve) curve = BRep_Tool::Curve(edge, location, first, last);
    if (curve.IsNull() || !std::isfinite(first) || !std::isfinite(last)) continue;
    const gp_Trsf& place = location.Transformation();
    const int pieces = curve->IsKind(STANDARD_TYPE(Geom_Line)) ? 1 : kCurvePieces;
    gp_Pnt from = curve->Value(first).Transformed(place);
    for (int i = 1; i <= pieces && out.size() < kMaxSegments; ++i) {
      const gp_Pnt to = curve->Value(first + (last - first) * i / pieces).Transformed(place);
      out.push_back({{from.X(), from.Y(), from.Z()}, {to.X(), to.Y(), to.Z()}});
      from = to;
    }
  }
  return out;
}

// Where an annotation's label stands: where the file puts its text, else amid its drawing,
// else at the geometry it annotates; an annotation plane's origin only when nothing else
// is known, since files put many annotations' planes through one point.
template <class Object>
QelMathPoint Anchor(const Object& object, bool hasText, const gp_Pnt& text, const std::vector<QelModelSegment>& drawing,
                    const std::optional<QelMathPoint>& geometry) {
  if (hasText) return Point(text);
  if (!drawing.empty()) {
    QelMathPoint low = drawing.front().from, high = low;
    for (const QelModelSegment& s : drawing)
      for (const QelMathPoint& p : {s.from, s.to}) {
        low = {std::min(low.x, p.x), std::min(low.y, p.y), std::min(low.z, p.z)};
        high = {std::max(high.x, p.x), std::max(high.y, p.y), std::max(high.z, p.z)};
      }
    return (low + high) * 0.5;
  }
  if (geometry) return *geometry;
  if (object->HasPlane()) return Point(object->GetPlane().Location());
  if (object->HasPoint()) return Point(object->GetPoint());
  return {};
}

// The datum letters of a tolerance's frame in order of precedence; the datums of one
// compartment (a common datum) joined as "A-B".
std::vector<std::string> DatumReferences(const Handle(XCAFDoc_DimTolTool)& tool, const TDF_Label& tolerance) {
  TDF_LabelSequence datums;
  tool->GetDatumWithObjectOfTolerLabels(tolerance, datums);
  std::map<int, std::string> byPosition;
  int unplaced = 1000;
  for (const TDF_Label& label : datums) {
    Handle(XCAFDoc_Datum) datum;
    if (!label.FindAttribute(XCAFDoc_Datum::GetID(), datum)) continue;
    Handle(XCAFDimTolObjects_DatumObject) object = datum->GetObject();
    if (object.IsNull()) continue;
    const std::string letter = Text(object->GetName());
    if (letter.empty()) continue;
    const int position = object->GetPosition() > 0 ? object->GetPosition() : unplaced++;
    std::string& compartment = byPosition[position];
    if (compartment.find(letter) == std::string::npos) compartment += (compartment.empty() ? "" : "-") + letter;
  }
  std::vector<std::string> out;
  for (auto& [position, letters] : byPosition) out.push_back(std::move(letters));
  return out;
}

// The leader runs from the label to the annotated geometry, when both are known and apart.
std::optional<QelMathPoint> Leader(const QelMathPoint& anchor, const std::optional<QelMathPoint>& geometry) {
  if (!geometry || (*geometry - anchor).Norm() < 1e-6) return std::nullopt;
  return geometry;
}
}  // namespace

struct QelStepPmiReader::Pending {
  TDF_Label label;
  QelModelAnnotationDesc desc;
  std::string owner;     // entry of the owning prototype, "" when none is known
  std::string datumKey;  // datums repeat once per tolerance that cites them: one per letter
  std::string fileKey;   // how the file's own presentation names it (QelStepDraughting)
};

QelStepPmiReader::QelStepPmiReader(const Handle(TDocStd_Document)& document, QelModelBuilder& builder,
                                   const std::unordered_map<std::string, QelBaseUnknown_var>& productOf,
                                   std::string_view fileText)
    : document_(document), builder_(builder), productOf_(productOf), fileText_(fileText) {}

const QelStepToleranceValues& QelStepPmiReader::ToleranceValues() {
  if (!toleranceValues_) toleranceValues_ = QelStepToleranceValues::Scan(fileText_);
  return *toleranceValues_;
}

std::optional<QelMathPoint> QelStepPmiReader::GeometryCentre(const TDF_Label& label) const {
  Handle(XCAFDoc_DimTolTool) tool = XCAFDoc_DocumentTool::DimTolTool(document_->Main());
  TDF_LabelSequence first, second;
  tool->GetRefShapeLabel(label, first, second);
  first.Append(second);
  Bnd_Box box;
  for (const TDF_Label& ref : first) {
    const TopoDS_Shape shape = XCAFDoc_ShapeTool::GetShape(ref);
    if (!shape.IsNull()) BRepBndLib::Add(shape, box, false);
  }
  if (box.IsVoid()) return std::nullopt;
  double x0, y0, z0, x1, y1, z1;
  box.Get(x0, y0, z0, x1, y1, z1);
  return QelMathPoint{(x0 + x1) / 2, (y0 + y1) / 2, (z0 + z1) / 2};
}

// The prototype (part or assembly) whose shapes a GD&T label refers to: sub-shape labels
// sit below their prototype, which sits directly below the shapes label.
std::string QelStepPmiReader::OwnerOf(const TDF_Label& label) const {
  Handle(XCAFDoc_DimTolTool) tool = XCAFDoc_DocumentTool::DimTolTool(document_->Main());
  const TDF_Label shapes = XCAFDoc_DocumentTool::ShapesLabel(document_->Main());
  TDF_LabelSequence first, second;
  tool->GetRefShapeLabel(label, first, second);
  first.Append(second);
  for (const TDF_Label& ref : first) {
    TDF_Label at = ref;
    while (!at.IsNull() && !at.IsRoot() && at.Father() != shapes) at = at.Father();
    if (at.IsNull() || at.IsRoot()) continue;
    const std::string entry = Entry(at);
    auto it = productOf_.find(entry);
    if (it == productOf_.end()) continue;
    // Several labels may show one product (the pieces of its shape): one owner for them all,
    // and "" for the root, as for annotations that name no shape.
    if (it->second->IsEqual(builder_.Root().get())) return {};
    return ownerKey_.emplace(it->second->GetImpl(), entry).first->second;
  }
  return {};
}

QelBaseUnknown_var QelStepPmiReader::SetFor(const std::string& owner) {
  if (auto it = sets_.find(owner); it != sets_.end()) return it->second;
  QelBaseUnknown_var product = owner.empty() ? builder_.Root() : productOf_.at(owner);
  const bool isRoot = product->IsEqual(builder_.Root().get());
  std::string alias;
  if (auto* named = QelModelObject::From(product.get())) alias = named->Alias();
  // What a file gives is already the lightweight review form (tessellated shapes, drawn
  // annotations), so sets are light and the views browser shows their captures; the root
  // presents the sets of the parts below it as its own, as an assembly does.
  QelBaseUnknown_var set = builder_.AddSet(
      product, {.alias = alias + " Annotations",
                .light = true,
                .rootScope = isRoot ? QelRootSetScope::Direct : QelRootSetScope::ARM});
  sets_.emplace(owner, set);
  return set;
}

void QelStepPmiReader::Read(const QelMathPoint& sceneCentre, double sceneSize, std::vector<std::string>& notes) {
  Handle(XCAFDoc_DimTolTool) tool = XCAFDoc_DocumentTool::DimTolTool(document_->Main());
  std::vector<Pending> pending;
  const QelStepDraughting draughting = QelStepDraughting::Scan(fileText_);
  std::map<std::string, size_t> dimensionSeen;
  std::set<size_t> taken;  // the file's dimensions matched already
  // The label's place: from the translator's drawing, else the file's own drawing of it.
  auto Place = [&](Pending& p, const auto& object, bool hasText, const gp_Pnt& text, std::vector<QelModelSegment> drawn) {
    if (drawn.empty() && !p.fileKey.empty()) drawn = draughting.Drawing(p.fileKey);
    const std::optional<QelMathPoint> geometry = GeometryCentre(p.label);
    p.desc.anchor = Anchor(object, hasText, text, drawn, geometry);
    p.desc.leader = Leader(p.desc.anchor, geometry);
    p.desc.segments = std::move(drawn);
  };

  TDF_LabelSequence labels;
  tool->GetDatumLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_Datum) datum;
    if (!label.FindAttribute(XCAFDoc_Datum::GetID(), datum)) continue;
    Handle(XCAFDimTolObjects_DatumObject) object = datum->GetObject();
    if (object.IsNull()) continue;
    const std::string letter = Text(object->GetName());
    Pending p{label, {}, OwnerOf(label), letter.empty() ? Entry(label) : letter, "A:" + letter};
    p.desc.alias = "Datum " + letter;
    p.desc.navigationNames = {letter};
    p.desc.typeName = "Datum";
    p.desc.subTypeName = "Datum " + letter;
    p.desc.typeCode = 3;
    Place(p, object, object->HasPointText(), object->GetPointTextAttach(), Segments(object->GetPresentation()));
    pending.push_back(std::move(p));
  }

  labels.Clear();
  tool->GetGeomToleranceLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_GeomTolerance) tolerance;
    if (!label.FindAttribute(XCAFDoc_GeomTolerance::GetID(), tolerance)) continue;
    Handle(XCAFDimTolObjects_GeomToleranceObject) object = tolerance->GetObject();
    if (object.IsNull()) continue;
    const std::string name = Text(object->GetSemanticName());
    Pending p{label, {}, OwnerOf(label), {}, "T:" + name};
    double value = object->GetValue();
    if (value == 0.0 && !name.empty()) ToleranceValues().Find(name, value);
    p.desc.typeName = "Geometrical Tolerance";
    p.desc.subTypeName = ToleranceName(object->GetType());
    p.desc.alias = name.empty() ? p.desc.subTypeName + " " + Number(value) : name;
    p.desc.navigationNames = {p.desc.alias};
    p.desc.typeCode = 5;
    p.desc.tolerance = value;
    QelModelToleranceFrame frame{.zone = value};
    if (object->GetTypeOfValue() == XCAFDimTolObjects_GeomToleranceTypeValue_Diameter) frame.zoneShape = "diameter";
    if (object->GetTypeOfValue() == XCAFDimTolObjects_GeomToleranceTypeValue_SphericalDiameter)
      frame.zoneShape = "spherical diameter";
    if (object->GetMaterialRequirementModifier() == XCAFDimTolObjects_GeomToleranceMatReqModif_M) frame.material = "M";
    if (object->GetMaterialRequirementModifier() == XCAFDimTolObjects_GeomToleranceMatReqModif_L) frame.material = "L";
    frame.datums = DatumReferences(tool, label);
    p.desc.frame = std::move(frame);
    Place(p, object, object->HasPointText(), object->GetPointTextAttach(), Segments(object->GetPresentation()));
    pending.push_back(std::move(p));
  }

  labels.Clear();
  tool->GetDimensionLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_Dimension) dimension;
    if (!label.FindAttribute(XCAFDoc_Dimension::GetID(), dimension)) continue;
    Handle(XCAFDimTolObjects_DimensionObject) object = dimension->GetObject();
    if (object.IsNull()) continue;
    const std::string name = Text(object->GetSemanticName());
    // The file's dimension of this name and nominal value not taken yet, else the n-th of
    // this name: files name many dimensions alike ("diameter").
    const double given = object->GetValue();
    const std::vector<std::string>& names = draughting.DimensionNames();
    std::optional<size_t> match;
    for (size_t i = 0; i < names.size() && !match; ++i) {
      const std::optional<double> nominal = draughting.DimensionNominal(i);
      if (names[i] == name && !taken.count(i) && nominal && std::abs(*nominal - given) <= 1e-9 * std::max(1.0, std::abs(given)))
        match = i;
    }
    for (size_t i = 0, at = 0, index = dimensionSeen[name]; i < names.size() && !match; ++i)
      if (names[i] == name && at++ == index && !taken.count(i)) match = i;
    ++dimensionSeen[name];
    std::string key;
    // The translator gives nominal values and limits in the file's unit, deviations and
    // shapes in millimetres: the model's unit.
    double scale = 1.0;
    if (match) {
      taken.insert(*match);
      key = "D:" + std::to_string(*match);
      scale = draughting.DimensionScale(*match);
    }
    Pending p{label, {}, OwnerOf(label), {}, key};
    const XCAFDimTolObjects_DimensionType type = object->GetType();
    if (type == XCAFDimTolObjects_DimensionType_CommonLabel ||
        type == XCAFDimTolObjects_DimensionType_DimensionPresentation) {
      // Text without semantics: a label, or a presentation the file gives no meaning to.
      p.desc.typeName = "Note";
      p.desc.subTypeName = type == XCAFDimTolObjects_DimensionType_CommonLabel ? "Label" : "Presentation";
      p.desc.typeCode = 9;
      p.desc.alias = name.empty() ? Text(object->GetPresentationName()) : name;
      if (p.desc.alias.empty()) p.desc.alias = p.desc.subTypeName;
    } else {
      std::string sub = DimensionName(type);
      if (sub.empty()) sub = name.empty() ? "Dimension" : Capitalised(name);
      p.desc.typeName = "Dimension";
      p.desc.subTypeName = sub;
      p.desc.typeCode = 6;
      const double value = object->GetValue() * scale;
      p.desc.alias = (name.empty() ? sub : name) + (value != 0.0 ? " " + Number(value) : std::string());
      QelModelDimensionValue said{.nominal = value};
      // The translator gives the lower deviation as its size below the nominal value.
      if (object->IsDimWithPlusMinusTolerance()) {
        p.desc.tolerance = object->GetUpperTolValue() + object->GetLowerTolValue();
        said.upper = object->GetUpperTolValue();
        said.lower = -object->GetLowerTolValue();
      } else if (object->IsDimWithRange()) {
        p.desc.tolerance = (object->GetUpperBound() - object->GetLowerBound()) * scale;
        said.upper = object->GetUpperBound() * scale;
        said.lower = object->GetLowerBound() * scale;
        said.limits = true;
      }
      // A dimension the file gives no value (the translator's 0) says no number.
      if (value != 0.0 || said.upper || said.lower) p.desc.dimension = said;
    }
    p.desc.navigationNames = {p.desc.alias};
    Place(p, object, object->HasTextPoint(), object->GetPointTextAttach(), Segments(object->GetPresentation()));
    pending.push_back(std::move(p));
  }

  // Annotations that name no shape of a known product go with the product that owns most
  // of the others, so that a view's annotations stay in one set.
  std::map<std::string, size_t> owners;
  for (const Pending& p : pending)
    if (!p.owner.empty()) ++owners[p.owner];
  std::string main;
  size_t most = 0;
  for (const auto& [owner, count] : owners)
    if (count > most) std::tie(main, most) = std::make_pair(owner, count);

  // Names repeat in files ("diameter 35" for four holes): the second and later of a name
  // get its count, in the translator's order, which is the same at every opening.
  std::map<std::string, int> named;
  for (Pending& p : pending) {
    if (!p.datumKey.empty()) continue;
    if (const int n = ++named[p.desc.alias]; n > 1) {
      p.desc.alias += " (" + std::to_string(n) + ")";
      p.desc.navigationNames = {p.desc.alias};
    }
  }

  struct Made {
    QelBaseUnknown_var annotation;
    std::string owner;
  };
  // The file names a callout's annotation by a key two annotations may share (the rows of
  // a composite frame carry one name): a view showing the key shows both.
  std::unordered_map<std::string, std::vector<Made>> byKey;
  std::unordered_map<std::string, Made> byLabel;
  std::map<std::pair<std::string, std::string>, QelBaseUnknown_var> datums;  // (owner, letter)
  for (Pending& p : pending) {
    const std::string owner = p.owner.empty() ? main : p.owner;
    QelBaseUnknown_var made;
    if (!p.datumKey.empty()) {
      auto it = datums.find({owner, p.datumKey});
      if (it != datums.end()) made = it->second;
    }
    if (!made) {
      made = builder_.AddAnnotation(SetFor(owner), p.desc);
      ++annotationCount_;
      if (!p.datumKey.empty()) datums.emplace(std::make_pair(owner, p.datumKey), made);
    }
    byLabel.emplace(Entry(p.label), Made{made, owner});
    if (!p.fileKey.empty()) {
      std::vector<Made>& same = byKey[p.fileKey];
      if (std::none_of(same.begin(), same.end(), [&](const Made& m) { return m.annotation->IsEqual(made.get()); }))
        same.push_back(Made{made, owner});
    }
  }

  // The saved views as the translator gives them, corrected by the file's cameras; the
  // file's own when the translator gives none.
  struct Saved {
    std::string name;
    QelMathPoint eye;
    QelMathVector sight, up;
    bool parallel, front, back;
    double frontAt, backAt;
    std::vector<const Made*> shown;
  };
  std::vector<Saved> saved;
  Handle(XCAFDoc_ViewTool) views = XCAFDoc_DocumentTool::ViewTool(document_->Main());
  labels.Clear();
  views->GetViewLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_View) view;
    if (!label.FindAttribute(XCAFDoc_View::GetID(), view)) continue;
    Handle(XCAFView_Object) object = view->GetObject();
    if (object.IsNull()) continue;
    const std::string name = Text(object->Name());
    const QelStepDraughting::Camera* camera = draughting.FindCamera(name);
    // The translator gives the projection point as the file does, in the camera's own
    // placement; the file's camera says where that is in the model.
    Saved v{name,
            camera ? camera->eye : Point(object->ProjectionPoint()),
            Vector(object->ViewDirection()),
            Vector(object->UpDirection()),
            object->Type() == XCAFView_ProjectionType_Parallel,
            camera ? camera->frontClipping : static_cast<bool>(object->HasFrontPlaneClipping()),
            camera ? camera->backClipping : static_cast<bool>(object->HasBackPlaneClipping()),
            camera ? camera->frontDistance : object->FrontPlaneDistance(),
            camera ? camera->backDistance : object->BackPlaneDistance(),
            {}};
    TDF_LabelSequence refs;
    views->GetRefGDTLabel(label, refs);
    for (const TDF_Label& ref : refs)
      if (auto it = byLabel.find(Entry(ref)); it != byLabel.end()) v.shown.push_back(&it->second);
    // The translator leaves some views empty: what the file's view lists stands instead.
    if (v.shown.empty() && camera)
      for (const std::string& key : camera->shows)
        if (auto it = byKey.find(key); it != byKey.end())
          for (const Made& made : it->second) v.shown.push_back(&made);
    saved.push_back(std::move(v));
  }
  if (saved.empty()) {
    for (const std::string& name : draughting.ViewNames()) {
      const QelStepDraughting::Camera* camera = draughting.FindCamera(name);
      Saved v{name,           camera->eye,           camera->axis,          camera->up, camera->parallel,
              camera->frontClipping, camera->backClipping, camera->frontDistance, camera->backDistance, {}};
      for (const std::string& key : camera->shows)
        if (auto it = byKey.find(key); it != byKey.end())
          for (const Made& made : it->second) v.shown.push_back(&made);
      saved.push_back(std::move(v));
    }
  }

  for (Saved& v : saved) {
    // The view joins the set holding most of its annotations; the others cannot be its elements.
    std::map<std::string, size_t> bySet;
    for (const Made* made : v.shown) ++bySet[made->owner];
    std::string owner = main;
    size_t best = 0;
    for (const auto& [candidate, count] : bySet)
      if (count > best) std::tie(owner, best) = std::make_pair(candidate, count);
    std::vector<QelBaseUnknown*> elements;
    size_t elsewhere = 0;
    for (const Made* made : v.shown) {
      if (made->owner != owner) {
        ++elsewhere;
        continue;
      }
      QelBaseUnknown* element = made->annotation.get();
      if (std::find(elements.begin(), elements.end(), element) == elements.end()) elements.push_back(element);
    }
    std::string name = v.name.empty() ? "View." + std::to_string(viewCount_ + 1) : v.name;
    if (elsewhere > 0) {
      notes.push_back("view '" + name + "': " + std::to_string(elsewhere) +
                      " annotations of other products are not among its elements");
    }
    const QelMathVector& sight = v.sight;
    const QelMathVector& up = v.up;
    QelMathVector right = sight.Cross(up);
    const double rightLength = right.Norm();
    if (rightLength > 0.0) right = right * (1.0 / rightLength);
    // A saved view clips only where the file asks for a front or back clipping plane: the
    // front plane faces the camera and cuts what lies before it, the back one what lies
    // beyond. With both, the front one is kept: a view clips along one plane here.
    std::optional<QelMathPlane> plane;
    if (v.front) {
      plane = QelMathPlane(v.eye + sight * v.frontAt, -sight, right, up);
    } else if (v.back) {
      plane = QelMathPlane(v.eye + sight * v.backAt, sight, -right, up);
    }
    QelModelViewDesc viewDesc{.alias = name, .plane = plane, .elements = elements};
    QelBaseUnknown_var set = SetFor(owner);
    QelBaseUnknown_var made = builder_.AddView(set, viewDesc);
    // A parallel projection keeps its picture wherever the eye stands along the line of
    // sight, and the translator does not give where the view's window lies in its plane:
    // such a camera looks at the scene's centre from twice the scene's size, so that a
    // perspective viewer (30-degree field) sees the whole part in the middle.
    const double reach = sceneSize > 0.0 ? 2.0 * sceneSize : 1.0;
    QelMathPoint from = v.eye;
    QelMathPoint to = v.eye + sight * std::max((sceneCentre - v.eye).Dot(sight), reach);
    if (v.parallel) {
      from = sceneCentre - sight * reach;
      to = sceneCentre;
    }
    // Named apart from its view, so that a person can tell the two in the panel and files.
    builder_.AddCapture(set, {.alias = name + " Capture",
                              .view = made.get(),
                              .camera = QelModelCameraDesc{from, to, up}});
    ++viewCount_;
    viewNames_.insert(v.name);
  }
}
