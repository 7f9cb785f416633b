#include "QelStepImporter.h"

#include <cmath>
#include <filesystem>
#include <fstream>
#include <memory>
#include <new>
#include <csignal>
#include <cstring>
#include <sstream>
#include <unordered_map>
#include <unordered_set>

#include <BRepBndLib.hxx>
#include <Bnd_Box.hxx>
#include <Message.hxx>
#include <Message_Messenger.hxx>
#include <Message_ProgressIndicator.hxx>
#include <Message_ProgressScope.hxx>
#include <Interface_InterfaceModel.hxx>
#include <STEPCAFControl_Reader.hxx>
#include <Standard_Failure.hxx>
#include <TDF_LabelSequence.hxx>
#include <TDF_Tool.hxx>
#include <TDataStd_Name.hxx>
#include <TDocStd_Document.hxx>
#include <TransferBRep.hxx>
#include <Transfer_TransientProcess.hxx>
#include <XSControl_TransferReader.hxx>
#include <XSControl_WorkSession.hxx>
#include <XCAFApp_Application.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>

#include "QelModelBuilder.h"
#include "QelModelJsonWriter.h"
#include "QelModelLoader.h"
#include "QelStepChildProcess.h"
#include "QelStepDataScan.h"
#include "QelStepReadCheck.h"
#include "QelStepFileHeader.h"
#include "QelStepPmiReader.h"
#include "QelStepTessellator.h"

namespace {
// The loader's own bound on the depth of the product tree (docs/model-format.md).
constexpr int kMaxProductDepth = 200;

// Tells the caller's progress function the current stage and the overall position, once
// per whole percent so that a fine-grained translation does not flood a terminal.
class ProgressRelay : public Message_ProgressIndicator {
 public:
  explicit ProgressRelay(const QelStepImportOptions& options) : options_(options) {}
  void Enter(const char* stage) {
    stage_ = stage;
    Tell(GetPosition(), true);
  }
  void Show(const Message_ProgressScope&, const Standard_Boolean force) override { Tell(GetPosition(), force); }

 private:
  void Tell(double done, bool force) {
    const int percent = static_cast<int>(done * 100.0);
    if (!options_.progress || (!force && percent == lastPercent_)) return;
    lastPercent_ = percent;
    options_.progress(stage_, done);
  }
  const QelStepImportOptions& options_;
  const char* stage_ = "reading";
  int lastPercent_ = -1;
};

// The translation library prints its own reports on standard output; a person gets ours.
void SilenceTranslator() {
  static const bool silenced = [] {
    Message::DefaultMessenger()->ChangePrinters().Clear();
    return true;
  }();
  (void)silenced;
}

std::string Entry(const TDF_Label& label) {
  TCollection_AsciiString entry;
  TDF_Tool::Entry(label, entry);
  return entry.ToCString();
}

std::string NameOf(const TDF_Label& label) {
  Handle(TDataStd_Name) name;
  if (!label.FindAttribute(TDataStd_Name::GetID(), name)) return {};
  std::string text = TCollection_AsciiString(name->Get()).ToCString();
  // An instance without a name of its own gets a generated "=>[0:1:1:2]" from the translator.
  if (text.rfind("=>", 0) == 0) return {};
  return text;
}

QelMathTransformation Placement(const gp_Trsf& t) {
  auto column = [&](int c) { return QelMathVector{t.Value(1, c), t.Value(2, c), t.Value(3, c)}; };
  return {column(1), column(2), column(3), column(4)};
}

// The shape labels that stand for a PRODUCT of the file (its product definitions), and how
// many the file holds. The translator also makes an assembly of a product whose shape
// representation is related to several representations (a solid and a wire body): its
// components are no products, and the product's own shape may then have no label at all.
struct FileProducts {
  std::unordered_set<std::string> labels;
  int count = 0;
};

FileProducts ProductLabels(STEPCAFControl_Reader& reader, const Handle(XCAFDoc_ShapeTool)& shapes) {
  FileProducts out;
  const Handle(XSControl_WorkSession) session = reader.ChangeReader().WS();
  if (session.IsNull() || session->Model().IsNull() || session->TransferReader().IsNull()) return out;
  const Handle(Transfer_TransientProcess) process = session->TransferReader()->TransientProcess();
  const Handle(Interface_InterfaceModel) model = session->Model();
  if (process.IsNull()) return out;
  for (Standard_Integer i = 1; i <= model->NbEntities(); ++i) {
    const Handle(Standard_Transient) entity = model->Value(i);
    if (entity.IsNull() || !entity->IsKind("StepBasic_ProductDefinition")) continue;
    ++out.count;
    const TopoDS_Shape shape = TransferBRep::ShapeResult(process, entity);
    TDF_Label label;
    if (!shape.IsNull() && shapes->FindShape(shape, label)) out.labels.insert(Entry(label));
  }
  return out;
}

// Builds the product tree from the document's shape structure and collects, per part,
// the products that show its shape.
class ProductWalker {
 public:
  ProductWalker(QelModelBuilder& builder, FileProducts products) : builder_(builder), products_(std::move(products)) {}

