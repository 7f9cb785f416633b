#include "QelHostWebApi.h"

#include <algorithm>
#include <cmath>
#include <nlohmann/json.hpp>

#include "Qel3DViewer.h"
#include "QelDbrBrowser.h"
#include "QelDelayedDestruction.h"
#include "QelFrmEditor.h"
#include "QelHostDisplayReasons.h"
#include "QelHostPanel.h"
#include "QelAnnotationLabel.h"
#include "QelHostSession.h"
#include "QelIAlias.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelILumCapture.h"
#include "QelILumCollection.h"
#include "QelILumSet.h"
#include "QelIVIABaseUI.h"
#include "QelListValQelUnicodeString.h"
#include "QelModelBuilder.h"
#include "QelModelObject.h"
#include "QelModelPrinter.h"
#include "QelPLMProductOccurrence.h"
#include "QelVidLayGrid.h"
#include "QelModelScene.h"
#include "QelOffscreenSupport.h"
#include "QelPngWriter.h"
#include "QelSettingRepository.h"
#include "QelFrmContext.h"
#include "QelIHyxFacetCtrl.h"
#include "QelReviewFramework.h"
#include "QelRovActivateAndDisplayToolbox.h"
#include "QelRovFacetServices.h"
#include "QelVidCtlButton.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidCtlScrollableArea.h"
#include "QelVidWidgetPrinter.h"

namespace {
using json = nlohmann::json;
constexpr int kLightBrowserType = 1;
constexpr double kPi = 3.14159265358979323846;

// Names come from model files; a stray byte must not make the whole answer fail.
std::string Dump(const json& value) { return value.dump(-1, ' ', false, json::error_handler_t::replace); }

QelHostWebReply Error(int status, const std::string& message, const std::string& at = {}) {
  json body{{"error", message}};
  // The widget a refusal is about, so the page can say it beside that box.
  if (!at.empty()) body["at"] = at;
  return {status, kQelJsonType, Dump(body)};
}

// The id QelVidAppendJson gives `w` under `root`: its path of child indices.
std::string IdOf(QelVidWidget* root, QelVidWidget* w) {
  std::vector<size_t> path;
  for (; w && w != root; w = w->GetParent()) {
    QelVidWidget* parent = w->GetParent();
    if (!parent) return {};
    std::vector<QelVidWidget*> children;
    if (auto* grid = dynamic_cast<QelVidLayGrid*>(parent)) children = grid->GetWidgetsInOrder();
    else for (int i = 0; i < parent->GetChildCount(); ++i) children.push_back(parent->GetChild(i));
    const auto at = std::find(children.begin(), children.end(), w);
    if (at == children.end()) return {};
    path.push_back(static_cast<size_t>(at - children.begin()));
  }
  if (!w) return {};
  std::string id = "0";
  for (auto it = path.rbegin(); it != path.rend(); ++it) id += "." + std::to_string(*it);
  return id;
}

bool IsShown(QelBaseUnknown* object) { return QelRovFacetServices::IsDisplayEnabled(object) == S_OK; }

using QelHostDisplayReasons::NameOf;

QelVar<QelPathElement> RootPath(QelBaseUnknown* root) {
  auto path = QelMakeVar<QelPathElement>();
  path->AddChildElement(root);
  return path;
}

// Shown on the page: the widget and every ancestor visible.
bool IsOnPage(QelVidWidget* w) {
  for (; w; w = w->GetParent())
    if (!w->GetVisibleFlag()) return false;
  return true;
}

// `v` turned by `degrees` about the unit `axis` (Rodrigues).
QelMathVector Turn(const QelMathVector& v, const QelMathVector& axis, double degrees) {
  const double a = degrees * kPi / 180.0, c = std::cos(a), s = std::sin(a);
  return v * c + axis.Cross(v) * s + axis * (axis.Dot(v) * (1.0 - c));
}

template <class T>
T* As(QelVidWidget* w) {
  return dynamic_cast<T*>(w);
}
}  // namespace

