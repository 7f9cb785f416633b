#include "QelVidStyleSheet.h"

#include <fstream>
#include <map>
#include <nlohmann/json.hpp>
#include <sstream>

#include "QelAssert.h"
#include "QelMsgCatalog.h"
#include "QelSYPEventHandler.h"
#include "QelSYPMetaClass.h"
#include "QelVidCtl.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlFrame.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidLabel.h"
#include "QelVidLayGrid.h"
#include "QelVidSpacer.h"

#ifndef QEL_RESOURCES_SOURCE_DIR
#define QEL_RESOURCES_SOURCE_DIR ""
#endif

using nlohmann::json;

struct QelVidStyleSheet::Document {
  json root;
};

namespace {
std::map<std::string, std::unique_ptr<QelVidStyleSheet>>& Cache() {
  static std::map<std::string, std::unique_ptr<QelVidStyleSheet>> cache;
  return cache;
}
std::vector<std::string>& Diagnostics() {
  static std::vector<std::string> diagnostics;
  return diagnostics;
}

struct StyleError {
  std::string place;
  std::string what;
};

// Line and column (1-based) of a byte offset, for a parse error a person can find.
std::string LineAndColumn(const std::string& text, size_t offset) {
  size_t line = 1, column = 1;
  for (size_t i = 0; i < offset && i < text.size(); ++i) {
    if (text[i] == '\n') {
      ++line;
      column = 1;
    } else {
      ++column;
    }
  }
  return "line " + std::to_string(line) + ", column " + std::to_string(column);
}

QelVar<QelVidWidget> MakePart(const std::string& kind, const QelString& name) {
  if (kind == "Frame") return QelMakeVar<QelVidCtlFrame>(nullptr, name);
  if (kind == "Label") return QelMakeVar<QelVidLabel>(nullptr, name);
  if (kind == "Grid") return QelMakeVar<QelVidLayGrid>(nullptr, name);
  if (kind == "Spacer") return QelMakeVar<QelVidSpacer>(nullptr, name);
  if (kind == "Expander") return QelMakeVar<QelVidCtlExpander>(nullptr, name);
  if (kind == "Button") return QelMakeVar<QelVidCtlButton>(nullptr, name);
  if (kind == "CheckButton") return QelMakeVar<QelVidCtlCheckButton>(nullptr, name);
  if (kind == "ScrollableArea") return QelMakeVar<QelVidCtlScrollableArea>(nullptr, name);
  if (kind == "Combo") return QelMakeVar<QelVidCtlImageAndLabelCombo>(nullptr, name);
  if (kind == "LineEditor") return QelMakeVar<QelVidCtlLineEditor>(nullptr, name);
  return nullptr;
}

QelSYPValue AttributeValue(const json& value, const std::string& place) {
  if (value.is_number_integer()) return value.get<int>();
  if (value.is_number_float()) return value.get<double>();
  if (value.is_boolean()) return value.get<bool>() ? 1 : 0;
  if (value.is_string()) return QelUnicodeString(value.get<std::string>());
  if (value.is_object()) {
    // A text a person reads comes from a catalog: {"catalog": "...", "key": "..."}.
    auto catalog = value.find("catalog");
    auto key = value.find("key");
    if (value.size() != 2 || catalog == value.end() || key == value.end() || !catalog->is_string() ||
        !key->is_string())
      throw StyleError{place, "a catalog text is {\"catalog\": text, \"key\": text}"};
    return QelMsgCatalog::BuildMessage(catalog->get<std::string>().c_str(), key->get<std::string>().c_str());
  }
  if (value.is_array() && (value.size() == 3 || value.size() == 4)) {
    int c[4] = {0, 0, 0, 255};
    for (size_t i = 0; i < value.size(); ++i) {
      if (!value[i].is_number_integer() || value[i].get<int>() < 0 || value[i].get<int>() > 255)
        throw StyleError{place + "/" + std::to_string(i), "a colour channel must be an integer 0..255"};
      c[i] = value[i].get<int>();
    }
    return QelVidColor(c[0], c[1], c[2], c[3]);
  }
  throw StyleError{place, "an attribute is a number, a text or a colour [r, g, b, a]"};
}

// Builds one template; parts, bindings and routes are only collected, so that a fault
// anywhere leaves the control untouched.
class TemplateBuilder {
 public:
  TemplateBuilder(QelVidCtl* control, const QelSYPMetaClass* meta) : control_(control), meta_(meta) {}

