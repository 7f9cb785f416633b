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

QelVidWidget::QelVidWidget(QelVidWidget* parent, QelString name)
    : name_(std::move(name)), parentWidget_(parent), namedParent_(parent) {}

QelVidWidget::~QelVidWidget() {
  // A child someone else still holds must not reach this widget once its memory is gone.
  for (const auto& child : children_)
    if (child->parentWidget_ == this) child->Unlink();
}

void* QelVidWidget::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelISYPIntrospectable>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

QelVidWidget* QelVidWidget::GetParent() const {
  if (!parentWidget_) return nullptr;
  if (ownedByParent_) return parentWidget_->IsBeingDestroyed() ? nullptr : parentWidget_;
  return namedParent_.GetRaw() ? parentWidget_ : nullptr;
}

QelVidWidget* QelVidWidget::GetChild(int index) const {
  return index >= 0 && index < GetChildCount() ? children_[index].get() : nullptr;
}

void QelVidWidget::AddChild(QelVidWidget* child) {
  if (!child || child == this) return;
  QelVar<QelVidWidget> keep = QelVar<QelVidWidget>::Retain(child);
  if (QelVidWidget* old = child->GetParent()) old->RemoveChild(child);
  child->namedParent_.Reset();
  child->parentWidget_ = this;
  child->ownedByParent_ = true;
  if (children_.empty()) children_.reserve(4);
  children_.push_back(std::move(keep));
}

bool QelVidWidget::RemoveChild(QelVidWidget* child) {
  auto it = std::find_if(children_.begin(), children_.end(), [child](const auto& c) { return c.get() == child; });
  if (it == children_.end()) return false;
  // Keep the child until the list no longer refers to it: its destructor may look around.
  QelVar<QelVidWidget> leaving = std::move(*it);
  children_.erase(it);
  leaving->Unlink();
  return true;
}

std::vector<QelVar<QelVidWidget>> QelVidWidget::TakeChildren() {
  std::vector<QelVar<QelVidWidget>> taken = std::move(children_);
  children_.clear();
  for (const auto& child : taken) child->Unlink();
  return taken;
}

QelVidWidget* QelVidWidget::FindDescendant(const std::string& name) const {
  for (const auto& child : children_) {
    if (child->name_.Str() == name) return child.get();
    if (QelVidWidget* found = child->FindDescendant(name)) return found;
  }
  return nullptr;
}

void QelVidWidget::SetAttribute(const std::string& name, const QelSYPValue& value) {
  if (QelSYPValue* found = attributes_.Find(std::string_view(name))) *found = value;
  else attributes_.Append(QelVidAttributeName(name), value);
  OnAttributeChanged(name);
}

void QelVidWidget::SetAttribute(const std::string* name, const QelSYPValue& value) {
  if (QelSYPValue* found = attributes_.Find(name)) *found = value;
  else attributes_.Append(name, value);
  OnAttributeChanged(*name);
}

void QelVidWidget::InitAttributes(const std::vector<QelVidAttribute>& initial, size_t more) {
  attributes_.Reserve(attributes_.size() + initial.size() + more);
  for (const QelVidAttribute& attribute : initial) SetAttribute(attribute.name, attribute.value);
}

QelSYPValue QelVidWidget::GetAttribute(const std::string& name) const {
  const QelSYPValue* found = attributes_.Find(std::string_view(name));
  return found ? *found : QelSYPValue();
}

int QelVidWidget::IntAttribute(const std::string& name, int fallback) const {
  const QelSYPValue* found = attributes_.Find(std::string_view(name));
  return found ? QelSYPValueToInt(*found, fallback) : fallback;
}

QelUnicodeString QelVidWidget::TextAttribute(const std::string& name) const {
  const QelSYPValue* found = attributes_.Find(std::string_view(name));
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
  Connection added{event, QelVar<QelSYPEventHandler>::Retain(handler)};
  if (ownConnectionCount_ < kOwnConnections && moreConnections_.empty())
    ownConnections_[ownConnectionCount_++] = std::move(added);
  else
    moreConnections_.push_back(std::move(added));
  return 1;
}

int QelVidWidget::RemoveHandler(QelSYPEvent* event, QelSYPEventHandler* handler) {
  auto matches = [&](const Connection& c) { return c.event == event && c.handler.get() == handler; };
  for (size_t i = 0; i < ownConnectionCount_; ++i) {
    if (!matches(ownConnections_[i])) continue;
    // Keep the order: close the gap, then refill the last own slot from the overflow.
    Connection leaving = std::move(ownConnections_[i]);
    for (size_t j = i + 1; j < ownConnectionCount_; ++j) ownConnections_[j - 1] = std::move(ownConnections_[j]);
    --ownConnectionCount_;
    if (!moreConnections_.empty()) {
      ownConnections_[ownConnectionCount_++] = std::move(moreConnections_.front());
      moreConnections_.erase(moreConnections_.begin());
    }
    return 1;
  }
  auto it = std::find_if(moreConnections_.begin(), moreConnections_.end(), matches);
  if (it == moreConnections_.end()) return 0;
  moreConnections_.erase(it);
  return 1;
}

int QelVidWidget::CountHandlers(QelSYPEvent* event) const {
  int count = 0;
  ForEachConnection([&](const Connection& c) { count += c.event == event ? 1 : 0; });
  return count;
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
    widget->ForEachConnection([&](const Connection& c) {
      if (c.event == event) handlers.push_back(c.handler);
    });
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