QelHostWebApi::QelHostWebApi(QelHostSession& session) : session_(session) {
  QelBaseUnknown* root = session_.Root();
  QelReviewFramework::Register();
  auto previews = QelMakeVar<Qel3DViewer>(576, 432);
  previews->SetSceneSource(QelMakeVar<QelModelScene>(root).get());
  browser_ = QelMakeVar<QelDbrBrowser>(kLightBrowserType, RootPath(root).get(), previews.get());
  // A model without a light views browser still has its panel and picture.
  if (browser_->Open(root, QelFrmEditor::GetCurrentEditor()) != S_OK) browser_ = nullptr;

  QelListValQelBaseUnknown_var sets;
  QelRovFacetServices::ListAllSets(root, sets, false);
  for (const auto& set : sets) {
    std::vector<QelBaseUnknown_var> annotations;
    QelVar<QelILumCollection> elements;
    if (QelVar<QelILumSet> lumSet{set.get()}) lumSet->GetElements(elements);
    uint32_t count = 0;
    if (elements) elements->GetCount(count);
    for (uint32_t i = 0; i < count; ++i)
      if (QelBaseUnknown_var item; elements->GetItem(i, item) == S_OK && item) annotations.push_back(item);
    annotationsBySet_.emplace_back(set, std::move(annotations));
  }

  // The product tree, root first, each product before its children.
  std::vector<QelBaseUnknown_var> pending{QelBaseUnknown_var::Retain(root)};
  while (!pending.empty() && products_.size() < 10000) {
    QelBaseUnknown_var product = pending.back();
    pending.pop_back();
    auto* occurrence = QelSysDynamicCast<QelPLMProductOccurrence>(product.get());
    if (!occurrence) continue;
    products_.push_back(product);
    QelListValQelBaseUnknown_var children;
    occurrence->ListChildren(children);
    for (int i = children.Size(); i >= 1; --i) pending.push_back(children[i]);
  }

  displayCallback_ = QelRovFacetServices::AddDisplayChangeCallback(
      root, session_.Editor(), [this](QelBaseUnknown*, QelBaseUnknown* object) {
        ++version_;
        if (!recording_ || !object) return;
        QelBaseUnknown_var held(object);
        // Told after the change: the state before is the other one.
        if (shownBefore_.emplace(held->GetImpl(), !IsShown(object)).second) changed_.push_back(held);
      });
  previousAsker_ = QelDlgNotify::SetAsker([this](const QelDlgNotify&, const QelUnicodeString& message,
                                                 const QelUnicodeString& title) {
    // Nobody can answer inside the request: the question is refused and kept for the page.
    asked_ = Question{title.Utf8(), message.Utf8()};
    return QelDlgNotify::AnswerNone;
  });

  // The first picture shows the whole model from above and aside, as `--picture` does.
  if (Qel3DViewer* viewer = session_.Viewer()) {
    Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
    viewpoint->SetOrientation(QelMathDirectionf(QelMathVector{-1, 1.5, -1}), QelMathDirectionf(QelMathVector{0, 0, 1}));
    viewer->PrepareViewpoint();
    QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(RootPath(root).get(), viewer, viewpoint);
  }
}

QelHostWebApi::~QelHostWebApi() {
  QelDlgNotify::SetAsker(previousAsker_);
  QelDlgNotify::ClearAnswers();
  if (displayCallback_) QelCallbackManager::Get().RemoveCallback(displayCallback_);
  if (browser_) browser_->Close();
  browser_ = nullptr;
  QelDelayedDestruction::FlushIdle();
}

void QelHostWebApi::BeginChanges() {
  changed_.clear();
  shownBefore_.clear();
  recording_ = true;
}

QelHostWebApi::Changes QelHostWebApi::EndChanges() {
  recording_ = false;
  Changes changes;
  for (const auto& object : changed_) {
    const bool now = IsShown(object.get());
    if (now != shownBefore_[object->GetImpl()]) (now ? changes.shown : changes.hidden).push_back(NameOf(object.get()));
  }
  changed_.clear();
  shownBefore_.clear();
  return changes;
}

int QelHostWebApi::ItemId(QelBaseUnknown* item) {
  auto [at, added] = itemIds_.emplace(item->GetImpl(), static_cast<int>(items_.size()) + 1);
  if (added) items_.push_back(QelBaseUnknown_var::Retain(item));
  return at->second;
}