  QelVar<QelVidWidget> Build(const json& node, const std::string& place) {
    if (!node.is_object()) throw StyleError{place, "a part is an object"};
    for (const auto& [key, value] : node.items()) {
      static const char* known[] = {"kind", "name", "attributes", "bind", "on", "children", "cell", "header", "body"};
      if (std::find(std::begin(known), std::end(known), key) == std::end(known))
        throw StyleError{place + "/" + key, "unknown key"};
    }
    auto kindIt = node.find("kind");
    if (kindIt == node.end() || !kindIt->is_string()) throw StyleError{place + "/kind", "missing or not a text"};
    std::string name;
    if (auto it = node.find("name"); it != node.end()) {
      if (!it->is_string()) throw StyleError{place + "/name", "not a text"};
      name = it->get<std::string>();
    }
    QelVar<QelVidWidget> part = MakePart(kindIt->get<std::string>(), QelString(name));
    if (!part) throw StyleError{place + "/kind", "unknown kind \"" + kindIt->get<std::string>() + "\""};
    if (!name.empty()) {
      for (const auto& [known, _] : parts_)
        if (known == name) throw StyleError{place + "/name", "the part name \"" + name + "\" is used twice"};
      parts_.emplace_back(name, part);
    }
    if (auto it = node.find("attributes"); it != node.end()) {
      if (!it->is_object()) throw StyleError{place + "/attributes", "not an object"};
      for (const auto& [attribute, value] : it->items())
        part->SetAttribute(attribute, AttributeValue(value, place + "/attributes/" + attribute));
    }
    if (auto it = node.find("bind"); it != node.end()) BindAll(*it, part.get(), place + "/bind");
    if (auto it = node.find("on"); it != node.end()) RouteAll(*it, part.get(), place + "/on");
    BuildChildren(node, part.get(), place);
    return part;
  }

  void Apply() {
    for (const auto& [name, part] : parts_) control_->AddNamedPart(name, part.get());
    for (const auto& b : bindings_) control_->AddBinding(b.part.get(), b.attribute, b.property);
    for (const auto& r : routes_) {
      QelVar<QelSYPEventHandler> handler = QelVar<QelSYPEventHandler>::Adopt(meta_->CreateHandler(control_, r.handler));
      if (handler) r.part->AddHandler(r.event, handler.get(), 0);
    }
  }

 private:
  struct Route {
    QelVar<QelVidWidget> part;
    QelSYPEvent* event;
    std::string handler;
  };

  void NeedMeta(const std::string& place) const {
    if (!meta_)
      throw StyleError{place, std::string("the class ") + control_->IsA() + " has no introspection table"};
  }

  void BindAll(const json& bind, QelVidWidget* part, const std::string& place) {
    if (!bind.is_object()) throw StyleError{place, "not an object"};
    for (const auto& [attribute, property] : bind.items()) {
      const std::string at = place + "/" + attribute;
      if (!property.is_string()) throw StyleError{at, "a binding names a property"};
      NeedMeta(at);
      if (!meta_->FindProperty(property.get<std::string>()))
        throw StyleError{at, "the class " + meta_->GetClassName() + " has no property \"" +
                                 property.get<std::string>() + "\""};
      bindings_.push_back({QelVar<QelVidWidget>::Retain(part), attribute, property.get<std::string>()});
    }
  }

  void RouteAll(const json& on, QelVidWidget* part, const std::string& place) {
    if (!on.is_object()) throw StyleError{place, "not an object"};
    for (const auto& [eventName, handler] : on.items()) {
      const std::string at = place + "/" + eventName;
      if (!handler.is_string()) throw StyleError{at, "a route names a handler"};
      QelSYPEvent* event = part->FindEvent(eventName);
      if (!event)
        throw StyleError{at, std::string("a ") + part->GetWidgetKind() + " raises no event \"" + eventName + "\""};
      NeedMeta(at);
      if (!meta_->FindHandler(handler.get<std::string>()))
        throw StyleError{at, "the class " + meta_->GetClassName() + " has no handler \"" +
                                 handler.get<std::string>() + "\""};
      routes_.push_back({QelVar<QelVidWidget>::Retain(part), event, handler.get<std::string>()});
    }
  }

  void BuildChildren(const json& node, QelVidWidget* part, const std::string& place) {
    auto* expander = dynamic_cast<QelVidCtlExpander*>(part);
    for (const char* slot : {"header", "body"}) {
      auto it = node.find(slot);
      if (it == node.end()) continue;
      if (!expander) throw StyleError{place + "/" + slot, "only an Expander has a header and a body"};
      QelVar<QelVidWidget> child = Build(*it, place + "/" + slot);
      if (std::string(slot) == "header") expander->SetHeader(child.get());
      else expander->SetBody(child.get());
    }
    auto it = node.find("children");
    if (it == node.end()) return;
    if (!it->is_array()) throw StyleError{place + "/children", "not a list"};
    if (expander) throw StyleError{place + "/children", "an Expander has a header and a body, not children"};
    auto* grid = dynamic_cast<QelVidLayGrid*>(part);
    for (size_t i = 0; i < it->size(); ++i) {
      const std::string at = place + "/children/" + std::to_string(i);
      QelVar<QelVidWidget> child = Build((*it)[i], at);
      if (!grid) {
        if ((*it)[i].contains("cell")) throw StyleError{at + "/cell", "only a Grid's children have a cell"};
        part->AddChild(child.get());
        continue;
      }
      QelVidGridConstraints c;
      c.row = static_cast<int>(i);
      if (auto cell = (*it)[i].find("cell"); cell != (*it)[i].end()) c = Cell(*cell, at + "/cell");
      grid->AddWidget(child.get(), c);
    }
  }

