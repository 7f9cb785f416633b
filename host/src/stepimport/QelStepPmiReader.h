#pragma once
// QelStepPmiReader: reads the semantic annotations (datums, geometric tolerances,
// dimensions) and saved views of a translated document into a model under construction.
// Lives for one import; it holds the document's tools and the builder by reference.
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include <TDF_Label.hxx>
#include <TDocStd_Document.hxx>

#include "QelModelBuilder.h"
#include "QelStepDraughting.h"
#include "QelStepToleranceValues.h"

class QelStepPmiReader {
 public:
  // `productOf`: the product made for a shape label (a part or assembly prototype), by the
  // label's entry; `fileText`, the whole file, gives what the translator drops or misplaces
  // (tolerance magnitudes, cameras, the views' contents, the annotations' drawings).
  QelStepPmiReader(const Handle(TDocStd_Document)& document, QelModelBuilder& builder,
                   const std::unordered_map<std::string, QelBaseUnknown_var>& productOf, std::string_view fileText);

  // Adds the sets, annotations, views and captures; `sceneCentre` and `sceneSize` place
  // each capture's target in front of its camera. Adds lines to `notes` for what was left out.
  void Read(const QelMathPoint& sceneCentre, double sceneSize, std::vector<std::string>& notes);

  size_t AnnotationCount() const { return annotationCount_; }
  size_t ViewCount() const { return viewCount_; }
  // The file's names of the saved views made, for the check of what was not read.
  const std::multiset<std::string>& ViewNames() const { return viewNames_; }

 private:
  struct Pending;
  std::string OwnerOf(const TDF_Label& label) const;
  // The centre of the shapes an annotation refers to, if it names any.
  std::optional<QelMathPoint> GeometryCentre(const TDF_Label& label) const;
  const QelStepToleranceValues& ToleranceValues();
  QelBaseUnknown_var SetFor(const std::string& owner);

  Handle(TDocStd_Document) document_;
  QelModelBuilder& builder_;
  const std::unordered_map<std::string, QelBaseUnknown_var>& productOf_;
  std::string_view fileText_;
  std::optional<QelStepToleranceValues> toleranceValues_;
  std::unordered_map<std::string, QelBaseUnknown_var> sets_;  // owner entry ("" the root) -> set
  mutable std::unordered_map<QelBaseUnknown*, std::string> ownerKey_;  // product -> its owner entry
  size_t annotationCount_ = 0;
  size_t viewCount_ = 0;
  std::multiset<std::string> viewNames_;
};
