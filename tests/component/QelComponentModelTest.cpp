// Counting, handles, weak references, ties, extensions and meta classes working together.
#include <gtest/gtest.h>

#include <thread>

#include "QelAssert.h"
#include "QelBaseUnknown_WR.h"
#include "TestObjects.h"

namespace {

class FrameLikeObject : public QelBaseUnknown {
 protected:
  ~FrameLikeObject() override = default;
};

class ComponentModelTest : public ::testing::Test {
 protected:
  void SetUp() override {
    baseline_ = QelBaseUnknown::LiveObjectCount();
    QelDictionary::Get().Register("TestAnimal", ITestCounter::IID, &QelCreateTie<TieCounterOfAnimal>, "Tests");
  }
  void TearDown() override {
    QelDictionary::Get().RemoveFramework("Tests");
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), baseline_) << "objects leaked or kept alive by a cycle";
  }
  int64_t baseline_ = 0;
};

TEST_F(ComponentModelTest, InterfaceIdentifiersParseAndPrintBack) {
  constexpr QelIID id = QelIID::Parse("{27b4f7ee-22B2-4983-9C0E-E83B932B725B}");
  EXPECT_EQ(id.ToString(), "{27B4F7EE-22B2-4983-9C0E-E83B932B725B}");
  EXPECT_EQ(id.data1, 0x27B4F7EEu);
  EXPECT_EQ(id.data4[7], 0x5B);
  for (const char* bad : {"", "27B4F7EE-22B2-4983-9C0E-E83B932B725B", "{27B4F7EE-22B2-4983-9C0E-E83B932B725}",
                          "{27B4F7EE+22B2-4983-9C0E-E83B932B725B}", "{27B4F7EG-22B2-4983-9C0E-E83B932B725B}"})
    EXPECT_FALSE(QelIID::TryParse(bad)) << bad;
}

TEST_F(ComponentModelTest, HandleAssignmentQueriesAndIsNullWhenAbsent) {
  auto animal = TestAnimal::Create("cat");
  QelVar<ITestGreeter> greeter(animal.get());
  ASSERT_TRUE(greeter);
  EXPECT_EQ(greeter->Greet(), "I am cat");

  QelDictionary::Get().RemoveFramework("Tests");  // no tie for ITestCounter now
  QelVar<ITestCounter> counter(animal.get());
  EXPECT_FALSE(counter);
  QelVar<TestDog> notADog(animal.get());
  EXPECT_FALSE(notADog);
}

TEST_F(ComponentModelTest, WeakReferenceDiesWithItsObjectAndNeverKeepsItAlive) {
  QelBaseUnknown_WR weak;
  QelBaseUnknown_WR copy;
  {
    auto animal = TestAnimal::Create("cat");
    weak = QelBaseUnknown_WR(animal);
    copy = weak;
    ASSERT_TRUE(weak.IsAlive());
    EXPECT_EQ(weak.Get().get(), static_cast<QelBaseUnknown*>(animal.get()));
  }
  EXPECT_FALSE(weak.IsAlive());
  EXPECT_FALSE(copy.Get());
  weak.Reset();  // the flag outlives the object until the last weak reference goes
  EXPECT_FALSE(copy.IsAlive());
}

TEST_F(ComponentModelTest, WeakReferenceMadeFromATieFollowsTheImplementation) {
  auto animal = TestAnimal::Create("cat");
  QelBaseUnknown_WR weak;
  {
    QelVar<ITestCounter> tie(animal.get());
    ASSERT_TRUE(tie);
    weak = QelBaseUnknown_WR(tie);
  }  // the tie is gone, the animal is not
  ASSERT_TRUE(weak.IsAlive());
  EXPECT_EQ(weak.GetRaw(), static_cast<QelBaseUnknown*>(animal.get()));
}