std::string QelHostWebApi::BrowserJson() {
  json browser = {{"columns", json::array()}, {"nodes", json::array()}};
  if (!browser_) return Dump(browser);
  QelListValQelUnicodeString headers;
  std::vector<QelString> columns = browser_->GetColumns(headers);
  for (int c = 1; c <= headers.Size(); ++c) browser["columns"].push_back(headers[c].Utf8());
  for (const auto& node : browser_->GetNodes()) {
    json items = json::array();
    for (const auto& item : node.items) {
      const int id = ItemId(item.get());
      QelVar<QelIVIABaseUI> ui{item.get()};
      QelUnicodeString name;
      if (ui) ui->GetPropertyValue("NAME", name);
      else name = QelUnicodeString(NameOf(item.get()));
      QelVar<QelIDbrBrowserViewBaseUI> view{item.get()};
      json entry = {{"item", id},
                    {"name", name.Utf8()},
                    {"kind", QelVar<QelILumCapture>(item.get()) ? "capture" : "view"},
                    {"description", view ? view->GetDescription().Utf8() : std::string()}};
      entry["thumbnail"] = ui ? json("/api/thumbnail/" + std::to_string(id) + ".png") : json(nullptr);
      items.push_back(std::move(entry));
    }
    browser["nodes"].push_back({{"name", node.name.Str()}, {"items", std::move(items)}});
  }
  return Dump(browser);
}

QelHostWebReply QelHostWebApi::StateWith(const Changes& changes) {
  // The labels a picture could not place are told with the answer, so the picture it names
  // is drawn now, at the size last asked for; the page's request for it then finds it ready.
  if (!picture_.empty() && pictureVersion_ != version_ && session_.Viewer()) DrawPicture(pictureWidth_, pictureHeight_);
  int shown = 0, hidden = 0;
  for (const auto& [set, annotations] : annotationsBySet_) {
    const QelModelObject* owner = QelModelObject::From(set.get());
    const bool setShown = owner && owner->IsShown();
    for (const auto& annotation : annotations) {
      const QelModelObject* object = QelModelObject::From(annotation.get());
      (setShown && object && object->IsShown() ? shown : hidden) += 1;
    }
  }
  QelDbrFraPanel* panel = QelHostPanel::Find(session_.Editor());
  json question = question_ ? json{{"title", question_->title}, {"message", question_->message}} : json(nullptr);
  QelHostWebReply reply;
  std::string& body = reply.body;
  body = "{\"panel\":";
  QelVidAppendJson(panel, body, true);  // most of the answer: written in place, never copied
  body += ",\"browser\":" + BrowserJson();
  body += ",\"changes\":" + Dump(json{{"shown", changes.shown}, {"hidden", changes.hidden}});
  body += ",\"display\":" + Dump(json{{"shown", shown}, {"hidden", hidden}});
  body += ",\"picture\":\"/api/picture.png?v=" + std::to_string(version_) + "\"";
  body += ",\"question\":" + Dump(question);
  // What filters now, each part with the box that undoes it, and why each hidden annotation
  // is not drawn: read off the rows once for the whole answer.
  const std::vector<QelHostPanelRow> rows = panel ? QelHostPanel::ReadRows(panel) : std::vector<QelHostPanelRow>();
  json filters = json::array();
  for (const auto& part : QelHostDisplayReasons::Summary(rows)) {
    const QelHostPanelRow* row = part.undo.empty() ? nullptr : QelHostPanel::Resolve(rows, part.undo);
    const std::string id = row && row->check ? IdOf(panel, row->check.get()) : std::string();
    filters.push_back({{"text", part.text}, {"undo", id.empty() ? json(nullptr) : json(id)}});
  }
  json notDrawn = json::array();
  size_t listed = 0;
  constexpr size_t kHiddenListed = 200;
  for (const auto& [set, annotations] : annotationsBySet_)
    for (const auto& annotation : annotations) {
      if (IsShown(annotation.get()) && IsShown(set.get())) continue;
      if (++listed > kHiddenListed) continue;
      notDrawn.push_back({{"name", NameOf(annotation.get())},
                          {"row", QelHostDisplayReasons::RowName(annotation.get())},
                          {"why", QelHostDisplayReasons::WhyNotDrawn(annotation.get(), rows, activatedCapture_)}});
    }
  body += ",\"filters\":" + Dump(filters);
  body += ",\"notDrawn\":" + Dump(json{{"count", listed}, {"listed", notDrawn}});
  body += ",\"unplaced\":" + Dump(unplaced_);
  json notRead = json::array();
  for (const QelModelNotRead& missing : QelModelBuilder::NotRead(session_.Root()))
    notRead.push_back({{"kind", missing.kind}, {"count", missing.count}, {"entities", missing.entities}});
  body += ",\"notRead\":" + Dump(notRead);
  body += ",\"unit\":" + Dump(json(QelAnnotationLabel::LengthUnit(session_.Root())));
  body += ",\"products\":" + ProductsJson() + "}";
  return reply;
}

