#include "QelMeshFileReader.h"

#include <assimp/Importer.hpp>
#include <assimp/postprocess.h>
#include <assimp/scene.h>

#include <algorithm>
#include <cctype>
#include <cmath>
#include <filesystem>

namespace {
void AddNode(const aiScene& scene, const aiNode& node, const aiMatrix4x4& parent, QelMeshShape& out) {
  const aiMatrix4x4 m = parent * node.mTransformation;
  for (unsigned i = 0; i < node.mNumMeshes; ++i) {
    const aiMesh& mesh = *scene.mMeshes[node.mMeshes[i]];
    const auto base = static_cast<uint32_t>(out.vertices.size());
    for (unsigned v = 0; v < mesh.mNumVertices; ++v) {
      const aiVector3D p = m * mesh.mVertices[v];
      out.vertices.push_back({p.x, p.y, p.z});
    }
    for (unsigned f = 0; f < mesh.mNumFaces; ++f) {
      const aiFace& face = mesh.mFaces[f];
      if (face.mNumIndices != 3) continue;  // points and lines of a mixed file are not surfaces
      out.triangles.push_back({base + face.mIndices[0], base + face.mIndices[1], base + face.mIndices[2]});
    }
  }
  for (unsigned c = 0; c < node.mNumChildren; ++c) AddNode(scene, *node.mChildren[c], m, out);
}
}  // namespace

bool QelMeshFileReader::Read(const std::string& path, QelMeshShape& mesh, std::string& reason) {
  std::string ext = std::filesystem::path(path).extension().string();
  std::transform(ext.begin(), ext.end(), ext.begin(), [](unsigned char c) { return std::tolower(c); });
  if (ext != ".stl" && ext != ".obj" && ext != ".ply" && ext != ".gltf" && ext != ".glb") {
    reason = "not a mesh file this host reads (STL, OBJ, PLY, glTF)";
    return false;
  }
  std::error_code ec;
  if (!std::filesystem::is_regular_file(path, ec)) {
    reason = "no such file";
    return false;
  }
  Assimp::Importer importer;
  const aiScene* scene =
      importer.ReadFile(path, aiProcess_Triangulate | aiProcess_JoinIdenticalVertices | aiProcess_ValidateDataStructure);
  if (!scene || !scene->mRootNode || (scene->mFlags & AI_SCENE_FLAGS_INCOMPLETE)) {
    reason = importer.GetErrorString();
    if (reason.empty()) reason = "the file could not be read";
    return false;
  }
  QelMeshShape read;
  AddNode(*scene, *scene->mRootNode, aiMatrix4x4(), read);
  if (read.triangles.empty()) {
    reason = "the file holds no triangles";
    return false;
  }
  for (const auto& v : read.vertices) {
    if (!std::isfinite(v[0]) || !std::isfinite(v[1]) || !std::isfinite(v[2])) {
      reason = "the file holds a coordinate that is not a finite number";
      return false;
    }
  }
  mesh = std::move(read);
  return true;
}
