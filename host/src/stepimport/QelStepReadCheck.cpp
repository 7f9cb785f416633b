#include "QelStepReadCheck.h"

#include <algorithm>
#include <cctype>
#include <map>
#include <set>
#include <unordered_map>

#include <Interface_Check.hxx>
#include <Interface_CheckIterator.hxx>
#include <StepData_StepModel.hxx>
#include <TCollection_HAsciiString.hxx>
#include <TDF_LabelSequence.hxx>
#include <Transfer_TransientProcess.hxx>
#include <XCAFDimTolObjects_DatumObject.hxx>
#include <XCAFDimTolObjects_DimensionObject.hxx>
#include <XCAFDimTolObjects_GeomToleranceObject.hxx>
#include <XCAFDoc_Datum.hxx>
#include <XCAFDoc_DimTolTool.hxx>
#include <XCAFDoc_Dimension.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_GeomTolerance.hxx>
#include <XSControl_TransferReader.hxx>
#include <XSControl_WorkSession.hxx>

namespace {
using Kind = QelStepDataScan::Kind;

std::string Text(const Handle(TCollection_HAsciiString)& text) { return text.IsNull() ? std::string() : text->ToCString(); }

// The names the document holds of one kind, each as often as it holds it.
struct ReadNames {
  std::multiset<std::string> datums, tolerances, dimensions;
};

ReadNames NamesIn(const Handle(TDocStd_Document)& document) {
  ReadNames names;
  Handle(XCAFDoc_DimTolTool) tool = XCAFDoc_DocumentTool::DimTolTool(document->Main());
  TDF_LabelSequence labels;
  tool->GetDatumLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_Datum) datum;
    if (label.FindAttribute(XCAFDoc_Datum::GetID(), datum) && !datum->GetObject().IsNull())
      names.datums.insert(Text(datum->GetObject()->GetName()));
  }
  labels.Clear();
  tool->GetGeomToleranceLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_GeomTolerance) tolerance;
    if (label.FindAttribute(XCAFDoc_GeomTolerance::GetID(), tolerance) && !tolerance->GetObject().IsNull())
      names.tolerances.insert(Text(tolerance->GetObject()->GetSemanticName()));
  }
  labels.Clear();
  tool->GetDimensionLabels(labels);
  for (const TDF_Label& label : labels) {
    Handle(XCAFDoc_Dimension) dimension;
    if (!label.FindAttribute(XCAFDoc_Dimension::GetID(), dimension) || dimension->GetObject().IsNull()) continue;
    const XCAFDimTolObjects_DimensionType type = dimension->GetObject()->GetType();
    // Labels and bare presentations come from other entities than the file's dimensions.
    if (type == XCAFDimTolObjects_DimensionType_CommonLabel ||
        type == XCAFDimTolObjects_DimensionType_DimensionPresentation)
      continue;
    names.dimensions.insert(Text(dimension->GetObject()->GetSemanticName()));
  }
  return names;
}

// The declared entities of a kind that the read names do not account for: as many as the
// file declares beyond what was read, those whose name was not read named first.
void Compare(const std::vector<const QelStepDataScan::Declared*>& declared, std::multiset<std::string> read,
             bool byLastText, const std::string& kind, std::vector<QelModelNotRead>& out) {
  if (declared.size() <= read.size()) return;
  QelModelNotRead missing{.kind = kind, .count = declared.size() - read.size()};
  for (const QelStepDataScan::Declared* d : declared) {
    auto it = read.find(byLastText ? d->lastText : d->name);
    if (it != read.end()) {
      read.erase(it);
    } else if (missing.entities.size() < std::min(missing.count, QelStepReadCheck::kMaxNamed)) {
      missing.entities.push_back("#" + std::to_string(d->id));
    }
  }
  out.push_back(std::move(missing));
}
}  // namespace