TEST_F(ComponentModelTest, TieKeepsItsImplementationAliveAndReleasesIt) {
  QelBaseUnknown_WR weak;
  QelVar<ITestCounter> counter;
  {
    auto animal = TestAnimal::Create("cat");
    weak = QelBaseUnknown_WR(animal);
    counter = QelVar<ITestCounter>(animal.get());
  }
  ASSERT_TRUE(weak.IsAlive()) << "the tie must hold its implementation";
  EXPECT_EQ(counter->Next(), 1);
  EXPECT_EQ(counter->Next(), 2);

  // The tie answers the implementation's other interfaces and compares equal to it.
  QelVar<ITestGreeter> greeter(counter.get());
  ASSERT_TRUE(greeter);
  EXPECT_TRUE(counter->IsEqual(greeter.get()));
  EXPECT_STREQ(counter->IsA(), "TestAnimal");
  EXPECT_EQ(QelSysDynamicCast<TestAnimal>(counter.get()), QelSysDynamicCast<TestAnimal>(greeter.get()));

  greeter = nullptr;
  counter = nullptr;
  EXPECT_FALSE(weak.IsAlive());
}

TEST_F(ComponentModelTest, TieOfABaseClassServesDerivedClasses) {
  auto dog = TestDog::Create();
  QelVar<ITestCounter> counter(dog.get());
  ASSERT_TRUE(counter);
  EXPECT_EQ(counter->Next(), 1);
  EXPECT_EQ(dog->count, 1);
}

TEST_F(ComponentModelTest, IsAKindOfWalksTheBaseChain) {
  auto dog = TestDog::Create();
  EXPECT_STREQ(dog->IsA(), "TestDog");
  EXPECT_TRUE(dog->IsAKindOf("TestDog"));
  EXPECT_TRUE(dog->IsAKindOf("TestAnimal"));
  EXPECT_TRUE(dog->IsAKindOf("QelBaseUnknown"));
  EXPECT_FALSE(dog->IsAKindOf("TestCat"));
  EXPECT_FALSE(dog->IsAKindOf(nullptr));
  // Declared once: a second declaration hands back the same description.
  EXPECT_EQ(&QelMetaObject::Declare("TestDog", QelMetaKind::Implementation, nullptr, "Other"), &TestDog::MetaObject());
}

// A destructor may touch its object's count in balance; anything else is reported once the
// last destructor has run, and the object is still freed exactly once.
TEST_F(ComponentModelTest, DestructorsMustLeaveTheCountBalanced) {
  class Touching : public QelBaseUnknown {
   public:
    explicit Touching(int adds, int releases) : adds_(adds), releases_(releases) {}

   protected:
    ~Touching() override {
      for (int i = 0; i < adds_; ++i) AddRef();
      for (int i = 0; i < releases_; ++i) Release();
    }

   private:
    int adds_, releases_;
  };
  struct Case {
    int adds, releases;
    const char* report;
  };
  for (Case c : {Case{1, 1, nullptr}, Case{0, 1, "release past zero"}, Case{1, 0, "reference kept on a destroyed object"}}) {
    QelAssertionCapture capture;
    QelMakeVar<Touching>(c.adds, c.releases);
    EXPECT_EQ(capture.Count(), c.report ? 1 : 0) << c.adds << "/" << c.releases;
    if (c.report) {
      EXPECT_EQ(capture.Count(kQelAssertKindBool, c.report), 1);
    }
  }
}

// Ownership is explicit: a raw pointer never turns into a handle silently, and a handle
// that retains an object nobody adopted (the creation reference would leak) is reported.
TEST_F(ComponentModelTest, FirstReferenceIsAdoptedNeverRetained) {
  static_assert(!std::is_convertible_v<TestAnimal*, QelVar<TestAnimal>>);
  static_assert(!std::is_convertible_v<QelBaseUnknown*, QelBaseUnknown_var>);
  static_assert(!std::is_assignable_v<QelBaseUnknown_var&, QelBaseUnknown*>);
  static_assert(!std::is_destructible_v<TestAnimal> && !std::is_destructible_v<ITestGreeter>);
  {
    QelAssertionCapture capture;
    auto made = QelMakeVar<FrameLikeObject>();
    QelBaseUnknown_var copy = made;
    auto* raw = new FrameLikeObject;
    raw->Release();  // giving the first reference back is fine too
    EXPECT_EQ(capture.Count(), 0);
  }
  QelAssertionCapture capture;
  auto* orphan = new FrameLikeObject;
  {
    QelBaseUnknown_var leaking(orphan);  // adds a second reference; the first has no owner
    EXPECT_EQ(capture.Count(kQelAssertKindBool, "first reference not adopted"), 1);
  }
  orphan->Release();
}