QelHostWebReply QelHostWebApi::State() { return StateWith({}); }

std::string QelHostWebApi::ProductsJson() {
  QelBaseUnknown_var active;
  if (QelFrmEditor* editor = session_.Editor()) active = editor->GetUIActivePath()->GetLeaf();
  json products = json::array();
  for (size_t i = 0; i < products_.size(); ++i) {
    int depth = 0;
    QelBaseUnknown_var father;
    for (auto* at = QelSysDynamicCast<QelPLMProductOccurrence>(products_[i].get());
         at && at->GetFather(father) == S_OK && depth < 64; at = QelSysDynamicCast<QelPLMProductOccurrence>(father.get()))
      ++depth;
    products.push_back({{"product", i + 1},
                        {"name", NameOf(products_[i].get())},
                        {"depth", depth},
                        {"active", active && active->IsEqual(products_[i].get())}});
  }
  return Dump(products);
}

QelHostWebReply QelHostWebApi::Reset(std::string_view) {
  pending_.reset();
  question_.reset();
  if (session_.OpeningMarks().empty()) return Error(400, "the panel was not shown when the model opened");
  BeginChanges();
  QelHostPanel::RestoreMarks(session_.Editor(), session_.OpeningMarks());
  Changes changes = EndChanges();
  QelDelayedDestruction::FlushIdle();
  activatedCapture_.clear();
  return StateWith(changes);
}

QelHostWebReply QelHostWebApi::UiActive(std::string_view body) {
  pending_.reset();
  question_.reset();
  const json request = json::parse(body, nullptr, false);
  if (!request.is_object() || !request.contains("product") || !request["product"].is_number_integer())
    return Error(400, "expects {\"product\": N}, N from the state's products");
  const auto number = request["product"].get<int64_t>();
  if (number < 1 || number > static_cast<int64_t>(products_.size()))
    return Error(400, "no product " + std::to_string(number));
  // The browser follows through its context; the items it lists now get new ids.
  session_.MakeUIActive(products_[static_cast<size_t>(number - 1)].get());
  QelDelayedDestruction::FlushIdle();
  return State();
}

QelHostWebReply QelHostWebApi::OpenPanel(std::string_view) {
  pending_.reset();
  question_.reset();
  QelFrmContext* context = QelFrmContext::GetContext();
  QelSettingRepository* repository = QelSettingRepository::GetRepository("QelRovDataFiltering");
  QelIHyxFacetCtrl* controller = session_.Controller();
  if (!context || !repository || !controller) return Error(400, "no panel can be shown here");
  const std::string key = std::string("DataFilteringPanel_") + context->GetWorkbenchName().CastToCharPtr();
  if (repository->WriteSetting(key.c_str(), 1) != S_OK || repository->SaveRepository() != S_OK)
    return Error(500, "could not save " + key + " in " + repository->GetFilePath());
  controller->CreateDataFilteringPanelIfNecessary();
  QelDelayedDestruction::FlushIdle();
  if (!QelHostPanel::Find(session_.Editor())) return Error(400, "the workbench or the window takes no panel");
  return State();
}

