#pragma once
// QelStepDraughting: what a STEP file says about the presentation of its annotations, read
// from the file's text where the translator gives it wrongly or not at all: each saved
// view's camera (where it stands, whether it clips) and the annotations it shows, each
// annotation's drawn lines placed in its annotation plane.
// Annotations are named by keys the PMI reader can form from the translated document:
// "T:<tolerance name>", "A:<datum letter>", "D:<n>" for the n-th dimension of the file,
// whose value's unit is read too.
// A plain value, made once per import from the whole text.
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "QelModelBuilder.h"

class QelStepDraughting {
 public:
  struct Camera {
    QelMathPoint eye{};      // where the camera stands, in the model
    QelMathVector axis{};    // its placement's axis: the line of sight
    QelMathVector up{};      // its placement's second axis
    bool parallel = true;
    bool frontClipping = false, backClipping = false;
    double frontDistance = 0.0, backDistance = 0.0;  // along the line of sight from the eye
    std::vector<std::string> shows{};  // keys of the annotations its view lists, in file order
  };

  static QelStepDraughting Scan(std::string_view text);

  // The camera of the saved view of that name (the camera's or the view's own), or null.
  const Camera* FindCamera(const std::string& viewName) const;
  // The names of the file's saved views (their cameras'), in file order.
  const std::vector<std::string>& ViewNames() const { return viewNames_; }
  // The lines an annotation is drawn with, in the model; empty when the file draws none.
  const std::vector<QelModelSegment>& Drawing(const std::string& key) const;
  // The names of the file's dimensions in file order: "D:<n>" is the n-th (from 0).
  const std::vector<std::string>& DimensionNames() const { return dimensionNames_; }
  // Millimetres per unit of the n-th dimension's value as the file writes it (25.4 for
  // inches): the translator gives nominal values in the file's unit.
  double DimensionScale(size_t n) const;
  // The n-th dimension's nominal value as the file writes it, if it gives one.
  std::optional<double> DimensionNominal(size_t n) const;

 private:
  std::unordered_map<std::string, Camera> cameras_;
  std::vector<std::string> viewNames_;
  std::unordered_map<std::string, std::vector<QelModelSegment>> drawings_;
  std::vector<std::string> dimensionNames_;
  std::vector<double> dimensionScales_;
  std::vector<std::optional<double>> dimensionNominals_;
};