  void Walk(const TDF_Label& prototype, const QelBaseUnknown_var& product, int depth) {
    const std::string entry = Entry(prototype);
    productOf.emplace(entry, product);
    if (!XCAFDoc_ShapeTool::IsAssembly(prototype) || OneProduct(prototype)) {
      Part& part = parts[entry];
      part.label = prototype;
      part.products.push_back(product);
      Gather(prototype, product, depth);
      return;
    }
    if (depth >= kMaxProductDepth) throw std::runtime_error("products nested more than 200 levels deep");
    TDF_LabelSequence components;
    XCAFDoc_ShapeTool::GetComponents(prototype, components);
    for (const TDF_Label& component : components) {
      TDF_Label referred;
      if (!XCAFDoc_ShapeTool::GetReferredShape(component, referred)) continue;
      std::string alias = NameOf(component);
      if (alias.empty()) alias = NameOf(referred);
      if (alias.empty()) alias = "Part." + std::to_string(++unnamed_);
      QelBaseUnknown_var child = builder_.AddProduct(
          product, {.alias = alias, .placement = Placement(XCAFDoc_ShapeTool::GetLocation(component).Transformation())});
      Walk(referred, child, depth + 1);
    }
  }

  struct Part {
    TDF_Label label;
    std::vector<QelBaseUnknown_var> products;
  };

  // An assembly none of whose components is a product of the file is the pieces of one
  // product's shape: that product shows them all and owns their annotations. A file of
  // one product is one product whatever labels its shape got.
  bool OneProduct(const TDF_Label& assembly) const {
    if (products_.labels.empty() && products_.count != 1) return false;
    TDF_LabelSequence components;
    XCAFDoc_ShapeTool::GetComponents(assembly, components);
    for (const TDF_Label& component : components) {
      TDF_Label referred;
      if (XCAFDoc_ShapeTool::GetReferredShape(component, referred) && products_.labels.count(Entry(referred))) return false;
    }
    return true;
  }

  void Gather(const TDF_Label& prototype, const QelBaseUnknown_var& product, int depth) {
    if (depth >= kMaxProductDepth) throw std::runtime_error("products nested more than 200 levels deep");
    TDF_LabelSequence components;
    XCAFDoc_ShapeTool::GetComponents(prototype, components);
    for (const TDF_Label& component : components) {
      TDF_Label referred;
      if (!XCAFDoc_ShapeTool::GetReferredShape(component, referred)) continue;
      if (productOf.emplace(Entry(referred), product).second) Gather(referred, product, depth + 1);
    }
  }
  std::unordered_map<std::string, QelBaseUnknown_var> productOf;
  std::unordered_map<std::string, Part> parts;