std::string QelHostWebApi::RangeRefusal(QelVidWidget* root, QelVidWidget* widget, const QelHostWebEvent& event) {
  using Type = QelHostWebEvent::Type;
  if (event.type != Type::Text && event.type != Type::Click) return {};
  // The range row holding the widget: the nearest ancestor with its editors and button.
  QelVidWidget* rowWidget = widget;
  while (rowWidget && !(rowWidget->FindDescendant("LeftEditor") && rowWidget->FindDescendant("RangeButton")))
    rowWidget = rowWidget->GetParent();
  if (!rowWidget || rowWidget == root) return {};
  auto* left = As<QelVidCtlLineEditor>(rowWidget->FindDescendant("LeftEditor"));
  auto* right = As<QelVidCtlLineEditor>(rowWidget->FindDescendant("RightEditor"));
  auto* combo = As<QelVidCtlImageAndLabelCombo>(rowWidget->FindDescendant("LeftCombo"));
  auto* check = As<QelVidCtlCheckButton>(rowWidget->FindDescendant("CheckBox"));
  if (!left || !right || !combo) return {};
  if (event.type == Type::Text) {
    if (widget != left && widget != right) return {};
    char* end = nullptr;
    const double value = std::strtod(event.text.c_str(), &end);
    if (!event.text.empty() && *end == '\0' && std::isfinite(value)) return {};
    errorAt_ = event.id;
    return "\"" + event.text + "\" is not a number; the range in effect is kept";
  }
  const bool ticking = check && widget == check && check->GetCheckState() != 1;
  if (!ticking && widget != rowWidget->FindDescendant("RangeButton")) return {};
  QelHostPanelRow row;
  row.row = QelVar<QelVidWidget>::Retain(rowWidget);
  row.kind = QelHostPanelRow::Kind::Range;
  row.state = check ? check->GetCheckState() : 0;
  const int index = combo->GetSelectedIndex();
  const std::string lower = index >= 0 && index < combo->GetLineCount() ? combo->GetLine(index).Utf8() : std::string();
  const double low = std::strtod(left->GetText().Utf8().c_str(), nullptr);
  const double high = std::strtod(right->GetText().Utf8().c_str(), nullptr);
  std::string why = QelHostPanel::RangeProblem(row, lower, low, true, high, ticking);
  if (!why.empty()) {
    errorAt_ = IdOf(root, why.find("upper") != std::string::npos ? right : left);
    why += "; the range in effect is kept";
  }
  return why;
}

bool QelHostWebApi::Dispatch(const QelHostWebEvent& event, std::string& error) {
  errorAt_.clear();
  QelDbrFraPanel* panel = QelHostPanel::Find(session_.Editor());
  if (!panel) {
    error = "no panel is open";
    return false;
  }
  QelVidWidget* widget = QelVidFindById(panel, event.id);
  const std::string named = "widget " + event.id;
  if (!widget) {
    error = "the panel has no " + named;
    return false;
  }
  if (!IsOnPage(widget) || !widget->IsEnabled()) {
    error = named + (widget->IsEnabled() ? " is hidden" : " is disabled");
    return false;
  }
  if (std::string why = RangeRefusal(panel, widget, event); !why.empty()) {
    error = why;
    return false;
  }
  // The widget's own dispatch may rebuild the dialog; the old widgets go when idle.
  QelVar<QelDbrFraPanel> holdPanel = QelVar<QelDbrFraPanel>::Retain(panel);
  QelVar<QelVidWidget> hold = QelVar<QelVidWidget>::Retain(widget);
  using Type = QelHostWebEvent::Type;
  const std::string kind = widget->GetWidgetKind();
  switch (event.type) {
    case Type::Click:
      // Enabled was checked above, so each of these raises its event.
      if (auto* check = As<QelVidCtlCheckButton>(widget)) return check->Click();
      if (auto* button = As<QelVidCtlButton>(widget)) return button->Click();
      break;
    case Type::Text:
      if (auto* editor = As<QelVidCtlLineEditor>(widget)) return editor->Enter(QelUnicodeString(event.text));
      break;
    case Type::Select:
      if (auto* combo = As<QelVidCtlImageAndLabelCombo>(widget)) {
        if (event.index < combo->GetLineCount()) return combo->Select(event.index);
        error = named + " has no line " + std::to_string(event.index);
        return false;
      }
      break;
    case Type::Expand:
    case Type::Collapse:
      if (auto* expander = As<QelVidCtlExpander>(widget)) {
        event.type == Type::Expand ? expander->Expand() : expander->Collapse();
        return true;
      }
      break;
    case Type::Scroll:
      if (auto* area = As<QelVidCtlScrollableArea>(widget)) {
        area->SetHScrollOffset(event.x);
        area->SetVScrollOffset(event.y);
        return true;
      }
      break;
  }
  error = named + " (" + kind + ") does not take this event";
  return false;
}

