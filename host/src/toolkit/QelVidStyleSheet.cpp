#include "QelVidStyleSheet.h"

#include <cstdlib>
#include <fstream>
#include <map>
#include <optional>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string_view>

#include "QelAssert.h"
#include "QelMsgCatalog.h"
#include "QelSYPEventArgs.h"
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

namespace {
constexpr const char* kResourcesVariable = "QEL_RESOURCES_DIR";
}

// A style's template checked against one control class and kept, so that building the
// thousandth row costs only its widgets: kinds, names, attribute values, resolved
// properties and handlers, cells.
struct QelVidCompiledPart {
  using Maker = QelVar<QelVidWidget> (*)(const QelString& name);
  std::string kind;
  Maker make = nullptr;  // resolved from the kind once
  QelString name;
  std::vector<QelVidAttribute> attributes;
  struct Binding {
    const std::string* attribute;  // from QelVidAttributeName
    const QelSYPMetaClass::Property* property;
  };
  std::vector<Binding> bindings;
  struct Route {
    QelSYPEvent* event;
    std::string handler;
  };
  std::vector<Route> routes;
  std::vector<QelVidCompiledPart> children;
  bool grid = false;  // a Grid places its children by `cells`
  std::vector<std::optional<QelVidGridConstraints>> cells;  // for a Grid's children
  std::unique_ptr<QelVidCompiledPart> header;
  std::unique_ptr<QelVidCompiledPart> body;
  size_t number = 0;  // in the order parts are made: the part, its header, body, children
  // Kept on the root only: what every control of the style shares.
  struct NumberedRoute {
    size_t part;
    const Route* route;
  };
  std::vector<NumberedRoute> allRoutes;
  std::shared_ptr<QelVidCtl::TemplateIndex> index;
  // The router every control of the style shares, while one lives (controls hold it).
  mutable QelBaseUnknown_WR router;
};

// Orders (style, class) keys and lets a look-up use the style name as it comes, without
// a key string of its own.
struct QelVidCompiledKeyLess {
  using is_transparent = void;
  template <class A, class B>
  bool operator()(const A& a, const B& b) const {
    const int order = std::string_view(a.first).compare(std::string_view(b.first));
    return order < 0 || (order == 0 && std::less<>()(a.second, b.second));
  }
};

struct QelVidStyleSheet::Document {
  json root;
  // Per style and control class; only templates that passed every check are kept.
  std::map<std::pair<std::string, const QelSYPMetaClass*>, std::shared_ptr<const QelVidCompiledPart>,
           QelVidCompiledKeyLess>
      compiled;
};

