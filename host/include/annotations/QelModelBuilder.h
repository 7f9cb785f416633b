#pragma once
// QelModelBuilder: makes an annotated product model in code (tests, benchmarks, and the
// model file loader itself). The root product owns the whole model: dropping the last
// handle on the root frees every object, since all other links are weak upward.
//
//   QelModelBuilder b("Root");
//   QelBaseUnknown_var part = b.AddProduct(b.Root(), {.alias = "Part1"});
//   QelBaseUnknown_var set = b.AddSet(part, {.alias = "Set.1", .light = true});
//   QelBaseUnknown_var drf = b.AddAnnotation(set, {.alias = "Datum.1", .typeName = "Datum",
//                                                  .subTypeName = "Simple", .typeCode = 3});
//   QelBaseUnknown_var root = b.Finish();
//
// Handles given out keep their object alive on their own; objects of a dropped model
// stay valid but answer as if detached (no set, no owner).
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "QelMathPlane.h"
#include "QelMathTransformation.h"
#include "QelMeshShape.h"
#include "QelVar.h"

// Whether a set is one of the root product's own sets, and as what.
enum class QelRootSetScope { None, Direct, ARM };
// Text and dimension visualisation objects are annotations that type filters leave out.
enum class QelAnnotationVisu { None, Text, Dimension };

// What the model's source file holds and was not read, of one kind: how many, and the
// file's names for them (STEP entity numbers), so a reviewer knows the model is partial.
struct QelModelNotRead {
  std::string kind{};
  size_t count = 0;
  std::vector<std::string> entities{};
};

struct QelModelProductDesc {
  std::string alias{};
  std::string icon = "I_Product";
  bool shown = true;
  bool lightLoadMode = false;
  // From the product's coordinates to its father's; the root has no father and keeps the identity.
  QelMathTransformation placement{};
  // The product's shape in its own coordinates (primitives or a mesh file), or none.
  std::shared_ptr<const QelMeshShape> shape{};
};

struct QelModelRepInstanceDesc {
  std::string alias{};             // the instance
  std::string referenceAlias{};    // the representation reference it instantiates
  std::string icon = "I_RepInstance";
};

struct QelModelSetDesc {
  std::string alias{};
  std::string icon = "I_AnnotationSet";
  int kind = 1;
  bool light = false;
  QelRootSetScope rootScope = QelRootSetScope::None;
  // A rep instance of the owner whose reference stores the set; null: stored in the owner.
  QelBaseUnknown* rep = nullptr;
  bool shown = true;
};

struct QelModelSegment {
  QelMathPoint from{};
  QelMathPoint to{};
};

// A geometric tolerance's feature control frame: the zone's size and shape, the material
// condition it applies at, and the datums it refers to in order of precedence.
struct QelModelToleranceFrame {
  double zone = 0.0;
  std::string zoneShape{};            // "", "diameter" or "spherical diameter"
  std::string material{};             // "", "M" (maximum) or "L" (least material condition)
  std::vector<std::string> datums{};  // "A", "B", ... as the frame's compartments read
};

// A dimension's nominal value and its tolerance: deviations from the nominal (the lower
// one usually negative) or the two limits.
struct QelModelDimensionValue {
  double nominal = 0.0;
  std::optional<double> upper{};
  std::optional<double> lower{};
  bool limits = false;  // upper and lower are limits rather than deviations
};

struct QelModelAnnotationDesc {
  std::string alias{};
  std::vector<std::string> navigationNames{};
  std::string icon = "I_Annotation";
  std::string typeName{};
  std::string subTypeName{};
  int typeCode = 3;
  // Answers QelILumGeometry instead of QelITPS (annotated geometries).
  bool geometry = false;
  QelAnnotationVisu visu = QelAnnotationVisu::None;
  std::optional<double> tolerance{};
  bool isDefault = false;
  bool shown = true;
  QelMathPoint anchor{};
  std::vector<QelModelSegment> segments{};
  // The point of the annotated geometry a leader runs to from the anchor, if known.
  std::optional<QelMathPoint> leader{};
  std::optional<QelModelToleranceFrame> frame{};
  std::optional<QelModelDimensionValue> dimension{};
};