bool QelHostWebApi::Run(const QelHostWebEvent& event, Changes& changes, std::string& error) {
  asked_.reset();
  BeginChanges();
  const bool done = Dispatch(event, error);
  if (!done && error.empty()) error = "widget " + event.id + " did not take the event";
  changes = EndChanges();
  // The request is over: the host is idle.
  QelDelayedDestruction::FlushIdle();
  if (asked_) {
    pending_ = event;
    question_ = asked_;
  }
  return done;
}

QelHostWebReply QelHostWebApi::Event(std::string_view body) {
  pending_.reset();
  question_.reset();
  QelHostWebEvent event;
  std::string error;
  Changes changes;
  errorAt_.clear();
  if (!QelHostWebRequest::ParseEvent(body, event, error) || !Run(event, changes, error))
    return Error(400, error, errorAt_);
  return StateWith(changes);
}

QelHostWebReply QelHostWebApi::Answer(std::string_view body) {
  bool yes = false;
  std::string error;
  if (!QelHostWebRequest::ParseAnswer(body, yes, error)) return Error(400, error);
  if (!pending_) return Error(400, "no question is waiting for an answer");
  const QelHostWebEvent event = *pending_;
  pending_.reset();
  question_.reset();
  Changes changes;
  if (yes) {
    QelDlgNotify::QueueAnswer(QelDlgNotify::AnswerYes);
    const bool done = Run(event, changes, error);
    // An answer the replay did not take must not confirm a later question.
    QelDlgNotify::ClearAnswers();
    if (!done) return Error(400, error);
  }
  return StateWith(changes);
}

QelHostWebReply QelHostWebApi::Camera(std::string_view body) {
  pending_.reset();
  question_.reset();
  QelHostWebCamera camera;
  std::string error;
  if (!QelHostWebRequest::ParseCamera(body, camera, error)) return Error(400, error);
  Qel3DViewer* viewer = session_.Viewer();
  if (!viewer) return Error(400, "no 3D viewer is open");
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  const QelMathPoint eye = viewpoint->GetOrigin();
  const QelMathVector sight = viewpoint->GetSightDirection().ToDouble();
  QelMathPoint target = viewpoint->GetTarget().ToDouble();
  // A viewpoint whose target sits at its eye turns about a point ahead of it.
  if ((target - eye).Dot(sight) <= 1e-9) target = eye + sight * 100.0;
  switch (camera.kind) {
    case QelHostWebCamera::Kind::Orbit: {
      // Dragging right turns the model right: the eye goes the other way about the target.
      QelMathVector up = viewpoint->GetUpDirection().ToDouble();
      up = up - sight * up.Dot(sight);
      up = QelMathDirection(up.SquareNorm() > 1e-12 ? up : QelMathVector{sight.z, sight.x, sight.y});
      QelMathVector offset = eye - target;
      offset = Turn(offset, up, -camera.dx);
      const QelMathVector right = QelMathDirection(up.Cross(offset));
      offset = Turn(offset, right, -camera.dy);
      up = Turn(up, right, -camera.dy);
      viewpoint->SetOrigin(target + offset);
      viewpoint->SetOrientation(QelMathDirectionf(offset * -1.0), QelMathDirectionf(up));
      viewpoint->SetTarget(QelMathPointf(target));
      break;
    }
    case QelHostWebCamera::Kind::Zoom:
      viewpoint->SetOrigin(target + (eye - target) * (1.0 / camera.factor));
      viewpoint->SetTarget(QelMathPointf(target));
      break;
    case QelHostWebCamera::Kind::Reframe:
      viewer->PrepareViewpoint();
      QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(RootPath(session_.Root()).get(), viewer,
                                                                     viewpoint);
      break;
  }
  ++version_;
  return State();
}

