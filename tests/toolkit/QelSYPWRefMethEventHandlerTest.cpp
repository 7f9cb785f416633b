// The weak-reference handler: its checks and their texts, a receiver that is gone, a
// receiver kept alive by the handler during the call.
#include <gtest/gtest.h>

#include "ProbeControl.h"
#include "QelAssert.h"
#include "QelSYPEventFactory.h"
#include "QelSYPMetaClass.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelToolkitCheck.h"

namespace {
QelSYPEvent* Poke() {
  return QelVidWidget::GetEventFactory()->NewEvent("TestPoke", QelSYPEvent::Local, "QelSYPEventArgs",
                                                   &QelVidWidget::MetaObject());
}
using Handler = QelSYPWRefMethEventHandler<ProbeControl>;

// An extension-like receiver of the handler's own template type.
class ExtensionProbe final : public ProbeControl {
 public:
  explicit ExtensionProbe(QelBaseUnknown* impl) : impl_(impl) {}
  QelBaseUnknown* GetImpl() override { return impl_; }

 private:
  ~ExtensionProbe() override = default;
  QelBaseUnknown* impl_;
};
bool g_aliveAfterDrop = false;

// Drops the last reference held outside the handler from inside its own handler.
class Dropping final : public ProbeControl {
 public:
  void Drop(QelBaseUnknown*, QelSYPEventArgs*) {
    QelBaseUnknown_WR self(this);
    *owner = nullptr;
    g_aliveAfterDrop = self.IsAlive() && GetName().Str() == "probe";
  }
  QelVar<Dropping>* owner = nullptr;

 private:
  ~Dropping() override = default;
};
}  // namespace

TEST(QelSYPWRefMethEventHandler, ConnectRefusesMissingPiecesWithTheirNames) {
  QelAssertionCapture capture;
  auto support = QelMakeVar<QelVidWidget>(nullptr, QelString("support"));
  auto probe = QelMakeVar<ProbeControl>();
  EXPECT_EQ(Handler::Connect(nullptr, Poke(), probe.get(), &ProbeControl::OnPress), 0);
  EXPECT_EQ(Handler::Connect(support.get(), nullptr, probe.get(), &ProbeControl::OnPress), 0);
  EXPECT_EQ(Handler::Connect(support.get(), Poke(), nullptr, &ProbeControl::OnPress), 0);
  EXPECT_EQ(Handler::Connect(support.get(), Poke(), probe.get(), nullptr), 0);
  ASSERT_EQ(capture.Count(), 4);
  EXPECT_EQ(capture.Reports()[0].detail, "i_pSupport");
  EXPECT_EQ(capture.Reports()[1].detail, "i_pEvent");
  EXPECT_EQ(capture.Reports()[2].detail, "i_pObj");
  EXPECT_EQ(capture.Count(kQelTkCheckKindCondition, "i_pMemberFunc != NULL"), 1);
  EXPECT_EQ(support->CountHandlers(Poke()), 0);

  EXPECT_EQ(Handler::Connect(support.get(), Poke(), probe.get(), &ProbeControl::OnPress), 1);
  EXPECT_EQ(support->CountHandlers(Poke()), 1);
  support->Raise(Poke());
  ASSERT_EQ(probe->presses.size(), 1u);
  EXPECT_EQ(probe->presses[0], static_cast<QelBaseUnknown*>(support.get()));
}

TEST(QelSYPWRefMethEventHandler, ReceiverThatIsAnExtensionIsRefusedWithTheExplanation) {
  QelAssertionCapture capture;
  auto probe = QelMakeVar<ProbeControl>();
  auto extension = QelMakeVar<ExtensionProbe>(probe.get());
  auto handler = QelMakeVar<Handler>(extension.get(), &ProbeControl::OnPress);
  ASSERT_EQ(capture.Count(kQelTkCheckKindCondition, "i_pObj->GetImpl() == i_pObj"), 1);
  EXPECT_EQ(capture.Reports()[0].text.find("i_pObj may be an extension; referencing an extension with a weak-ref is "
                                           "not possible.") != std::string::npos,
            true);
  auto support = QelMakeVar<QelVidWidget>(nullptr, QelString("support"));
  support->AddHandler(Poke(), handler.get(), 0);
  support->Raise(Poke());
  EXPECT_TRUE(probe->presses.empty());
  EXPECT_TRUE(extension->presses.empty());
}

TEST(QelSYPWRefMethEventHandler, ReceiverGoneDoesNothingAndArgumentsMustBeEventArgs) {
  QelAssertionCapture capture;
  auto support = QelMakeVar<QelVidWidget>(nullptr, QelString("support"));
  auto probe = QelMakeVar<ProbeControl>();
  auto handler = QelMakeVar<Handler>(probe.get(), &ProbeControl::OnPress);
  support->AddHandler(Poke(), handler.get(), 0);
  handler->HandleEvent(support.get(), support.get());  // not event arguments
  EXPECT_EQ(capture.Count(kQelTkCheckKindPointer, "pArgs"), 1);
  EXPECT_TRUE(probe->presses.empty());
  probe = nullptr;
  EXPECT_TRUE(support->Raise(Poke()));
  EXPECT_EQ(capture.Count(), 1);
}

TEST(QelSYPWRefMethEventHandler, ReceiverDroppingItsLastReferenceInsideTheCallSurvivesIt) {
  auto support = QelMakeVar<QelVidWidget>(nullptr, QelString("support"));
  QelVar<Dropping> owner = QelMakeVar<Dropping>();
  Dropping* raw = owner.get();
  raw->owner = &owner;
  QelBaseUnknown_WR watch(raw);
  QelSYPWRefMethEventHandler<Dropping>::Connect(support.get(), Poke(), raw, &Dropping::Drop);
  g_aliveAfterDrop = false;
  support->Raise(Poke());
  EXPECT_TRUE(g_aliveAfterDrop);
  EXPECT_FALSE(watch.IsAlive());
}

TEST(QelSYPWRefMethEventHandler, MetaClassFactoryRefusesNoObjectAndAnObjectOfAnotherClass) {
  QelAssertionCapture capture;
  const QelSYPMetaClass* meta = QelSYPMetaClass::Find("ProbeControl");
  ASSERT_NE(meta, nullptr);
  EXPECT_EQ(meta->CreateHandler(nullptr, "OnPress"), nullptr);
  auto other = QelMakeVar<QelVidWidget>(nullptr, QelString("other"));
  EXPECT_EQ(meta->CreateHandler(other.get(), "OnPress"), nullptr);
  EXPECT_EQ(capture.Count(kQelTkCheckKindPointer, "i_pObj"), 1);
  EXPECT_EQ(capture.Count(kQelTkCheckKindPointer, "pObj"), 1);
}