struct QelModelViewDesc {
  std::string alias{};
  std::string icon = "I_AnnotationView";
  std::optional<QelMathPlane> plane = QelMathPlane();
  std::vector<QelBaseUnknown*> elements{};        // annotations of the same set
  bool extraction = false;
  std::vector<QelBaseUnknown*> referenceViews{};  // extraction views only
  std::vector<QelBaseUnknown*> relatedViews{};    // what component 45 lists for the view
  bool shown = true;
};

struct QelModelCameraDesc {
  QelMathPoint origin{};
  QelMathPoint target{};
  QelMathVector zenith{0.0, 0.0, 1.0};
};

struct QelModelCaptureDesc {
  std::string alias{};
  std::string icon = "I_Capture";
  QelBaseUnknown* view = nullptr;               // linked view of the same set, or none
  std::optional<QelModelCameraDesc> camera{};
  bool shown = true;
};

class QelModelBuilder {
 public:
  explicit QelModelBuilder(const QelModelProductDesc& root = {.alias = "Root"});
  ~QelModelBuilder();
  QelModelBuilder(const QelModelBuilder&) = delete;
  QelModelBuilder& operator=(const QelModelBuilder&) = delete;

  // The root product (late type "SorOccurrence"); null after Finish.
  QelBaseUnknown_var Root() const;

  // Each Add answers the new object, or null (and an assertion report) when a handle
  // passed is not of the expected kind or belongs to another model.
  QelBaseUnknown_var AddProduct(const QelBaseUnknown_var& parent, const QelModelProductDesc& desc);
  QelBaseUnknown_var AddRepInstance(const QelBaseUnknown_var& product, const QelModelRepInstanceDesc& desc);
  QelBaseUnknown_var AddSet(const QelBaseUnknown_var& owner, const QelModelSetDesc& desc);
  QelBaseUnknown_var AddAnnotation(const QelBaseUnknown_var& set, const QelModelAnnotationDesc& desc);
  QelBaseUnknown_var AddView(const QelBaseUnknown_var& set, const QelModelViewDesc& desc);
  QelBaseUnknown_var AddCapture(const QelBaseUnknown_var& set, const QelModelCaptureDesc& desc);
  // The views component's second list of the set; by default every capture of the set.
  bool SetOtherElements(const QelBaseUnknown_var& set, const std::vector<QelBaseUnknown*>& elements);

  // Hands the root over and leaves the builder empty.
  QelBaseUnknown_var Finish();

  // Gives a product of this model (the root too) its shape; false for anything else.
  bool SetShape(const QelBaseUnknown_var& product, std::shared_ptr<const QelMeshShape> shape);

  // Cuts a view's or capture's link to its set while the set still lists it: the object's
  // set can no longer be found, as in a host whose record of it was lost. False for
  // anything else.
  static bool DetachFromSet(const QelBaseUnknown_var& viewOrCapture);

  // Shown/hidden state of any model object, outside the facet services.
  static bool SetShown(const QelBaseUnknown_var& object, bool shown);
  // Switches a set owner's light-load mode; observers are told when it changes.
  static HRESULT SwitchLightLoadMode(const QelBaseUnknown_var& owner, bool on);

  // The name reports use for the model (file name for loaded models).
  void SetSourceName(const std::string& name);
  // What the source file held and the model lacks; read back with NotRead.
  void SetNotRead(std::vector<QelModelNotRead> notRead);
  // The list of the model of any of its objects; empty for a complete model.
  static std::vector<QelModelNotRead> NotRead(QelBaseUnknown* object);
  // The length unit every coordinate and value of the model is in ("mm", "in"...); empty
  // when the model does not say.
  void SetLengthUnit(const std::string& unit);

 private:
  struct State;
  std::unique_ptr<State> state_;
};