  static QelVidGridConstraints Cell(const json& cell, const std::string& place) {
    if (!cell.is_array() || (cell.size() != 2 && cell.size() != 8))
      throw StyleError{place, "a cell is [column, row] or the eight grid constraints"};
    int v[8] = {0, 0, 1, 1, 1, 1, 1, 0};
    for (size_t i = 0; i < cell.size(); ++i) {
      if (!cell[i].is_number_integer() || cell[i].get<int>() < 0)
        throw StyleError{place + "/" + std::to_string(i), "not an integer of 0 or more"};
      v[i] = cell[i].get<int>();
    }
    return {v[0], v[1], v[2], v[3], v[4], v[5], v[6], v[7]};
  }

  QelVidCtl* control_;
  const QelSYPMetaClass* meta_;
  std::vector<std::pair<std::string, QelVar<QelVidWidget>>> parts_;
  struct Binding {
    QelVar<QelVidWidget> part;
    std::string attribute;
    std::string property;
  };
  std::vector<Binding> bindings_;
  std::vector<Route> routes_;
};
}  // namespace

QelVidStyleSheet::QelVidStyleSheet(std::string path, std::unique_ptr<Document> document)
    : path_(std::move(path)), document_(std::move(document)) {}
QelVidStyleSheet::~QelVidStyleSheet() = default;

std::string QelVidStyleSheet::StyleFolder() {
  std::string resources = QelGetEnv("QEL_RESOURCES_DIR");
  if (resources.empty()) resources = QEL_RESOURCES_SOURCE_DIR;
  return resources + "/styles";
}

const QelVidStyleSheet* QelVidStyleSheet::Load(const std::string& fileName, const std::string& forStyle) {
  const std::string path = StyleFolder() + "/" + fileName;
  const std::string asked = forStyle.empty() ? "" : " (style \"" + forStyle + "\" asked for)";
  if (auto it = Cache().find(path); it != Cache().end()) return it->second.get();
  if (fileName.empty() || fileName.find('/') != std::string::npos) {
    Report("style sheet \"" + fileName + "\": not a file name of the style folder" + asked);
    return nullptr;
  }
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    Report("style sheet " + path + ": cannot be read" + asked);
    return nullptr;
  }
  std::stringstream buffer;
  buffer << in.rdbuf();
  const std::string text = buffer.str();
  auto document = std::make_unique<Document>();
  try {
    document->root = json::parse(text, nullptr, true, true);
  } catch (const json::parse_error& e) {
    Report("style sheet " + path + ": malformed at " + LineAndColumn(text, e.byte > 0 ? e.byte - 1 : 0) + asked +
           ": " + e.what());
    return nullptr;
  }
  const json& root = document->root;
  if (!root.is_object() || !root.contains("styles") || !root["styles"].is_object()) {
    Report("style sheet " + path + ": at /styles: the sheet must be an object with an object \"styles\"" + asked);
    return nullptr;
  }
  auto* sheet = new QelVidStyleSheet(path, std::move(document));
  Cache()[path].reset(sheet);
  return sheet;
}

void QelVidStyleSheet::ClearCache() { Cache().clear(); }

bool QelVidStyleSheet::HasStyle(const std::string& style) const { return document_->root["styles"].contains(style); }

std::vector<std::string> QelVidStyleSheet::StyleNames() const {
  std::vector<std::string> names;
  for (const auto& [name, _] : document_->root["styles"].items()) names.push_back(name);
  return names;
}

HRESULT QelVidStyleSheet::Instantiate(QelVidCtl* control, const std::string& style) const {
  if (!control) return E_FAIL;
  const json& styles = document_->root["styles"];
  auto it = styles.find(style);
  if (it == styles.end()) {
    Report("style sheet " + path_ + ": style \"" + style + "\": no such style");
    return E_FAIL;
  }
  try {
    if (!it->is_object() || !it->contains("template"))
      throw StyleError{"/styles/" + style, "a style is an object with a \"template\""};
    TemplateBuilder builder(control, control->GetSYPMetaClass());
    QelVar<QelVidWidget> root = builder.Build((*it)["template"], "/styles/" + style + "/template");
    control->SetTemplateRoot(root.get());
    builder.Apply();
  } catch (const StyleError& e) {
    Report("style sheet " + path_ + ": style \"" + style + "\": at " + e.place + ": " + e.what);
    return E_FAIL;
  } catch (const json::exception& e) {
    Report("style sheet " + path_ + ": style \"" + style + "\": " + e.what());
    return E_FAIL;
  }
  return S_OK;
}

std::vector<std::string> QelVidStyleSheet::TakeDiagnostics() { return std::exchange(Diagnostics(), {}); }

void QelVidStyleSheet::Report(const std::string& text) {
  // Kept for whoever asks next; a process that never asks keeps only the latest ones.
  if (Diagnostics().size() >= 64) Diagnostics().erase(Diagnostics().begin());
  Diagnostics().push_back(text);
  QelSysLogError(("qel: " + text + "\n").c_str());
}
