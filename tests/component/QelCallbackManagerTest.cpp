// Callback lists must survive additions and removals made by the callbacks themselves.
#include <gtest/gtest.h>

#include <stdexcept>
#include <vector>

#include "QelAssert.h"
#include "QelCallbackManager.h"
#include "TestObjects.h"

namespace {

class CallbackManagerTest : public ::testing::Test {
 protected:
  void SetUp() override {
    baseline_ = QelBaseUnknown::LiveObjectCount();
    publisher_ = TestAnimal::Create("publisher");
    subscriber_ = TestAnimal::Create("subscriber");
  }
  void TearDown() override {
    manager_.RemoveCallbacksOn(nullptr, subscriber_.get());
    manager_.RemoveCallbacksOn(nullptr, nullptr);
    publisher_ = nullptr;
    subscriber_ = nullptr;
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), baseline_);
  }
  QelCallbackManager& manager_ = QelCallbackManager::Get();
  QelVar<TestAnimal> publisher_, subscriber_;
  std::vector<std::string> calls_;
  int64_t baseline_ = 0;
};

TEST_F(CallbackManagerTest, DispatchReachesOnlyTheNamedNotificationInOrder) {
  manager_.AddCallback(publisher_.get(), "A", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("a1"); });
  manager_.AddCallback(publisher_.get(), "B", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("b"); });
  manager_.AddCallback(publisher_.get(), "A", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("a2"); });
  manager_.Dispatch(publisher_.get(), "A");
  EXPECT_EQ(calls_, (std::vector<std::string>{"a1", "a2"}));
  EXPECT_EQ(manager_.CountCallbacks(publisher_.get(), "A"), 2);
}

TEST_F(CallbackManagerTest, CallbackRemovingItselfAndTheNextDuringDispatchIsSafe) {
  QelCallbackId first = 0, second = 0;
  first = manager_.AddCallback(publisher_.get(), "N", subscriber_.get(), [&](auto*, auto*) {
    calls_.push_back("first");
    EXPECT_TRUE(manager_.RemoveCallback(first));
    EXPECT_TRUE(manager_.RemoveCallback(second));
    manager_.AddCallback(publisher_.get(), "N", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("late"); });
  });
  second = manager_.AddCallback(publisher_.get(), "N", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("second"); });
  manager_.Dispatch(publisher_.get(), "N");
  EXPECT_EQ(calls_, std::vector<std::string>{"first"}) << "a removed callback is never called; an added one waits";
  manager_.Dispatch(publisher_.get(), "N");
  EXPECT_EQ(calls_, (std::vector<std::string>{"first", "late"}));
}

TEST_F(CallbackManagerTest, SubscriberThatDiedIsSkippedAndNotKeptAlive) {
  QelBaseUnknown_WR weak;
  {
    auto shortLived = TestAnimal::Create("short");
    weak = QelBaseUnknown_WR(shortLived);
    manager_.AddCallback(publisher_.get(), "N", shortLived.get(), [&](auto*, auto*) { calls_.push_back("dead"); });
  }
  EXPECT_FALSE(weak.IsAlive());
  manager_.Dispatch(publisher_.get(), "N");
  EXPECT_TRUE(calls_.empty());
  EXPECT_EQ(manager_.CountCallbacks(publisher_.get(), "N"), 0);
}

TEST_F(CallbackManagerTest, SubscriberRemovesItsCallbacksFromItsOwnDestructor) {
  // Weak references are already dead when a destructor runs; removal must still match.
  class Leaving : public TestAnimal {
   public:
    Leaving(QelBaseUnknown* publisher, int* removed) : TestAnimal("leaving"), removed_(removed) {
      QelCallbackManager::Get().AddCallback(publisher, "N", this, [](auto*, auto*) {});
    }
    ~Leaving() override { *removed_ = QelCallbackManager::Get().RemoveCallbacksOn(nullptr, this); }
    int* removed_;
  };
  int removed = 0;
  (new Leaving(publisher_.get(), &removed))->Release();
  EXPECT_EQ(removed, 1);
}

TEST_F(CallbackManagerTest, RemoveCallbacksOnSelectsBySubscriberAndName) {
  auto other = TestAnimal::Create("other");
  manager_.AddCallback(publisher_.get(), "A", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("sa"); });
  manager_.AddCallback(publisher_.get(), "B", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("sb"); });
  manager_.AddCallback(publisher_.get(), "A", other.get(), [&](auto*, auto*) { calls_.push_back("oa"); });
  EXPECT_EQ(manager_.RemoveCallbacksOn(publisher_.get(), subscriber_.get(), "A"), 1);
  manager_.Dispatch(publisher_.get(), "A");
  manager_.Dispatch(publisher_.get(), "B");
  EXPECT_EQ(calls_, (std::vector<std::string>{"oa", "sb"}));
  EXPECT_EQ(manager_.RemoveCallbacksOn(nullptr, other.get()), 1);
  EXPECT_FALSE(manager_.RemoveCallback(0));
}

TEST_F(CallbackManagerTest, PayloadAndPublisherReachTheCallback) {
  auto payload = TestAnimal::Create("payload");
  manager_.AddCallback(publisher_.get(), "N", nullptr, [&](QelBaseUnknown* from, QelBaseUnknown* what) {
    calls_.push_back(QelSysDynamicCast<TestAnimal>(from)->Greet() + "/" + QelSysDynamicCast<TestAnimal>(what)->Greet());
  });
  manager_.Dispatch(publisher_.get(), "N", payload.get());
  EXPECT_EQ(calls_, std::vector<std::string>{"I am publisher/I am payload"});
}

// A callback that throws ends the dispatch, not the bookkeeping: removals made afterwards
// are compacted as usual instead of piling up for good.
TEST_F(CallbackManagerTest, ThrowingCallbackLeavesTheListCompactable) {
  manager_.AddCallback(publisher_.get(), "A", subscriber_.get(), [](auto*, auto*) { throw std::runtime_error("boom"); });
  EXPECT_THROW(manager_.Dispatch(publisher_.get(), "A"), std::runtime_error);
  const size_t stored = manager_.StoredEntries();
  for (int i = 0; i < 100; ++i) {
    QelCallbackId id = manager_.AddCallback(publisher_.get(), "B", subscriber_.get(), [](auto*, auto*) {});
    manager_.RemoveCallback(id);
  }
  EXPECT_EQ(manager_.StoredEntries(), stored);
}

// The same function of the same subscriber for the same notification is one subscription;
// a second one is a mistake (it would be called twice) and is reported.
TEST_F(CallbackManagerTest, AddingTheSameCallbackTwiceIsReportedAndKeepsOne) {
  QelAssertionCapture capture;
  auto add = [&] { return manager_.AddCallback(publisher_.get(), "A", subscriber_.get(), [&](auto*, auto*) { calls_.push_back("a"); }); };
  const QelCallbackId first = add();
  EXPECT_EQ(add(), first);
  EXPECT_EQ(capture.Count(kQelAssertKindBool, "callback added twice"), 1);
  manager_.AddCallback(publisher_.get(), "A", publisher_.get(), [&](auto*, auto*) { calls_.push_back("p"); });
  manager_.Dispatch(publisher_.get(), "A");
  EXPECT_EQ(calls_, (std::vector<std::string>{"a", "p"}));
  EXPECT_EQ(capture.Count(), 1);
}

}  // namespace