QelHostWebReply QelHostWebApi::Activate(std::string_view body) {
  pending_.reset();
  question_.reset();
  int item = 0;
  std::string error;
  if (!QelHostWebRequest::ParseActivate(body, item, error)) return Error(400, error);
  if (!browser_ || item > static_cast<int>(items_.size())) return Error(400, "the browser has no item " + std::to_string(item));
  QelBaseUnknown_var chosen = items_[static_cast<size_t>(item - 1)];
  BeginChanges();
  const HRESULT activated = browser_->Activate(chosen.get());
  Changes changes = EndChanges();
  if (activated == S_OK) {
    QelHostPanel::PressRefresh(session_.Editor());
    if (QelVar<QelILumCapture>(chosen.get())) activatedCapture_ = NameOf(chosen.get());
  }
  QelDelayedDestruction::FlushIdle();
  if (activated != S_OK) return Error(400, "item " + std::to_string(item) + " cannot be activated");
  ++version_;
  return StateWith(changes);
}

QelHostWebReply QelHostWebApi::Picture(int width, int height) {
  width = std::clamp(width, 64, 2048);
  height = std::clamp(height, 64, 2048);
  if (!session_.Viewer()) return Error(404, "no 3D viewer is open");
  if (picture_.empty() || pictureVersion_ != version_ || pictureWidth_ != width || pictureHeight_ != height) {
    if (std::string error = DrawPicture(width, height); !error.empty()) return Error(500, error);
  }
  servedVersion_ = pictureVersion_;
  return {200, "image/png", picture_};
}

bool QelHostWebApi::PreparePicture() {
  // One try per version: a picture that cannot be drawn is not tried again at every pause.
  if (picture_.empty() || pictureVersion_ == version_ || servedVersion_ != pictureVersion_ ||
      preparedVersion_ == version_ || !session_.Viewer())
    return false;
  preparedVersion_ = version_;
  return DrawPicture(pictureWidth_, pictureHeight_).empty();
}

std::string QelHostWebApi::DrawPicture(int width, int height) {
  Qel3DViewer* viewer = session_.Viewer();
  QelSupport* support = viewer->GetSupport();
  support->SetSize(width, height);
  viewer->PrepareViewpoint();
  auto image = QelMakeVar<QelPixelImage>(width, height);
  QelVar<QelOffscreenSupport> offscreen = createSupport(support, image.get());
  if (!offscreen) return "the viewer has no surface to draw";
  offscreen->SetBackgroundColor(0.5f, 0.5f, 0.5f);
  offscreen->SetTextSprites(1);
  std::string png;
  if (offscreen->Draw() != S_OK || !QelPngWriter::Encode(*image, png)) return "the picture could not be made";
  unplaced_ = offscreen->GetUnplacedLabels();
  picture_ = std::move(png);
  pictureVersion_ = version_;
  pictureWidth_ = width;
  pictureHeight_ = height;
  return {};
}

QelHostWebReply QelHostWebApi::Thumbnail(int item) {
  if (item < 1 || item > static_cast<int>(items_.size())) return Error(404, "no item " + std::to_string(item));
  auto cached = thumbnails_.find(item);
  if (cached == thumbnails_.end()) {
    QelVar<QelIVIABaseUI> ui{items_[static_cast<size_t>(item - 1)].get()};
    QelPixelImage* raw = nullptr;
    if (ui) ui->GetThumbnail(&raw);
    auto image = QelVar<QelPixelImage>::Adopt(raw);
    std::string png;
    if (!image || !QelPngWriter::Encode(*image, png)) return Error(404, "item " + std::to_string(item) + " has no thumbnail");
    cached = thumbnails_.emplace(item, std::move(png)).first;
  }
  return {200, "image/png", cached->second};
}
