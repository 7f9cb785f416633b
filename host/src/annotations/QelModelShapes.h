#pragma once
// QelModelShapes: reads the "shape" of a product in a model file: box and cylinder
// primitives, tessellated here, and mesh files named relative to the model file. Throws
// std::runtime_error "<JSON path>: <what is wrong>" on bad input; the loader reports it.
#include <memory>
#include <string>

#include <nlohmann/json.hpp>

#include "QelMeshShape.h"
#include "QelVar.h"

namespace QelModelShapes {
// `at`: the JSON path of the value; `product`: the product being read (its model names
// the file that mesh paths are relative to).
std::shared_ptr<const QelMeshShape> Read(const nlohmann::json& value, const std::string& at, QelBaseUnknown* product);
}  // namespace QelModelShapes
