// Importing each NIST annotation test model, against a bare OpenCASCADE read, transfer and
// mesh of the same file with the same reader modes and tessellation tolerance: the cost of
// what the importer adds (its scan, the child process, the annotations, the model and its
// trip through the JSON model format). Processor time counts the child's too; each round
// runs both, so a change of the machine's load falls on both alike. The bare translation
// runs in a forked child too, so that this process stays as small as qelhost's (which
// never translates in its own memory): the translator's heap left here would make every
// later child of ours pay for copying its pages, which qelhost's children do not. The counters ours_ms,
// bare_ms and ratio (ours / bare, at most 1.15 is the target) are per import.
#include <benchmark/benchmark.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include <BRepBndLib.hxx>
#include <BRepMesh_IncrementalMesh.hxx>
#include <Bnd_Box.hxx>
#include <Message.hxx>
#include <Message_Messenger.hxx>
#include <STEPCAFControl_Reader.hxx>
#include <TDF_LabelSequence.hxx>
#include <TDocStd_Document.hxx>
#include <XCAFApp_Application.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>

#include "QelStepImporter.h"

namespace {
// Processor time of this process and of its waited-for children, in seconds.
double CpuSeconds() {
  double total = 0.0;
  for (int who : {RUSAGE_SELF, RUSAGE_CHILDREN}) {
    rusage usage{};
    getrusage(who, &usage);
    total += static_cast<double>(usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) +
             static_cast<double>(usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) * 1e-6;
  }
  return total;
}

bool Ours(const std::string& path, std::string& error) {
  QelBaseUnknown_var root;
  std::vector<std::string> notes;
  return QelStepImporter::ImportFile(path, root, error, notes) == S_OK;
}

// The translator alone, as the importer sets it up, and each part meshed as the importer
// meshes it.
bool Bare(const std::string& path) {
  Message::DefaultMessenger()->ChangePrinters().Clear();
  Handle(XCAFApp_Application) application = XCAFApp_Application::GetApplication();
  Handle(TDocStd_Document) document;
  application->NewDocument("MDTV-XCAF", document);
  STEPCAFControl_Reader reader;
  reader.SetNameMode(true);
  reader.SetColorMode(false);
  reader.SetLayerMode(false);
  reader.SetPropsMode(false);
  reader.SetGDTMode(true);
  reader.SetViewMode(true);
  const bool ok = reader.ReadFile(path.c_str()) == IFSelect_RetDone && reader.Transfer(document);
  if (ok) {
    TDF_LabelSequence shapes;
    XCAFDoc_DocumentTool::ShapeTool(document->Main())->GetShapes(shapes);
    for (const TDF_Label& label : shapes) {
      if (XCAFDoc_ShapeTool::IsAssembly(label)) continue;
      const TopoDS_Shape shape = XCAFDoc_ShapeTool::GetShape(label);
      Bnd_Box box;
      BRepBndLib::Add(shape, box, false);
      IMeshTools_Parameters parameters;
      parameters.Deflection = box.IsVoid() ? QelStepImporter::kMaxDeflection
                                           : std::clamp(std::sqrt(box.SquareExtent()) * QelStepImporter::kRelativeDeflection,
                                                        QelStepImporter::kMinDeflection, QelStepImporter::kMaxDeflection);
      parameters.Angle = QelStepImporter::kAngularDeflection;
      parameters.InParallel = true;
      BRepMesh_IncrementalMesh mesher(shape, parameters);
    }
  }
  application->Close(document);
  return ok;
}

void Import(benchmark::State& state, const std::string& path) {
  double ours = 0.0, bare = 0.0;
  size_t rounds = 0;
  for (auto _ : state) {
    std::string error;
    double start = CpuSeconds();
    if (!Ours(path, error)) {
      state.SkipWithError(error.c_str());
      return;
    }
    ours += CpuSeconds() - start;
    start = CpuSeconds();
    const pid_t child = fork();
    if (child == 0) _exit(Bare(path) ? 0 : 1);
    int status = 1;
    waitpid(child, &status, 0);
    if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) {
      state.SkipWithError("the bare translation failed");
      return;
    }
    bare += CpuSeconds() - start;
    ++rounds;
  }
  state.counters["ours_ms"] = 1000.0 * ours / static_cast<double>(rounds);
  state.counters["bare_ms"] = 1000.0 * bare / static_cast<double>(rounds);
  state.counters["ratio"] = bare > 0.0 ? ours / bare : 0.0;
}
}  // namespace

BENCHMARK_CAPTURE(Import, CTC01, std::string(QEL_NIST_MODELS) + "/nist_ctc_01_asme1_ap242-e1.stp")
    ->Unit(benchmark::kMillisecond)->Iterations(5);
BENCHMARK_CAPTURE(Import, FTC06, std::string(QEL_NIST_MODELS) + "/nist_ftc_06_asme1_ap242-e2.stp")
    ->Unit(benchmark::kMillisecond)->Iterations(5);
BENCHMARK_CAPTURE(Import, STC06, std::string(QEL_NIST_MODELS) + "/nist_stc_06_asme1_ap242-e3.stp")
    ->Unit(benchmark::kMillisecond)->Iterations(5);
BENCHMARK_MAIN();
