#pragma once
// QelRenderScene: what one picture is made of, as plain values: placed shapes and
// annotation marks in world coordinates. Built for one draw and thrown away; shapes are
// shared with the model, never copied.
#include <memory>
#include <string>
#include <vector>

#include "QelMathTransformation.h"
#include "QelMeshShape.h"

struct QelRenderColor {
  float r = 0.0f;
  float g = 0.0f;
  float b = 0.0f;
  friend bool operator==(const QelRenderColor&, const QelRenderColor&) = default;
};

struct QelRenderMesh {
  std::shared_ptr<const QelMeshShape> shape;
  QelMathTransformation toWorld{};
  QelRenderColor color{0.62f, 0.66f, 0.72f};
};

struct QelRenderAnnotation {
  QelMathPoint anchor{};
  std::vector<QelMathPoint> segments{};  // pairs: from, to
  QelRenderColor color{};
  std::string text{};
  // A tolerance frame's compartments (characteristic symbol first), drawn as boxes side
  // by side instead of `text`; empty for a label of one box.
  std::vector<std::string> compartments{};
};

struct QelRenderScene {
  std::vector<QelRenderMesh> meshes;
  std::vector<QelRenderAnnotation> annotations;
};
