#include <gtest/gtest.h>

#include "QelAssert.h"
#include "QelBaseUnknown_WR.h"
#include "QelListValQelBaseUnknown_var.h"
#include "TestObjects.h"

namespace {

class ListTest : public ::testing::Test {
 protected:
  void SetUp() override {
    baseline_ = QelBaseUnknown::LiveObjectCount();
    QelDictionary::Get().Register("TestAnimal", ITestCounter::IID, &QelCreateTie<TieCounterOfAnimal>, "Tests");
    a_ = TestAnimal::Create("a");
    b_ = TestAnimal::Create("b");
  }
  void TearDown() override {
    a_ = nullptr;
    b_ = nullptr;
    QelDictionary::Get().RemoveFramework("Tests");
    EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), baseline_);
  }
  int64_t baseline_ = 0;
  QelVar<TestAnimal> a_, b_;
};

TEST_F(ListTest, PositionsAreOneBasedAndOutOfRangeIsReported) {
  QelListValQelBaseUnknown_var list;
  list.Append(a_.get());
  list.Append(b_.get());
  ASSERT_EQ(list.Size(), 2);
  EXPECT_EQ(list[1].get(), static_cast<QelBaseUnknown*>(a_.get()));
  EXPECT_EQ(list[2].get(), static_cast<QelBaseUnknown*>(b_.get()));
  // Read only: an out-of-range answer is a shared null that nobody may write into.
  static_assert(std::is_const_v<std::remove_reference_t<decltype(list[1])>>);
  QelAssertionCapture capture;
  EXPECT_FALSE(list[0]);
  EXPECT_FALSE(list[3]);
  list.RemovePosition(5);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 3);
  EXPECT_EQ(list.Size(), 2);
}

TEST_F(ListTest, LocateAndRemoveTreatATieAsItsImplementation) {
  QelListValQelBaseUnknown_var list;
  list.Append(a_.get());
  list.Append(b_.get());
  QelVar<ITestCounter> tieOfB(b_.get());
  ASSERT_TRUE(tieOfB);
  EXPECT_EQ(list.Locate(tieOfB.get()), 2);
  EXPECT_EQ(list.Locate(nullptr), 0);
  EXPECT_EQ(list.RemoveValue(tieOfB.get()), 2);
  EXPECT_EQ(list.RemoveValue(tieOfB.get()), 0);
  EXPECT_EQ(list.Size(), 1);
}

TEST_F(ListTest, RemoveDuplicatesKeepsFirstOccurrencesInOrder) {
  QelListValQelBaseUnknown_var list;
  QelVar<ITestCounter> tieOfA(a_.get());
  list.Append(b_.get());
  list.Append(a_.get());
  list.Append(QelBaseUnknown_var());
  list.Append(tieOfA.get());
  list.Append(b_.get());
  list.Append(QelBaseUnknown_var());
  list.RemoveDuplicates();
  ASSERT_EQ(list.Size(), 3);
  EXPECT_EQ(list.Locate(b_.get()), 1);
  EXPECT_EQ(list.Locate(a_.get()), 2);
  EXPECT_FALSE(list[3]);
}

TEST_F(ListTest, ListHoldsItsEntries) {
  QelBaseUnknown_WR weak;
  QelListValQelBaseUnknown_var list;
  {
    auto c = TestAnimal::Create("c");
    weak = QelBaseUnknown_WR(c);
    list.Append(c.get());
  }
  EXPECT_TRUE(weak.IsAlive());
  list.RemoveAll();
  EXPECT_FALSE(weak.IsAlive());
}

}  // namespace
