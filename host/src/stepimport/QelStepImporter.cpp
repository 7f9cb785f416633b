#include "QelStepImporter.h"

#include <cmath>
#include <filesystem>
#include <fstream>
#include <memory>
#include <new>
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

std::string ReadWhole(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
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
    reader.SetGDTMode(annotated);
    reader.SetViewMode(annotated);
    const IFSelect_ReturnStatus read = reader.ReadFile(path.c_str());
    whole.Next(50);
    if (read != IFSelect_RetDone) {
      error = path + ": the STEP file could not be read (its data section is not valid STEP)";
      return E_FAIL;
    }
    if (reader.ChangeReader().NbRootsForTransfer() == 0) {
      error = path + ": the STEP file holds no product";
      return E_FAIL;
    }
    progress->Enter("translating");
    if (!reader.Transfer(closer.document, whole.Next(30))) {
      error = path + ": the STEP file could not be translated into shapes";
      return E_FAIL;
    }
    Handle(XCAFDoc_ShapeTool) shapes = XCAFDoc_DocumentTool::ShapeTool(closer.document->Main());
    TDF_LabelSequence free;
    shapes->GetFreeShapes(free);
    if (free.IsEmpty()) {
      error = path + ": the STEP file holds no product";
      return E_FAIL;
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
    if (annotated) {
      const std::string text = ReadWhole(path);
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
      pmi.Read(centre, size, left);
      for (const std::string& line : left) notes.push_back(path + ": " + line);
      if (pmi.AnnotationCount() == 0) notes.push_back(path + ": the file holds no semantic annotation");
    }
    whole.Next(3);
    progress->Enter("done");
    root = builder.Finish();
    return S_OK;
  } catch (const Standard_Failure& failure) {
    error = path + ": the STEP file could not be translated: " + failure.GetMessageString();
  } catch (const std::bad_alloc&) {
    error = path + ": not enough memory to import the file";
  } catch (const std::exception& e) {
    error = path + ": " + e.what();
  }
  root = nullptr;
  notes.clear();
  return E_FAIL;
}
