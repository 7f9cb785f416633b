#include "QelHostWebApi.h"

#include <algorithm>
#include <cmath>
#include <nlohmann/json.hpp>

#include "Qel3DViewer.h"
#include "QelDbrBrowser.h"
#include "QelDelayedDestruction.h"
#include "QelFrmEditor.h"
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
#include "QelModelObject.h"
#include "QelModelScene.h"
#include "QelOffscreenSupport.h"
#include "QelPngWriter.h"
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

QelHostWebReply Error(int status, const std::string& message) {
  return {status, kQelJsonType, Dump(json{{"error", message}})};
}

bool IsShown(QelBaseUnknown* object) { return QelRovFacetServices::IsDisplayEnabled(object) == S_OK; }

std::string NameOf(QelBaseUnknown* object) {
  QelUnicodeString alias;
  if (QelVar<QelIAlias> named{object}) named->GetAlias(alias);
  return alias.IsEmpty() ? std::string("(no name)") : alias.Utf8();
}

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
  body += ",\"unit\":" + Dump(json(QelAnnotationLabel::LengthUnit(session_.Root())));
  body += ",\"question\":" + Dump(question) + "}";
  return reply;
}

QelHostWebReply QelHostWebApi::State() { return StateWith({}); }

bool QelHostWebApi::Dispatch(const QelHostWebEvent& event, std::string& error) {
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
  if (!QelHostWebRequest::ParseEvent(body, event, error) || !Run(event, changes, error)) return Error(400, error);
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
