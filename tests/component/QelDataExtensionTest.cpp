// Data extensions: created on the first query of one of their interfaces on an object of
// their late type, shared by later queries, and gone with the object.
#include <gtest/gtest.h>

#include "QelBaseUnknown_WR.h"
#include "TestObjects.h"

namespace {

int g_extensionsCreated = 0;

// Extends objects of the late type "TestLateDog" with ITestGreeter (directly) and
// ITestCounter (through a tie).
class TestDogExtension : public ITestGreeter {
 public:
  static const QelMetaObject& MetaObject() {
    static const QelMetaObject& meta = QelMetaObject::Declare(
        "TestDogExtension", QelMetaKind::DataExtension, &QelBaseUnknown::MetaObject(), "Tests", {"TestLateDog"});
    return meta;
  }
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }
  static QelBaseUnknown* Create(QelBaseUnknown* extended) {
    ++g_extensionsCreated;
    return new TestDogExtension(extended);
  }
  std::string Greet() override {
    QelBaseUnknown_var dog = extended_.Get();
    return dog ? std::string("extension of ") + dog->IsA() : "orphan";
  }
  int count = 0;

 protected:
  explicit TestDogExtension(QelBaseUnknown* extended) : extended_(extended) {}
  ~TestDogExtension() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<ITestGreeter>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }

 private:
  QelBaseUnknown_WR extended_;
};

class TieCounterOfExtension final : public QelTie<ITestCounter> {
 public:
  using QelTie::QelTie;
  int Next() override { return ++Impl<TestDogExtension>()->count; }
};

QelBaseUnknown* DirectGreeter(QelBaseUnknown* impl) {
  impl->AddRef();
  return impl;
}

class DataExtensionTest : public ::testing::Test {
 protected:
  void SetUp() override {
    baseline_ = QelBaseUnknown::LiveObjectCount();
    g_extensionsCreated = 0;
    auto& dictionary = QelDictionary::Get();
    dictionary.RegisterExtension("TestLateDog", TestDogExtension::MetaObject(), &TestDogExtension::Create, "Tests");
    dictionary.Register("TestDogExtension", ITestCounter::IID, &QelCreateTie<TieCounterOfExtension>, "Tests");
    dictionary.Register("TestDogExtension", ITestGreeter::IID, &DirectGreeter, "Tests");
  }
  void TearDown() override {
    QelDictionary::Get().RemoveFramework("Tests");
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), baseline_);
  }
  int64_t baseline_ = 0;
};

TEST_F(DataExtensionTest, ExtensionIsCreatedOnceAndSharedByLaterQueries) {
  // An animal that is not of the late type gets no extension.
  auto cat = TestAnimal::Create("cat");
  QelVar<ITestCounter> none(cat.get());
  EXPECT_FALSE(none);
  EXPECT_EQ(g_extensionsCreated, 0);

  auto dog = TestDog::Create();
  EXPECT_EQ(g_extensionsCreated, 0) << "nothing is created before the first query";
  QelVar<ITestCounter> first(dog.get());
  QelVar<ITestCounter> second(dog.get());
  ASSERT_TRUE(first && second);
  EXPECT_EQ(g_extensionsCreated, 1);
  first->Next();
  EXPECT_EQ(second->Next(), 2) << "both ties must reach the same extension";
}

TEST_F(DataExtensionTest, ObjectOwnInterfacesWinOverItsExtensions) {
  auto dog = TestDog::Create();
  QelVar<ITestGreeter> greeter(dog.get());
  ASSERT_TRUE(greeter);
  EXPECT_EQ(greeter->Greet(), "I am dog");
  EXPECT_EQ(g_extensionsCreated, 0);
}

TEST_F(DataExtensionTest, ExtensionLivesAsLongAsItsObject) {
  QelBaseUnknown_WR extensionWeak;
  {
    auto dog = TestDog::Create();
    {
      QelVar<ITestCounter> counter(dog.get());
      extensionWeak = QelBaseUnknown_WR(counter);
    }
    EXPECT_TRUE(extensionWeak.IsAlive()) << "the object keeps its extension after the tie is dropped";
  }
  EXPECT_FALSE(extensionWeak.IsAlive());
}

TEST_F(DataExtensionTest, ExtensionHeldBeyondItsObjectSeesTheObjectGone) {
  QelVar<ITestCounter> counter;
  {
    auto dog = TestDog::Create();
    counter = QelVar<ITestCounter>(dog.get());
  }
  QelVar<ITestGreeter> greeter(counter.get());
  ASSERT_TRUE(greeter);
  EXPECT_EQ(greeter->Greet(), "orphan");
}

TEST_F(DataExtensionTest, ObjectInDestructionGetsNoNewExtension) {
  // A class that queries itself from its destructor, after its extensions are gone.
  class Queried : public TestDog {
   public:
    ~Queried() override {
      QelVar<ITestCounter> late(static_cast<QelBaseUnknown*>(this));
      found = static_cast<bool>(late);
    }
    bool found = true;
  };
  (new Queried)->Release();
  EXPECT_EQ(g_extensionsCreated, 0);
}

}  // namespace
