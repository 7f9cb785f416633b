#pragma once
// QelVidWidget: a node of the headless widget tree. A widget holds its children through
// counted handles and its parent weakly; it carries named attributes (what a person would
// see: "visible", "enabled", "text", "checked", colours ...) and event handlers, and
// dispatches events to its handlers and, for propagating events, to its ancestors'.
// A dispatch holds every widget it will visit, so a handler may remove and release the
// widget (or an ancestor) that is dispatching: it goes when the dispatch returns.
#include <string>
#include <vector>

#include "QelBaseUnknown_WR.h"
#include "QelVidAttributeList.h"
#include "QelISYPIntrospectable.h"
#include "QelMetaObject.h"
#include "QelSYPEvent.h"
#include "QelSYPValue.h"
#include "QelString.h"
#include "QelVidPoint.h"

class QelSYPEventArgs;
class QelSYPEventFactory;
class QelSYPEventHandler;

class QelVidWidget : public QelISYPIntrospectable {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelVidWidget(QelVidWidget* parent, QelString name);

  // The kind a renderer shows: "Widget", "Frame", "Grid", "Expander" ...
  virtual const char* GetWidgetKind() const { return "Widget"; }

  const QelString& GetName() const { return name_; }
  void SetName(const QelString& name) { name_ = name; }
  // The parent, without a reference; null for a root or once the parent is gone.
  QelVidWidget* GetParent() const;

  // Children in order; adding one that has another parent moves it.
  int GetChildCount() const { return static_cast<int>(children_.size()); }
  QelVidWidget* GetChild(int index) const;
  void AddChild(QelVidWidget* child);
  // False when `child` is not a child of this widget.
  bool RemoveChild(QelVidWidget* child);
  // The first descendant (depth first, this widget excluded) with that name.
  QelVidWidget* FindDescendant(const std::string& name) const;

  void SetVisibleFlag(int visible) { SetAttribute("visible", visible ? 1 : 0); }
  int GetVisibleFlag() const { return IntAttribute("visible", 1); }
  // Whether a hidden widget still takes its room in a layout.
  void SetLayoutWhenUnvisibleFlag(int flag) { layoutWhenUnvisible_ = flag != 0; }
  int GetLayoutWhenUnvisibleFlag() const { return layoutWhenUnvisible_ ? 1 : 0; }
  bool TakesRoom() const { return GetVisibleFlag() || layoutWhenUnvisible_; }
  void SetEnabled(int enabled) { SetAttribute("enabled", enabled ? 1 : 0); }
  int IsEnabled() const { return IntAttribute("enabled", 1); }
  void SetMinimumDimension(const QelVidPoint& size) { minimum_ = size; }
  const QelVidPoint& GetMinimumDimension() const { return minimum_; }

  // Attributes: what a style sets or binds. Kinds react to theirs in OnAttributeChanged.
  void SetAttribute(const std::string& name, const QelSYPValue& value);
  // The same by the name's one copy (QelVidAttributeName), as a compiled style binds.
  void SetAttribute(const std::string* name, const QelSYPValue& value);
  // A new part's attributes from its template, with room for `more` (its bindings). Each
  // is announced as SetAttribute would; the names are distinct.
  void InitAttributes(const std::vector<QelVidAttribute>& initial, size_t more);
  QelSYPValue GetAttribute(const std::string& name) const;
  int IntAttribute(const std::string& name, int fallback) const;
  QelUnicodeString TextAttribute(const std::string& name) const;
  // In order of first setting.
  const QelVidAttributeList& GetAttributes() const { return attributes_; }

  // The resource name of the class at `level` (0: the class itself, 1: its base ...).
  virtual QelString GetResourceFilename(int level) const;

  // Events.
  static QelSYPEventFactory* GetEventFactory();
  static QelSYPEvent* MouseEnterEvent();
  static QelSYPEvent* MouseLeaveEvent();
  // The event a style may route by this name ("MouseEnter", "Clicked" ...), or null.
  virtual QelSYPEvent* FindEvent(const std::string& name) const;
  // Connects a handler (the widget takes a reference). 1, or 0 for a null event or handler.
  int AddHandler(QelSYPEvent* event, QelSYPEventHandler* handler, int flags);
  int RemoveHandler(QelSYPEvent* event, QelSYPEventHandler* handler);
  int CountHandlers(QelSYPEvent* event) const;
  // Calls this widget's handlers of the arguments' event, in order of connection, then,
  // when the event propagates, each ancestor's. False for null arguments or event.
  bool Dispatch(QelSYPEventArgs* args);
  // Raises `event` from this widget with itself as origin.
  bool Raise(QelSYPEvent* event);

  // A person's pointer entering or leaving the widget.
  void MouseEnter() { Raise(MouseEnterEvent()); }
  void MouseLeave() { Raise(MouseLeaveEvent()); }

  // QelISYPIntrospectable: the table of the object's class, found by its class name.
  const QelSYPMetaClass* GetSYPMetaClass() const override;
  void DispatchModifyProperty(const char* propertyName) override;

 protected:
  ~QelVidWidget() override;
  void* QueryDirect(const QelIID& iid) override;
  // Detaches every child at once, handing them over in order: a layout giving up all its
  // widgets must not pay a search per widget.
  std::vector<QelVar<QelVidWidget>> TakeChildren();
  void ReserveChildren(size_t count) { children_.reserve(count); }
  virtual void OnAttributeChanged(const std::string&) {}

 private:
  struct Connection {
    QelSYPEvent* event = nullptr;
    QelVar<QelSYPEventHandler> handler;
  };
  // In order of connection: the widget's own slots first, then the overflow.
  template <class Visit>
  void ForEachConnection(Visit&& visit) const {
    for (size_t i = 0; i < ownConnectionCount_; ++i) visit(ownConnections_[i]);
    for (const Connection& c : moreConnections_) visit(c);
  }

  QelString name_;
  // The parent: the widget that lists this one among its children, or the one named at
  // construction. An owner clears the link when it lets its children go, so a raw
  // pointer is enough and a row of parts costs no weak flags; a parent only named is
  // linked weakly, as it may go first.
  QelVidWidget* parentWidget_ = nullptr;
  QelBaseUnknown_WR namedParent_;
  bool ownedByParent_ = false;
  std::vector<QelVar<QelVidWidget>> children_;
  // A few per widget: a flat list is cheaper to build than a tree.
  QelVidAttributeList attributes_;
  // A styled part has one or two handlers: those live in the widget, without a list of
  // their own.
  static constexpr size_t kOwnConnections = 2;
  Connection ownConnections_[kOwnConnections];
  size_t ownConnectionCount_ = 0;
  std::vector<Connection> moreConnections_;
  QelVidPoint minimum_;
  bool layoutWhenUnvisible_ = true;
  void Unlink() {
    parentWidget_ = nullptr;
    ownedByParent_ = false;
  }
};