#ifndef NDEBUG
TEST_F(ComponentModelTest, CountingOffTheOwningThreadIsReported) {
  auto made = QelMakeVar<FrameLikeObject>();
  QelAssertionCapture capture;
  std::thread([&] {
    QelBaseUnknown_var copy = made;  // a retain and a release on a worker thread
  }).join();
  EXPECT_EQ(capture.Count(kQelAssertKindBool, "counted object used off its owning thread"), 2);
  { QelBaseUnknown_var copy = made; }
  EXPECT_EQ(capture.Count(), 2) << "the owning thread itself is never reported";
}
#endif

// `cur = cur->next` must read the next node before the old one (which owns it) goes.
TEST_F(ComponentModelTest, AssigningAHandleFromWhatItHoldsKeepsTheSourceAlive) {
  class Node : public QelBaseUnknown {
   public:
    QelVar<Node> next;
    int value = 0;

   protected:
    ~Node() override = default;
  };
  QelVar<Node> head;
  for (int i = 3; i >= 1; --i) {
    auto node = QelMakeVar<Node>();
    node->value = i;
    node->next = head;
    head = node;
  }
  int sum = 0;
  for (QelVar<Node> cur = std::move(head); cur; cur = cur->next) sum += cur->value;
  EXPECT_EQ(sum, 6);  // and TearDown finds no node left behind
  QelVar<Node> self = QelMakeVar<Node>();
  self = self;  // self-assignment keeps the object
  ASSERT_TRUE(self);
  EXPECT_EQ(self->value, 0);
}

// An entry overridden by a second module belongs to that module from then on: unloading
// it must take the entry away, since its factory would point into a closed library.
TEST_F(ComponentModelTest, OverridingEntriesMoveToTheOverridingFramework) {
  QelDictionary& dictionary = QelDictionary::Get();
  QelNamedCreator zoo = []() -> QelBaseUnknown* { return TestAnimal::Create("zoo").Detach(); };
  QelExtensionCreator none = [](QelBaseUnknown*) -> QelBaseUnknown* { return nullptr; };
  const QelMetaObject& extension =
      QelMetaObject::Declare("TestOverriddenExtension", QelMetaKind::DataExtension, &QelBaseUnknown::MetaObject(), "First");
  for (const char* framework : {"First", "Second"}) {
    dictionary.Register("TestOverridden", ITestCounter::IID, &QelCreateTie<TieCounterOfAnimal>, framework);
    dictionary.RegisterExtension("TestOverridden", extension, none, framework);
    dictionary.RegisterNamedCreator("TestOverridden", zoo, framework);
  }
  dictionary.RemoveFramework("Second");
  EXPECT_EQ(dictionary.FindFactory("TestOverridden", ITestCounter::IID), nullptr);
  EXPECT_TRUE(dictionary.ExtensionsOf("TestOverridden").empty());
  EXPECT_EQ(dictionary.FindNamedCreator("TestOverridden"), nullptr);
  EXPECT_TRUE(dictionary.Describe("First").empty());
}

TEST_F(ComponentModelTest, NamedComponentIsInstantiatedWithTheRequestedInterface) {
  QelDictionary::Get().RegisterNamedCreator(
      "TestZoo", []() -> QelBaseUnknown* { return TestAnimal::Create("zoo").Detach(); }, "Tests");
  QelVar<ITestGreeter> greeter = QelInstantiateComponent<ITestGreeter>("TestZoo");
  ASSERT_TRUE(greeter);
  EXPECT_EQ(greeter->Greet(), "I am zoo");
  QelVar<ITestCounter> counter = QelInstantiateComponent<ITestCounter>("TestZoo");
  EXPECT_TRUE(counter);
  void* out = reinterpret_cast<void*>(1);
  EXPECT_EQ(QelInstantiateComponent("NoSuchComponent", ITestGreeter::IID, &out), E_FAIL);
  EXPECT_EQ(out, nullptr);
}

}  // namespace
