// Dispatch: own handlers first, then the ancestors' for a propagating event; handlers
// changed during a dispatch; a widget removed and released while it dispatches.
#include <gtest/gtest.h>

#include <functional>

#include "QelSYPEventArgs.h"
#include "QelSYPEventFactory.h"
#include "QelSYPEventHandler.h"
#include "QelVidLayGrid.h"
#include "QelVidWidget.h"

namespace {
class Recorder final : public QelSYPEventHandler {
 public:
  explicit Recorder(std::function<void(QelVidWidget*)> onEvent) : onEvent_(std::move(onEvent)) {}
  void HandleEvent(QelVidWidget* current, QelBaseUnknown*) override { onEvent_(current); }

 private:
  ~Recorder() override = default;
  std::function<void(QelVidWidget*)> onEvent_;
};

QelSYPEvent* Bubbling() {
  return QelVidWidget::GetEventFactory()->NewEvent("TestBubbling", QelSYPEvent::Ancestors, "QelSYPEventArgs",
                                                   &QelVidWidget::MetaObject());
}
QelSYPEvent* LocalOnly() {
  return QelVidWidget::GetEventFactory()->NewEvent("TestLocal", QelSYPEvent::Local, "QelSYPEventArgs",
                                                   &QelVidWidget::MetaObject());
}

struct Tree {
  QelVar<QelVidWidget> root = QelMakeVar<QelVidWidget>(nullptr, QelString("root"));
  QelVar<QelVidLayGrid> grid = QelMakeVar<QelVidLayGrid>(nullptr, QelString("grid"));
  QelVar<QelVidWidget> leaf = QelMakeVar<QelVidWidget>(nullptr, QelString("leaf"));
  Tree() {
    root->AddChild(grid.get());
    grid->AddWidget(leaf.get(), {});
  }
};

void Connect(QelVidWidget* w, QelSYPEvent* e, std::function<void(QelVidWidget*)> f) {
  auto handler = QelMakeVar<Recorder>(std::move(f));
  EXPECT_EQ(w->AddHandler(e, handler.get(), 0), 1);
}
// Looks at its first child's parent from its own destructor, as a derived widget may.
class WatchfulOwner final : public QelVidWidget {
 public:
  WatchfulOwner(QelVidWidget** seen) : QelVidWidget(nullptr, QelString("owner")), seen_(seen) {}

 private:
  ~WatchfulOwner() override { *seen_ = GetChild(0)->GetParent(); }
  QelVidWidget** seen_;
};
}  // namespace

TEST(QelVidWidgetDispatch, ParentLinksEndWhenTheParentGoesEvenForChildrenHeldElsewhere) {
  QelVidWidget* seenWhileGoing = reinterpret_cast<QelVidWidget*>(1);
  auto owner = QelMakeVar<WatchfulOwner>(&seenWhileGoing);
  auto child = QelMakeVar<QelVidWidget>(nullptr, QelString("child"));
  owner->AddChild(child.get());
  EXPECT_EQ(child->GetParent(), owner.get());
  owner = nullptr;
  EXPECT_EQ(seenWhileGoing, nullptr);  // already during the owner's own destructor
  EXPECT_EQ(child->GetParent(), nullptr);

  // A parent only named at construction does not own the widget and may go first.
  auto named = QelMakeVar<QelVidWidget>(nullptr, QelString("named"));
  auto orphan = QelMakeVar<QelVidWidget>(named.get(), QelString("orphan"));
  EXPECT_EQ(orphan->GetParent(), named.get());
  named = nullptr;
  EXPECT_EQ(orphan->GetParent(), nullptr);
}

TEST(QelVidWidgetDispatch, PropagatingEventReachesOwnHandlersThenEachAncestor) {
  Tree t;
  std::vector<std::string> seen;
  for (QelVidWidget* w : {t.root.get(), static_cast<QelVidWidget*>(t.grid.get()), t.leaf.get()}) {
    Connect(w, Bubbling(), [&](QelVidWidget* at) { seen.push_back(at->GetName().Str() + "/b"); });
    Connect(w, LocalOnly(), [&](QelVidWidget* at) { seen.push_back(at->GetName().Str() + "/l"); });
  }
  EXPECT_TRUE(t.leaf->Raise(Bubbling()));
  EXPECT_TRUE(t.leaf->Raise(LocalOnly()));
  EXPECT_EQ(seen, (std::vector<std::string>{"leaf/b", "grid/b", "root/b", "leaf/l"}));
  EXPECT_EQ(QelVidWidget::GetEventFactory()->NewEvent("TestBubbling", QelSYPEvent::Local, "", &QelVidWidget::MetaObject()),
            Bubbling());
  EXPECT_FALSE(t.leaf->Dispatch(nullptr));
  EXPECT_EQ(t.leaf->AddHandler(nullptr, nullptr, 0), 0);
}

TEST(QelVidWidgetDispatch, HandlersAddedOrRemovedDuringDispatchWaitForTheNextOne) {
  Tree t;
  int late = 0, second = 0;
  auto lateHandler = QelMakeVar<Recorder>([&](QelVidWidget*) { ++late; });
  auto secondHandler = QelMakeVar<Recorder>([&](QelVidWidget*) { ++second; });
  Connect(t.leaf.get(), LocalOnly(), [&](QelVidWidget* at) {
    at->AddHandler(LocalOnly(), lateHandler.get(), 0);
    at->RemoveHandler(LocalOnly(), secondHandler.get());
  });
  t.leaf->AddHandler(LocalOnly(), secondHandler.get(), 0);
  t.leaf->Raise(LocalOnly());
  EXPECT_EQ(late, 0);
  EXPECT_EQ(second, 1);  // the pass had already taken it
  t.leaf->Raise(LocalOnly());
  EXPECT_EQ(late, 1);
  EXPECT_EQ(second, 1);
}

TEST(QelVidWidgetDispatch, WidgetRemovedAndReleasedDuringItsOwnDispatchLivesUntilItReturns) {
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  {
    Tree t;
    QelVidWidget* leaf = t.leaf.get();
    int calls = 0;
    // The first handler tears the leaf out of the tree and drops the last outside
    // reference; the second still runs on it, and the ancestors are still visited.
    Connect(leaf, Bubbling(), [&](QelVidWidget*) { t.grid->RemoveWidget(leaf); t.leaf = nullptr; });
    Connect(leaf, Bubbling(), [&](QelVidWidget* at) { calls += at->GetName().Str() == "leaf"; });
    Connect(t.grid.get(), Bubbling(), [&](QelVidWidget*) { ++calls; });
    EXPECT_TRUE(leaf->Raise(Bubbling()));
    EXPECT_EQ(calls, 2);
    EXPECT_EQ(t.grid->GetChildCount(), 0);
  }
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before);
}
