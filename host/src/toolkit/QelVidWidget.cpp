#include "QelVidWidget.h"

#include <algorithm>

#include "QelSYPEventArgs.h"
#include "QelSYPEventFactory.h"
#include "QelSYPEventHandler.h"
#include "QelSYPMetaClass.h"

const QelMetaObject& QelVidWidget::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelVidWidget", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "toolkit");
  return meta;
}
const QelMetaObject* QelVidWidget::GetMetaObject() const { return &MetaObject(); }

QelVidWidget::QelVidWidget(QelVidWidget* parent, const QelString& name)
    : name_(name), parent_(parent), parentWidget_(parent) {}

QelVidWidget::~QelVidWidget() = default;

void* QelVidWidget::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelISYPIntrospectable>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

QelVidWidget* QelVidWidget::GetParent() const { return parent_.GetRaw() ? parentWidget_ : nullptr; }

QelVidWidget* QelVidWidget::GetChild(int index) const {
  return index >= 0 && index < GetChildCount() ? children_[index].get() : nullptr;
}

void QelVidWidget::AddChild(QelVidWidget* child) {
  if (!child || child == this) return;
  QelVar<QelVidWidget> keep = QelVar<QelVidWidget>::Retain(child);
  if (QelVidWidget* old = child->GetParent()) old->RemoveChild(child);
  child->parent_ = QelBaseUnknown_WR(this);
  child->parentWidget_ = this;
  if (children_.empty()) children_.reserve(4);
  children_.push_back(std::move(keep));
}

bool QelVidWidget::RemoveChild(QelVidWidget* child) {
  auto it = std::find_if(children_.begin(), children_.end(), [child](const auto& c) { return c.get() == child; });
  if (it == children_.end()) return false;
  // Keep the child until the list no longer refers to it: its destructor may look around.
  QelVar<QelVidWidget> leaving = std::move(*it);
  children_.erase(it);
  leaving->parent_.Reset();
  leaving->parentWidget_ = nullptr;
  return true;
}

QelVidWidget* QelVidWidget::FindDescendant(const std::string& name) const {
  for (const auto& child : children_) {
    if (child->name_.Str() == name) return child.get();
    if (QelVidWidget* found = child->FindDescendant(name)) return found;
  }
  return nullptr;
}

void QelVidWidget::SetAttribute(const std::string& name, const QelSYPValue& value) {
  // Most widgets carry a handful: one allocation instead of a growth series.
  if (attributes_.capacity() == 0) attributes_.reserve(4);
  auto it = std::find_if(attributes_.begin(), attributes_.end(), [&](const auto& a) { return a.first == name; });
  if (it == attributes_.end()) attributes_.emplace_back(name, value);
  else it->second = value;
  OnAttributeChanged(name);
}

const QelSYPValue* QelVidWidget::FindAttribute(const std::string& name) const {
  for (const auto& [key, value] : attributes_)
    if (key == name) return &value;
  return nullptr;
}

QelSYPValue QelVidWidget::GetAttribute(const std::string& name) const {
  const QelSYPValue* found = FindAttribute(name);
  return found ? *found : QelSYPValue();
}

int QelVidWidget::IntAttribute(const std::string& name, int fallback) const {
  const QelSYPValue* found = FindAttribute(name);
  return found ? QelSYPValueToInt(*found, fallback) : fallback;
}

QelUnicodeString QelVidWidget::TextAttribute(const std::string& name) const {
  const QelSYPValue* found = FindAttribute(name);
  if (!found) return {};
  if (const auto* text = std::get_if<QelUnicodeString>(found)) return *text;
  return QelUnicodeString(QelSYPValueToText(*found));
}

QelString QelVidWidget::GetResourceFilename(int) const { return QelString("QelVidWidget"); }

QelSYPEventFactory* QelVidWidget::GetEventFactory() {
  static QelSYPEventFactory factory;
  return &factory;
}

QelSYPEvent* QelVidWidget::MouseEnterEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("MouseEnter", QelSYPEvent::Local, "QelSYPEventArgs", &MetaObject());
  return event;
}

QelSYPEvent* QelVidWidget::MouseLeaveEvent() {
  static QelSYPEvent* event =
      GetEventFactory()->NewEvent("MouseLeave", QelSYPEvent::Local, "QelSYPEventArgs", &MetaObject());
  return event;
}

QelSYPEvent* QelVidWidget::FindEvent(const std::string& name) const {
  if (name == "MouseEnter") return MouseEnterEvent();
  if (name == "MouseLeave") return MouseLeaveEvent();
  return nullptr;
}

int QelVidWidget::AddHandler(QelSYPEvent* event, QelSYPEventHandler* handler, int) {
  if (!event || !handler) return 0;
  if (connections_.empty()) connections_.reserve(2);
  connections_.push_back({event, QelVar<QelSYPEventHandler>::Retain(handler)});
  return 1;
}

int QelVidWidget::RemoveHandler(QelSYPEvent* event, QelSYPEventHandler* handler) {
  auto it = std::find_if(connections_.begin(), connections_.end(),
                         [&](const Connection& c) { return c.event == event && c.handler.get() == handler; });
  if (it == connections_.end()) return 0;
  connections_.erase(it);
  return 1;
}

int QelVidWidget::CountHandlers(QelSYPEvent* event) const {
  return static_cast<int>(
      std::count_if(connections_.begin(), connections_.end(), [event](const Connection& c) { return c.event == event; }));
}

bool QelVidWidget::Dispatch(QelSYPEventArgs* args) {
  if (!args || !args->GetEvent()) return false;
  QelSYPEvent* event = args->GetEvent();
  QelVar<QelSYPEventArgs> heldArgs = QelVar<QelSYPEventArgs>::Retain(args);
  // Every widget the dispatch will visit is held now: a handler may tear the tree down.
  std::vector<QelVar<QelVidWidget>> route{QelVar<QelVidWidget>::Retain(this)};
  if (event->GetPropagation() == QelSYPEvent::Ancestors)
    for (QelVidWidget* up = GetParent(); up; up = up->GetParent()) route.push_back(QelVar<QelVidWidget>::Retain(up));
  for (const auto& widget : route) {
    // A snapshot, so handlers added or removed by a handler do not disturb this pass.
    std::vector<QelVar<QelSYPEventHandler>> handlers;
    for (const Connection& c : widget->connections_)
      if (c.event == event) handlers.push_back(c.handler);
    for (const auto& handler : handlers) handler->HandleEvent(widget.get(), args);
  }
  return true;
}

bool QelVidWidget::Raise(QelSYPEvent* event) {
  if (!event) return false;
  QelVar<QelSYPEventArgs> args = QelMakeVar<QelSYPEventArgs>(event);
  args->SetOrigin(this);
  return Dispatch(args.get());
}

const QelSYPMetaClass* QelVidWidget::GetSYPMetaClass() const {
  for (const QelMetaObject* meta = GetMetaObject(); meta; meta = meta->Base())
    if (const QelSYPMetaClass* found = QelSYPMetaClass::Find(meta->Name())) return found;
  return nullptr;
}

void QelVidWidget::DispatchModifyProperty(const char*) {}