std::string QelStepReadCheck::TypeOf(std::string_view text, uint64_t id) {
  const std::string name = "#" + std::to_string(id);
  for (size_t at = text.find(name); at != std::string_view::npos; at = text.find(name, at + 1)) {
    // An instance's own name stands first in its statement and is followed by '='.
    if (at > 0 && !std::isspace(static_cast<unsigned char>(text[at - 1])) && text[at - 1] != ';') continue;
    size_t i = at + name.size();
    while (i < text.size() && std::isspace(static_cast<unsigned char>(text[i]))) ++i;
    if (i >= text.size() || text[i] != '=') continue;
    for (++i; i < text.size() && (std::isspace(static_cast<unsigned char>(text[i])) || text[i] == '('); ++i) {
    }
    size_t end = i;
    while (end < text.size() && (std::isalnum(static_cast<unsigned char>(text[end])) || text[end] == '_')) ++end;
    return std::string(text.substr(i, end - i));
  }
  return {};
}

std::vector<std::string> QelStepReadCheck::TransferFailures(STEPCAFControl_Reader& reader, std::string_view text) {
  std::vector<std::string> failures;
  Handle(XSControl_WorkSession) session = reader.ChangeReader().WS();
  if (session.IsNull() || session->TransferReader().IsNull()) return failures;
  Handle(Transfer_TransientProcess) process = session->TransferReader()->TransientProcess();
  Handle(StepData_StepModel) model = Handle(StepData_StepModel)::DownCast(session->Model());
  if (process.IsNull() || model.IsNull()) return failures;
  const Interface_CheckIterator checks = process->CheckList(Standard_False);
  for (checks.Start(); checks.More() && failures.size() < kMaxNamed; checks.Next()) {
    const Handle(Interface_Check)& check = checks.Value();
    if (check.IsNull()) continue;
    const char* reason = check->HasFailed() ? check->CFail(1) : nullptr;
    // A few warnings mean a part was dropped (a face of a damaged type leaves its shell
    // with "not mapped to TopoDS"); the others ("Missing seam-edge added") are repairs.
    for (int i = 1; !reason && i <= check->NbWarnings(); ++i) {
      const std::string warning = check->CWarning(i);
      if (warning.find("not mapped") != std::string::npos || warning.find("not translated") != std::string::npos)
        reason = check->CWarning(i);
    }
    if (!reason) continue;
    std::string where = "an entity";
    if (checks.Number() > 0 && checks.Number() <= model->NbEntities()) {
      const int id = model->IdentLabel(model->Value(checks.Number()));
      where = "#" + std::to_string(id);
      const std::string type = TypeOf(text, static_cast<uint64_t>(id));
      if (!type.empty()) where += " (" + type + ")";
    }
    std::string text = reason;
    while (!text.empty() && std::isspace(static_cast<unsigned char>(text.front()))) text.erase(0, 1);
    while (!text.empty() && std::isspace(static_cast<unsigned char>(text.back()))) text.pop_back();
    failures.push_back(where + ": " + text);
  }
  return failures;
}

std::vector<QelModelNotRead> QelStepReadCheck::Missing(const QelStepDataScan& scan,
                                                       const Handle(TDocStd_Document)& document, bool annotationsRead,
                                                       const std::multiset<std::string>& views) {
  std::map<Kind, std::vector<const QelStepDataScan::Declared*>> byKind;
  std::map<std::string, std::vector<const QelStepDataScan::Declared*>> tessellated;
  for (const QelStepDataScan::Declared& d : scan.Entities()) {
    if (d.kind == Kind::Tessellated) {
      tessellated[d.type].push_back(&d);
    } else {
      byKind[d.kind].push_back(&d);
    }
  }
  const ReadNames read = annotationsRead ? NamesIn(document) : ReadNames{};
  std::vector<QelModelNotRead> out;
  // The translator repeats a datum for every tolerance that cites it: one per letter.
  const std::set<std::string> letters(read.datums.begin(), read.datums.end());
  Compare(byKind[Kind::Datum], {letters.begin(), letters.end()}, true, "datums", out);
  Compare(byKind[Kind::Tolerance], read.tolerances, false, "geometric tolerances", out);
  Compare(byKind[Kind::Dimension], read.dimensions, false, "dimensions", out);
  Compare(byKind[Kind::SavedView], views, false, "saved views", out);
  // This translator reads no tessellated shape of a part at all.
  for (const auto& [type, entities] : tessellated) {
    std::multiset<std::string> none;
    Compare(entities, none, false, "tessellated shapes (" + type + ")", out);
  }
  return out;
}