 private:
  QelModelBuilder& builder_;
  FileProducts products_;
  int unnamed_ = 0;
};

// The translator's one-time set-up (its protocol tables, the document application), done
// in the caller once, so that each child inherits it instead of doing it again. Nothing of
// a file is read here, and no worker thread is started: a forked child has none of the
// caller's threads.
void PrepareTranslator() {
  static const bool prepared = [] {
    SilenceTranslator();
    STEPCAFControl_Reader reader;
    Handle(XCAFApp_Application) application = XCAFApp_Application::GetApplication();
    Handle(TDocStd_Document) document;
    application->NewDocument("MDTV-XCAF", document);
    application->Close(document);
    return true;
  }();
  (void)prepared;
}

std::string ReadWhole(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  if (!in && !in.eof()) throw std::runtime_error("cannot read the file");
  return text.str();
}

// Reading the semantic annotations failed where the shapes and views may still be read.
struct AnnotationFailure : std::runtime_error {
  using std::runtime_error::runtime_error;
};

std::string FailureText(const Standard_Failure& failure) {
  const char* text = failure.GetMessageString();
  return text && *text ? std::string(text) : std::string(failure.DynamicType()->Name());
}

// What the child hands back: "N <note>" lines, then "M" and the model file, or "E <error>".
std::string OneLine(std::string text) {
  for (char& c : text)
    if (c == '\n' || c == '\r') c = ' ';
  return text;
}

// The limits of one translation: generous for what real files of that size need, and
// small enough that a file made to exhaust the machine is stopped.
QelStepChildProcess::Limits LimitsFor(size_t bytes) {
  const double megabytes = static_cast<double>(bytes) / (1 << 20);
  QelStepChildProcess::Limits limits;
  limits.cpuSeconds = 60.0 + 4.0 * megabytes;
  limits.wallSeconds = 2.0 * limits.cpuSeconds + 30.0;
  limits.memoryBytes = (size_t(4) << 30) + 64 * bytes;
  return limits;
}

// Closes the translated document whatever way the import ends.
struct DocumentCloser {
  Handle(XCAFApp_Application) application;
  Handle(TDocStd_Document) document;
  ~DocumentCloser() {
    if (!document.IsNull() && document->IsOpened()) application->Close(document);
  }
};
}  // namespace

bool QelStepImporter::IsStepFile(const std::string& path) {
  QelStepFileHeader header;
  std::string error;
  return QelStepFileHeader::Read(path, header, error) && header.isStep;
}

