#include "QelStepTessellator.h"

#include <algorithm>
#include <cmath>

#include <BRepBndLib.hxx>
#include <BRepMesh_IncrementalMesh.hxx>
#include <BRep_Tool.hxx>
#include <Bnd_Box.hxx>
#include <Poly_Triangulation.hxx>
#include <TopExp_Explorer.hxx>
#include <TopoDS.hxx>
#include <TopoDS_Face.hxx>

#include "QelStepImporter.h"

double QelStepTessellator::Deflection(const TopoDS_Shape& shape) {
  Bnd_Box box;
  BRepBndLib::Add(shape, box, false);
  if (box.IsVoid()) return QelStepImporter::kMaxDeflection;
  const double diagonal = std::sqrt(box.SquareExtent());
  return std::clamp(diagonal * QelStepImporter::kRelativeDeflection, QelStepImporter::kMinDeflection,
                    QelStepImporter::kMaxDeflection);
}

std::shared_ptr<const QelMeshShape> QelStepTessellator::Mesh(const TopoDS_Shape& shape,
                                                             const Message_ProgressRange& progress) {
  if (shape.IsNull()) return nullptr;
  TopExp_Explorer faces(shape, TopAbs_FACE);
  if (!faces.More()) return nullptr;
  IMeshTools_Parameters parameters;
  parameters.Deflection = Deflection(shape);
  parameters.Angle = QelStepImporter::kAngularDeflection;
  parameters.InParallel = true;
  BRepMesh_IncrementalMesh mesher(shape, parameters, progress);
  auto mesh = std::make_shared<QelMeshShape>();
  for (; faces.More(); faces.Next()) {
    const TopoDS_Face& face = TopoDS::Face(faces.Current());
    TopLoc_Location location;
    const Handle(Poly_Triangulation) triangulation = BRep_Tool::Triangulation(face, location);
    if (triangulation.IsNull()) continue;
    const gp_Trsf& toShape = location.Transformation();
    const auto base = static_cast<uint32_t>(mesh->vertices.size());
    for (int i = 1; i <= triangulation->NbNodes(); ++i) {
      const gp_Pnt p = triangulation->Node(i).Transformed(toShape);
      mesh->vertices.push_back({static_cast<float>(p.X()), static_cast<float>(p.Y()), static_cast<float>(p.Z())});
    }
    // A reversed face's triangles are wound the other way round.
    const bool reversed = face.Orientation() == TopAbs_REVERSED;
    for (int i = 1; i <= triangulation->NbTriangles(); ++i) {
      int a = 0, b = 0, c = 0;
      triangulation->Triangle(i).Get(a, b, c);
      if (reversed) std::swap(b, c);
      mesh->triangles.push_back({base + static_cast<uint32_t>(a - 1), base + static_cast<uint32_t>(b - 1),
                                 base + static_cast<uint32_t>(c - 1)});
    }
  }
  if (mesh->triangles.empty()) return nullptr;
  return mesh;
}
