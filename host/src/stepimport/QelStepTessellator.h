#pragma once
// QelStepTessellator: turns a translated shape into the triangle mesh the model keeps for
// it, in the shape's own coordinates, within the importer's tessellation tolerance. The
// shape gains its triangulation as a side effect; the mesh is a new shared value.
#include <memory>

#include <Message_ProgressRange.hxx>
#include <TopoDS_Shape.hxx>

#include "QelMeshShape.h"

namespace QelStepTessellator {
// The chordal deviation used for `shape` (see QelStepImporter).
double Deflection(const TopoDS_Shape& shape);
// Null when the shape has no face (wires, points, an empty compound).
std::shared_ptr<const QelMeshShape> Mesh(const TopoDS_Shape& shape, const Message_ProgressRange& progress);
}  // namespace QelStepTessellator