namespace {
// One translation of a scanned file into a model, in the process that calls it. Null with
// `error` for a refused file; throws AnnotationFailure when `readAnnotations` and reading
// them failed, so that the caller can open the file without them.
QelBaseUnknown_var Translate(const std::string& path, const std::string& text, const QelStepDataScan& scan,
                             bool annotated, bool readAnnotations, const QelStepImportOptions& options,
                             std::vector<std::string>& notes, std::string& error) {
  SilenceTranslator();
  Handle(ProgressRelay) progress = new ProgressRelay(options);
  Message_ProgressScope whole(progress->Start(), "import", 100);
  progress->Enter("reading");

  DocumentCloser closer{XCAFApp_Application::GetApplication(), {}};
  closer.application->NewDocument("MDTV-XCAF", closer.document);
  STEPCAFControl_Reader reader;
  reader.SetNameMode(true);
  reader.SetColorMode(false);
  reader.SetLayerMode(false);
  reader.SetPropsMode(false);
  reader.SetGDTMode(annotated && readAnnotations);
  reader.SetViewMode(annotated);
  const IFSelect_ReturnStatus read = reader.ReadFile(path.c_str());
  whole.Next(50);
  if (read != IFSelect_RetDone) {
    error = path + ": the STEP file could not be read (its data section is not valid STEP)";
    return nullptr;
  }
  if (reader.ChangeReader().NbRootsForTransfer() == 0) {
    error = path + ": the STEP file holds no product";
    return nullptr;
  }
  progress->Enter("translating");
  bool transferred = false;
  try {
    transferred = reader.Transfer(closer.document, whole.Next(30));
  } catch (const Standard_Failure& failure) {
    if (annotated && readAnnotations) throw AnnotationFailure(FailureText(failure));
    throw;
  }
  if (!transferred) {
    error = path + ": the STEP file could not be translated into shapes";
    return nullptr;
  }
  // A part of a shape or a product that failed is not shown as if the file had none.
  const std::vector<std::string> failures = QelStepReadCheck::TransferFailures(reader, text);
  if (!failures.empty()) {
    error = path + ": the model would be incomplete: " + failures.front();
    if (failures.size() > 1) error += " (and " + std::to_string(failures.size() - 1) + " more)";
    return nullptr;
  }
  Handle(XCAFDoc_ShapeTool) shapes = XCAFDoc_DocumentTool::ShapeTool(closer.document->Main());
  TDF_LabelSequence free;
  shapes->GetFreeShapes(free);
  if (free.IsEmpty()) {
    error = path + ": the STEP file holds no product";
    return nullptr;
  }

  // One top product is the root; several are gathered under a root named after the file.
  std::string rootAlias = free.Length() == 1 ? NameOf(free.First()) : std::string();
  if (rootAlias.empty()) rootAlias = std::filesystem::path(path).stem().string();
  QelModelBuilder builder({.alias = rootAlias});
  builder.SetSourceName(path);
  // The translator gives lengths in millimetres whatever the file's unit.
  builder.SetLengthUnit("mm");
  ProductWalker walker(builder, ProductLabels(reader, shapes));
  if (free.Length() == 1) {
    walker.Walk(free.First(), builder.Root(), 0);
  } else {
    for (const TDF_Label& top : free) {
      std::string alias = NameOf(top);
      if (alias.empty()) alias = "Part." + Entry(top);
      walker.Walk(top, builder.AddProduct(builder.Root(), {.alias = alias}), 1);
    }
  }

  progress->Enter("tessellating");
  Bnd_Box scene;
  {
    Message_ProgressScope meshing(whole.Next(17), "tessellating", static_cast<double>(walker.parts.size()));
    for (auto& [entry, part] : walker.parts) {
      const TopoDS_Shape shape = XCAFDoc_ShapeTool::GetShape(part.label);
      BRepBndLib::Add(shape, scene, false);
      std::shared_ptr<const QelMeshShape> mesh = QelStepTessellator::Mesh(shape, meshing.Next());
      if (!mesh) continue;
      for (const QelBaseUnknown_var& product : part.products) builder.SetShape(product, mesh);
    }
  }

  progress->Enter("annotations");
  std::multiset<std::string> viewsRead;
  if (annotated) {
    QelStepPmiReader pmi(closer.document, builder, walker.productOf, text);
    QelMathPoint centre{};
    double size = 0.0;
    if (!scene.IsVoid()) {
      double x0, y0, z0, x1, y1, z1;
      scene.Get(x0, y0, z0, x1, y1, z1);
      centre = {(x0 + x1) / 2, (y0 + y1) / 2, (z0 + z1) / 2};
      size = std::sqrt(scene.SquareExtent());
    }
    std::vector<std::string> left;
    try {
      pmi.Read(centre, size, left);
    } catch (const Standard_Failure& failure) {
      if (readAnnotations) throw AnnotationFailure(FailureText(failure));
      throw;
    }
    viewsRead = pmi.ViewNames();
    for (const std::string& line : left) notes.push_back(path + ": " + line);
    if (readAnnotations && pmi.AnnotationCount() == 0) notes.push_back(path + ": the file holds no semantic annotation");
  }
  std::vector<QelModelNotRead> missing =
      QelStepReadCheck::Missing(scan, closer.document, annotated && readAnnotations, viewsRead);
  for (const QelModelNotRead& m : missing)
    notes.push_back(path + ": not read: " + std::to_string(m.count) + " " + m.kind);
  builder.SetNotRead(std::move(missing));
  whole.Next(3);
  progress->Enter("done");
  return builder.Finish();
}

// The child's side: the whole translation, its answer as text (see OneLine).
std::string TranslateToText(const std::string& path, const std::string& text, const QelStepDataScan& scan,
                            bool annotated, const QelStepImportOptions& options) {
  std::vector<std::string> notes;
  std::string error;
  QelBaseUnknown_var root;
  try {
    try {
      root = Translate(path, text, scan, annotated, true, options, notes, error);
    } catch (const AnnotationFailure& failure) {
      notes.clear();
      error.clear();
      notes.push_back(path + ": the semantic annotations could not be read (" + failure.what() +
                      "): opened the shapes and saved views without them");
      root = Translate(path, text, scan, annotated, false, options, notes, error);
    }
  } catch (const Standard_Failure& failure) {
    error = path + ": the STEP file could not be translated: " + FailureText(failure);
  } catch (const std::bad_alloc&) {
    error = path + ": not enough memory to import the file";
  } catch (const std::exception& e) {
    error = path + ": " + e.what();
  }
  if (!root) return "E " + OneLine(error.empty() ? path + ": the STEP file could not be translated" : error);
  std::string answer;
  for (const std::string& note : notes) answer += "N " + OneLine(note) + "\n";
  std::ostringstream model;
  if (!QelModelJsonWriter::Write(root.get(), model, false)) return "E " + path + ": the imported model could not be written";
  answer += "M\n";
  answer += model.str();
  return answer;
}

std::string SignalName(int signal) {
  const char* name = sigabbrev_np(signal);
  return name ? std::string("SIG") + name : "signal " + std::to_string(signal);
}
}  // namespace

