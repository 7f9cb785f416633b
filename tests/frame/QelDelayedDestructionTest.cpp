#include "QelDelayedDestruction.h"

#include "FrameTestFixture.h"

namespace {

// Asks, from its destructor, for the delayed destruction of the object it holds, as a
// panel does for its dialog.
class Chained : public QelBaseUnknown {
 public:
  explicit Chained(QelBaseUnknown* next) : next_(next) {}

 protected:
  ~Chained() override { QelDelayedDestruction::Request(next_.get()); }

 private:
  QelBaseUnknown_var next_;
};

using DelayedDestructionTest = FrameTest;

TEST_F(DelayedDestructionTest, ObjectLivesUntilTheIdleFlushNotBefore) {
  auto object = NewObject();
  QelBaseUnknown_WR weak(object.get());
  QelDelayedDestruction::Request(object.get());
  object = nullptr;
  EXPECT_TRUE(weak.IsAlive()) << "the queue holds it";
  EXPECT_EQ(QelDelayedDestruction::PendingCount(), 1);
  EXPECT_EQ(QelDelayedDestruction::FlushIdle(), 1);
  EXPECT_FALSE(weak.IsAlive());
  EXPECT_EQ(QelDelayedDestruction::FlushIdle(), 0);
  QelDelayedDestruction::Request(nullptr);
  EXPECT_EQ(QelDelayedDestruction::PendingCount(), 0);
}

TEST_F(DelayedDestructionTest, AnObjectStillHeldElsewhereOnlyLosesTheQueuesReference) {
  auto object = NewObject();
  QelDelayedDestruction::Request(object.get());
  QelDelayedDestruction::FlushIdle();
  QelBaseUnknown_WR weak(object.get());
  EXPECT_TRUE(weak.IsAlive());
}

TEST_F(DelayedDestructionTest, RequestsMadeDuringAFlushWaitForTheNextOne) {
  auto inner = NewObject();
  QelBaseUnknown_WR innerWeak(inner.get());
  auto outer = QelBaseUnknown_var::Adopt(new Chained(inner.get()));
  QelBaseUnknown_WR outerWeak(outer.get());
  inner = nullptr;
  QelDelayedDestruction::Request(outer.get());
  outer = nullptr;

  EXPECT_EQ(QelDelayedDestruction::FlushIdle(), 1);
  EXPECT_FALSE(outerWeak.IsAlive());
  EXPECT_TRUE(innerWeak.IsAlive()) << "requested by a destructor inside the flush";
  EXPECT_EQ(QelDelayedDestruction::FlushIdle(), 1);
  EXPECT_FALSE(innerWeak.IsAlive());
}

}  // namespace
