// Counting, handles, weak references, ties, extensions and meta classes working together.
#include <gtest/gtest.h>

#include "QelAssert.h"
#include "QelBaseUnknown_WR.h"
#include "TestObjects.h"

namespace {

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
  auto animal = QelVar<TestAnimal>::Adopt(TestAnimal::Create("cat"));
  QelVar<ITestGreeter> greeter = animal.get();
  ASSERT_TRUE(greeter);
  EXPECT_EQ(greeter->Greet(), "I am cat");

  QelDictionary::Get().RemoveFramework("Tests");  // no tie for ITestCounter now
  QelVar<ITestCounter> counter = animal.get();
  EXPECT_FALSE(counter);
  QelVar<TestDog> notADog = animal.get();
  EXPECT_FALSE(notADog);
}

TEST_F(ComponentModelTest, WeakReferenceDiesWithItsObjectAndNeverKeepsItAlive) {
  QelBaseUnknown_WR weak;
  QelBaseUnknown_WR copy;
  {
    auto animal = QelVar<TestAnimal>::Adopt(TestAnimal::Create("cat"));
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
  auto animal = QelVar<TestAnimal>::Adopt(TestAnimal::Create("cat"));
  QelBaseUnknown_WR weak;
  {
    QelVar<ITestCounter> tie = animal.get();
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
    auto animal = QelVar<TestAnimal>::Adopt(TestAnimal::Create("cat"));
    weak = QelBaseUnknown_WR(animal);
    counter = animal.get();
  }
  ASSERT_TRUE(weak.IsAlive()) << "the tie must hold its implementation";
  EXPECT_EQ(counter->Next(), 1);
  EXPECT_EQ(counter->Next(), 2);

  // The tie answers the implementation's other interfaces and compares equal to it.
  QelVar<ITestGreeter> greeter = counter.get();
  ASSERT_TRUE(greeter);
  EXPECT_TRUE(counter->IsEqual(greeter.get()));
  EXPECT_STREQ(counter->IsA(), "TestAnimal");
  EXPECT_EQ(QelSysDynamicCast<TestAnimal>(counter.get()), QelSysDynamicCast<TestAnimal>(greeter.get()));

  greeter = nullptr;
  counter = nullptr;
  EXPECT_FALSE(weak.IsAlive());
}

TEST_F(ComponentModelTest, TieOfABaseClassServesDerivedClasses) {
  auto dog = QelVar<TestDog>::Adopt(TestDog::Create());
  QelVar<ITestCounter> counter = dog.get();
  ASSERT_TRUE(counter);
  EXPECT_EQ(counter->Next(), 1);
  EXPECT_EQ(dog->count, 1);
}

TEST_F(ComponentModelTest, IsAKindOfWalksTheBaseChain) {
  auto dog = QelVar<TestDog>::Adopt(TestDog::Create());
  EXPECT_STREQ(dog->IsA(), "TestDog");
  EXPECT_TRUE(dog->IsAKindOf("TestDog"));
  EXPECT_TRUE(dog->IsAKindOf("TestAnimal"));
  EXPECT_TRUE(dog->IsAKindOf("QelBaseUnknown"));
  EXPECT_FALSE(dog->IsAKindOf("TestCat"));
  EXPECT_FALSE(dog->IsAKindOf(nullptr));
  // Declared once: a second declaration hands back the same description.
  EXPECT_EQ(&QelMetaObject::Declare("TestDog", QelMetaKind::Implementation, nullptr, "Other"), &TestDog::MetaObject());
}

TEST_F(ComponentModelTest, BalancedAddRefAndReleaseInsideADestructorDeletesOnce) {
  // The count is held up during destruction: a balanced AddRef/Release there is harmless.
  class SelfTouching : public QelBaseUnknown {
   public:
    ~SelfTouching() override {
      AddRef();
      Release();
    }
  };
  QelAssertionCapture capture;
  (new SelfTouching)->Release();
  EXPECT_EQ(capture.Count(), 0);
}

TEST_F(ComponentModelTest, NamedComponentIsInstantiatedWithTheRequestedInterface) {
  QelDictionary::Get().RegisterNamedCreator(
      "TestZoo", []() -> QelBaseUnknown* { return TestAnimal::Create("zoo"); }, "Tests");
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