HRESULT QelStepImporter::ImportFile(const std::string& path, QelBaseUnknown_var& root, std::string& error,
                                    std::vector<std::string>& notes, const QelStepImportOptions& options) {
  root = nullptr;
  error.clear();
  notes.clear();
  try {
    QelStepFileHeader header;
    if (!QelStepFileHeader::Read(path, header, error)) return E_FAIL;
    if (!header.isStep) {
      error = path + ": not a STEP file (it does not begin with ISO-10303-21;)";
      return E_FAIL;
    }
    if (!header.complete) {
      error = path + ": the STEP file is cut short (it does not end with END-ISO-10303-21;)";
      return E_FAIL;
    }
    const bool annotated = header.IsAP242();
    if (!annotated) {
      const std::string schema = header.schemas.empty() ? std::string("none") : header.schemas.front();
      notes.push_back(path + ": schema " + schema +
                      " is not AP242 and carries no semantic annotations: opened without annotations");
    }
    const std::string text = ReadWhole(path);
    QelStepDataScan scan;
    std::string scanError;
    if (!QelStepDataScan::Scan(text, scan, scanError)) {
      error = path + ": " + scanError;
      notes.clear();
      return E_FAIL;
    }

    // The translator is not safe against damaged data: it runs in a child process, so that
    // a crash or a runaway file costs the import, never the program.
    PrepareTranslator();
    const QelStepChildProcess::Limits limits = LimitsFor(text.size());
    const QelStepChildProcess::Outcome outcome = QelStepChildProcess::Run(
        [&] { return TranslateToText(path, text, scan, annotated, options); }, limits);
    if (!outcome.failure.empty()) {
      error = path + ": the STEP file could not be translated: " + outcome.failure;
    } else if (outcome.outOfTime) {
      error = path + ": the STEP file could not be translated within " +
              std::to_string(static_cast<int>(limits.cpuSeconds)) + " s of processor time";
    } else if (outcome.signal != 0) {
      error = path + ": the STEP file could not be translated: the translator crashed on its data (" +
              SignalName(outcome.signal) + "); the file is damaged";
    } else if (!outcome.finished) {
      error = path + ": the STEP file could not be translated: the translator stopped without an answer";
    } else if (outcome.bytes.rfind("E ", 0) == 0) {
      error = outcome.bytes.substr(2);
    } else {
      size_t at = 0;
      while (outcome.bytes.compare(at, 2, "N ") == 0) {
        const size_t end = outcome.bytes.find('\n', at);
        if (end == std::string::npos) break;
        notes.push_back(outcome.bytes.substr(at + 2, end - at - 2));
        at = end + 1;
      }
      if (outcome.bytes.compare(at, 2, "M\n") != 0) {
        error = path + ": the STEP file could not be translated: the translator's answer was cut";
      } else if (QelModelLoader::LoadText(outcome.bytes.substr(at + 2), path, root, error) == S_OK) {
        return S_OK;
      }
    }
  } catch (const std::bad_alloc&) {
    error = path + ": not enough memory to import the file";
  } catch (const std::exception& e) {
    error = path + ": " + e.what();
  }
  root = nullptr;
  notes.clear();
  return E_FAIL;
}