namespace {
std::map<std::string, std::unique_ptr<QelVidStyleSheet>>& Cache() {
  // Never destroyed: a module's unloader still clears it during exit.
  static auto* cache = new std::map<std::string, std::unique_ptr<QelVidStyleSheet>>();
  return *cache;
}
// The sheets last handed out, by the resource folder setting and file name they were
// asked under: a control styled per row finds its sheet without building its path.
struct RecentSheet {
  std::string resourcesSetting;
  std::string fileName;
  const QelVidStyleSheet* sheet;
};
std::vector<RecentSheet>& Recent() {
  static auto* recent = new std::vector<RecentSheet>();
  return *recent;
}
std::vector<std::string>& Diagnostics() {
  static auto* diagnostics = new std::vector<std::string>();
  return *diagnostics;
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

// The new part's reference, taken over as a widget handle: the upcast is static, where a
// handle conversion would cast dynamically.
template <class Kind>
QelVar<QelVidWidget> NewPart(const QelString& name) {
  return QelVar<QelVidWidget>::Adopt(QelMakeVar<Kind>(nullptr, name).Detach());
}

QelVidCompiledPart::Maker MakerOf(const std::string& kind) {
  if (kind == "Frame") return &NewPart<QelVidCtlFrame>;
  if (kind == "Label") return &NewPart<QelVidLabel>;
  if (kind == "Grid") return &NewPart<QelVidLayGrid>;
  if (kind == "Spacer") return &NewPart<QelVidSpacer>;
  if (kind == "Expander") return &NewPart<QelVidCtlExpander>;
  if (kind == "Button") return &NewPart<QelVidCtlButton>;
  if (kind == "CheckButton") return &NewPart<QelVidCtlCheckButton>;
  if (kind == "ScrollableArea") return &NewPart<QelVidCtlScrollableArea>;
  if (kind == "Combo") return &NewPart<QelVidCtlImageAndLabelCombo>;
  if (kind == "LineEditor") return &NewPart<QelVidCtlLineEditor>;
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

// Checks a template and compiles it; every fault throws with its place.
class TemplateCompiler {
 public:
  TemplateCompiler(const std::string& className, const QelSYPMetaClass* meta) : className_(className), meta_(meta) {}

  // The template's root, with the totals of the whole tree.
  std::shared_ptr<QelVidCompiledPart> CompileTemplate(const json& node, const std::string& style,
                                                      const std::string& place) {
    auto root = std::make_shared<QelVidCompiledPart>(Compile(node, place));
    root->index = std::make_shared<QelVidCtl::TemplateIndex>();
    root->index->style = QelString(style);
    Number(*root, *root);
    return root;
  }

  QelVidCompiledPart Compile(const json& node, const std::string& place) {
    if (!node.is_object()) throw StyleError{place, "a part is an object"};
    for (const auto& [key, value] : node.items()) {
      static const char* known[] = {"kind", "name", "attributes", "bind", "on", "children", "cell", "header", "body"};
      if (std::find(std::begin(known), std::end(known), key) == std::end(known))
        throw StyleError{place + "/" + key, "unknown key"};
    }
    QelVidCompiledPart part;
    auto kindIt = node.find("kind");
    if (kindIt == node.end() || !kindIt->is_string()) throw StyleError{place + "/kind", "missing or not a text"};
    part.kind = kindIt->get<std::string>();
    std::string name;
    if (auto it = node.find("name"); it != node.end()) {
      if (!it->is_string()) throw StyleError{place + "/name", "not a text"};
      name = it->get<std::string>();
    }
    part.name = QelString(name);
    // A sample of the kind answers which events it raises.
    part.make = MakerOf(part.kind);
    QelVar<QelVidWidget> sample = part.make ? part.make(part.name) : nullptr;
    if (!sample) throw StyleError{place + "/kind", "unknown kind \"" + part.kind + "\""};
    if (!name.empty()) {
      if (std::find(names_.begin(), names_.end(), name) != names_.end())
        throw StyleError{place + "/name", "the part name \"" + name + "\" is used twice"};
      names_.push_back(name);
    }
    if (auto it = node.find("attributes"); it != node.end()) {
      if (!it->is_object()) throw StyleError{place + "/attributes", "not an object"};
      for (const auto& [attribute, value] : it->items())
        part.attributes.push_back(
            {QelVidAttributeName(attribute), AttributeValue(value, place + "/attributes/" + attribute)});
    }
    if (auto it = node.find("bind"); it != node.end()) BindAll(*it, part, place + "/bind");
    if (auto it = node.find("on"); it != node.end()) RouteAll(*it, sample.get(), part, place + "/on");
    CompileChildren(node, part, place);
    return part;
  }

 private:
  // Numbers the parts in the order BuildParts makes them, and lists names, bindings and
  // routes by those numbers.
  static void Number(QelVidCompiledPart& part, QelVidCompiledPart& root) {
    QelVidCtl::TemplateIndex& index = *root.index;
    part.number = index.partCount++;
    if (!part.name.IsEmpty()) index.namedParts.push_back({part.name.Str(), part.number});
    for (const auto& binding : part.bindings) index.bindings.push_back({part.number, binding.attribute, binding.property});
    for (const auto& route : part.routes) root.allRoutes.push_back({part.number, &route});
    if (part.header) Number(*part.header, root);
    if (part.body) Number(*part.body, root);
    for (QelVidCompiledPart& child : part.children) Number(child, root);
  }

  void NeedMeta(const std::string& place) const {
    if (!meta_) throw StyleError{place, "the class " + className_ + " has no introspection table"};
  }

  void BindAll(const json& bind, QelVidCompiledPart& part, const std::string& place) {
    if (!bind.is_object()) throw StyleError{place, "not an object"};
    for (const auto& [attribute, property] : bind.items()) {
      const std::string at = place + "/" + attribute;
      if (!property.is_string()) throw StyleError{at, "a binding names a property"};
      NeedMeta(at);
      const QelSYPMetaClass::Property* found = meta_->FindProperty(property.get<std::string>());
      if (!found)
        throw StyleError{at, "the class " + meta_->GetClassName() + " has no property \"" +
                                 property.get<std::string>() + "\""};
      part.bindings.push_back({QelVidAttributeName(attribute), found});
    }
  }

  void RouteAll(const json& on, QelVidWidget* sample, QelVidCompiledPart& part, const std::string& place) {
    if (!on.is_object()) throw StyleError{place, "not an object"};
    for (const auto& [eventName, handler] : on.items()) {
      const std::string at = place + "/" + eventName;
      if (!handler.is_string()) throw StyleError{at, "a route names a handler"};
      QelSYPEvent* event = sample->FindEvent(eventName);
      if (!event)
        throw StyleError{at, std::string("a ") + sample->GetWidgetKind() + " raises no event \"" + eventName + "\""};
      NeedMeta(at);
      if (!meta_->FindHandler(handler.get<std::string>()))
        throw StyleError{at, "the class " + meta_->GetClassName() + " has no handler \"" +
                                 handler.get<std::string>() + "\""};
      part.routes.push_back({event, handler.get<std::string>()});
    }
  }

  void CompileChildren(const json& node, QelVidCompiledPart& part, const std::string& place) {
    const bool expander = part.kind == "Expander";
    for (const char* slot : {"header", "body"}) {
      auto it = node.find(slot);
      if (it == node.end()) continue;
      if (!expander) throw StyleError{place + "/" + slot, "only an Expander has a header and a body"};
      auto child = std::make_unique<QelVidCompiledPart>(Compile(*it, place + "/" + slot));
      (std::string(slot) == "header" ? part.header : part.body) = std::move(child);
    }
    auto it = node.find("children");
    if (it == node.end()) return;
    if (!it->is_array()) throw StyleError{place + "/children", "not a list"};
    if (expander) throw StyleError{place + "/children", "an Expander has a header and a body, not children"};
    const bool grid = part.kind == "Grid";
    part.grid = grid;
    for (size_t i = 0; i < it->size(); ++i) {
      const std::string at = place + "/children/" + std::to_string(i);
      part.children.push_back(Compile((*it)[i], at));
      auto cell = (*it)[i].find("cell");
      if (!grid) {
        if (cell != (*it)[i].end()) throw StyleError{at + "/cell", "only a Grid's children have a cell"};
        part.cells.emplace_back();
        continue;
      }
      QelVidGridConstraints c;
      c.row = static_cast<int>(i);
      if (cell != (*it)[i].end()) c = Cell(*cell, at + "/cell");
      part.cells.emplace_back(c);
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

  std::string className_;
  const QelSYPMetaClass* meta_;
  std::vector<std::string> names_;
};

// The one handler of every control of a style: it finds the control of an event by
// walking up from the part that raised it, and the route by that part's number, then
// makes the handler of the route's name for that call. A row that is never clicked or
// hovered thus costs no handler and no reference of its own.
class QelVidRouteHandler final : public QelSYPEventHandler {
 public:
  QelVidRouteHandler(const QelSYPMetaClass* meta, std::shared_ptr<const QelVidCompiledPart> compiled)
      : meta_(meta), compiled_(std::move(compiled)) {}

  void HandleEvent(QelVidWidget* current, QelBaseUnknown* args) override {
    auto* eventArgs = dynamic_cast<QelSYPEventArgs*>(args);
    QelSYPEvent* event = eventArgs ? eventArgs->GetEvent() : nullptr;
    if (!event || !current) return;
    for (const QelVidCompiledPart::NumberedRoute& numbered : compiled_->allRoutes) {
      if (numbered.route->event != event) continue;
      QelVidCtl* control = ControlOf(current, numbered.part);
      if (!control) continue;
      // Held: the handler may rebuild the control, and with it the part's owners.
      QelBaseUnknown_var held = QelBaseUnknown_var::Retain(control);
      auto handler = QelVar<QelSYPEventHandler>::Adopt(meta_->CreateHandler(held.get(), numbered.route->handler));
      if (handler) handler->HandleEvent(current, args);
      return;
    }
  }

 protected:
  ~QelVidRouteHandler() override = default;

 private:
  // The control whose part `number` is `part`. A control styled again has other parts, and
  // a part taken out of its control has no such ancestor: their routes no longer apply.
  QelVidCtl* ControlOf(QelVidWidget* part, size_t number) const {
    for (QelVidWidget* up = part->GetParent(); up; up = up->GetParent()) {
      auto* control = dynamic_cast<QelVidCtl*>(up);
      if (control && control->GetTemplateIndex() == compiled_->index.get() && control->GetTemplatePart(number) == part)
        return control;
    }
    return nullptr;
  }

  const QelSYPMetaClass* meta_;
  std::shared_ptr<const QelVidCompiledPart> compiled_;
};

// Makes the widgets of a compiled template for a control, each at its number in `parts`.
QelVar<QelVidWidget> BuildParts(const QelVidCompiledPart& compiled, std::vector<QelVar<QelVidWidget>>& parts,
                                QelVidRouteHandler* router) {
  QelVar<QelVidWidget> part = compiled.make(compiled.name);
  parts[compiled.number] = part;
  part->InitAttributes(compiled.attributes, compiled.bindings.size());
  for (const auto& route : compiled.routes) part->AddHandler(route.event, router, 0);
  // Only an expander has a header or a body, and only a part with children may be a grid:
  // leaves, most parts of a row, need no cast.
  if (compiled.header || compiled.body) {
    if (auto* expander = dynamic_cast<QelVidCtlExpander*>(part.get())) {
      if (compiled.header) expander->SetHeader(BuildParts(*compiled.header, parts, router).get());
      if (compiled.body) expander->SetBody(BuildParts(*compiled.body, parts, router).get());
    }
  }
  if (compiled.children.empty()) return part;
  // The maker of a Grid part makes a QelVidLayGrid.
  auto* grid = compiled.grid ? static_cast<QelVidLayGrid*>(part.get()) : nullptr;
  for (size_t i = 0; i < compiled.children.size(); ++i) {
    QelVar<QelVidWidget> child = BuildParts(compiled.children[i], parts, router);
    if (grid && compiled.cells[i]) grid->AddWidget(child.get(), *compiled.cells[i]);
    else part->AddChild(child.get());
  }
  return part;
}
}  // namespace

QelVidStyleSheet::QelVidStyleSheet(std::string path, std::unique_ptr<Document> document)
    : path_(std::move(path)), document_(std::move(document)) {}
QelVidStyleSheet::~QelVidStyleSheet() = default;

std::string QelVidStyleSheet::StyleFolder() {
  std::string resources = QelGetEnv(kResourcesVariable);
  if (resources.empty()) resources = QEL_RESOURCES_SOURCE_DIR;
  return resources + "/styles";
}

const QelVidStyleSheet* QelVidStyleSheet::Load(const std::string& fileName, const std::string& forStyle) {
  const char* setting = std::getenv(kResourcesVariable);
  const std::string_view resourcesSetting = setting ? setting : "";
  for (const RecentSheet& recent : Recent())
    if (recent.fileName == fileName && recent.resourcesSetting == resourcesSetting) return recent.sheet;
  const QelVidStyleSheet* sheet = LoadByPath(fileName, forStyle);
  if (sheet) Recent().push_back({std::string(resourcesSetting), fileName, sheet});
  return sheet;
}

const QelVidStyleSheet* QelVidStyleSheet::LoadByPath(const std::string& fileName, const std::string& forStyle) {
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

void QelVidStyleSheet::ClearCache() {
  Recent().clear();
  Cache().clear();
}

bool QelVidStyleSheet::HasStyle(const std::string& style) const { return document_->root["styles"].contains(style); }

std::vector<std::string> QelVidStyleSheet::StyleNames() const {
  std::vector<std::string> names;
  for (const auto& [name, _] : document_->root["styles"].items()) names.push_back(name);
  return names;
}

HRESULT QelVidStyleSheet::Instantiate(QelVidCtl* control, const std::string& style) const {
  if (!control) return E_FAIL;
  const QelSYPMetaClass* meta = control->GetSYPMetaClass();
  auto found = document_->compiled.find(std::pair<std::string_view, const QelSYPMetaClass*>(style, meta));
  if (found == document_->compiled.end()) found = document_->compiled.emplace(std::pair(style, meta), nullptr).first;
  auto& compiled = found->second;
  if (!compiled) {
    const json& styles = document_->root["styles"];
    auto it = styles.find(style);
    if (it == styles.end()) {
      document_->compiled.erase({style, meta});
      Report("style sheet " + path_ + ": style \"" + style + "\": no such style");
      return E_FAIL;
    }
    try {
      if (!it->is_object() || !it->contains("template"))
        throw StyleError{"/styles/" + style, "a style is an object with a \"template\""};
      TemplateCompiler compiler(control->IsA(), meta);
      compiled = compiler.CompileTemplate((*it)["template"], style, "/styles/" + style + "/template");
    } catch (const StyleError& e) {
      document_->compiled.erase({style, meta});
      Report("style sheet " + path_ + ": style \"" + style + "\": at " + e.place + ": " + e.what);
      return E_FAIL;
    } catch (const json::exception& e) {
      document_->compiled.erase({style, meta});
      Report("style sheet " + path_ + ": style \"" + style + "\": " + e.what());
      return E_FAIL;
    }
  }
  std::shared_ptr<const QelVidCompiledPart> held = compiled;  // the map may change below
  QelVar<QelVidRouteHandler> router;
  if (!held->allRoutes.empty()) {
    // The weak link only ever refers to a router.
    if (QelBaseUnknown_var shared = held->router.Get()) {
      router = QelVar<QelVidRouteHandler>::Retain(static_cast<QelVidRouteHandler*>(shared.get()));
    } else {
      router = QelMakeVar<QelVidRouteHandler>(meta, held);
      held->router = QelBaseUnknown_WR(router.get());
    }
  }
  std::vector<QelVar<QelVidWidget>> parts(held->index->partCount);
  QelVar<QelVidWidget> root = BuildParts(*held, parts, router.get());
  control->SetTemplate(root.get(), held->index, std::move(parts));
  return S_OK;
}

std::vector<std::string> QelVidStyleSheet::TakeDiagnostics() { return std::exchange(Diagnostics(), {}); }

void QelVidStyleSheet::Report(const std::string& text) {
  // Kept for whoever asks next; a process that never asks keeps only the latest ones.
  if (Diagnostics().size() >= 64) Diagnostics().erase(Diagnostics().begin());
  Diagnostics().push_back(text);
  QelSysLogError(("qel: " + text + "\n").c_str());
}
