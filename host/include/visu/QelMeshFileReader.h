#pragma once
// QelMeshFileReader: reads a triangle mesh from an STL, OBJ, PLY or glTF file (through
// assimp), every node's transformation applied, into a QelMeshShape. Stateless.
#include <string>

#include "QelMeshShape.h"

namespace QelMeshFileReader {
// True and the mesh; false and the reason (without the file name) otherwise. An empty
// mesh, a file of another kind and a truncated file are refused.
bool Read(const std::string& path, QelMeshShape& mesh, std::string& reason);
}  // namespace QelMeshFileReader
