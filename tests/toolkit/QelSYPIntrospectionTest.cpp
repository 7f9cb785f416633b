// Introspection: builders found by name, properties read and written by name, change
// notifications reaching the bound parts, the check on a foreign implementation.
#include <gtest/gtest.h>

#include "ProbeControl.h"
#include "QelAssert.h"
#include "QelBoxingOfQelVidColor.h"
#include "QelISYPIntrospectable.h"
#include "QelSYPMetaClass.h"
#include "QelSYPMetaClassBuilder.h"
#include "QelToolkitCheck.h"
#include "QelVidColor.h"

namespace {
// Answers the interface but is no toolkit widget.
class ForeignIntrospectable final : public QelISYPIntrospectable {
 public:
  const QelSYPMetaClass* GetSYPMetaClass() const override { return nullptr; }
  void DispatchModifyProperty(const char*) override { ++dispatched; }
  int dispatched = 0;

 protected:
  ~ForeignIntrospectable() override = default;
  void* QueryDirect(const QelIID& iid) override {
    if (void* mine = QelQueryDirect<QelISYPIntrospectable>(this, iid)) return mine;
    return QelBaseUnknown::QueryDirect(iid);
  }
};
}  // namespace

TEST(QelSYPIntrospection, BuilderMakesTheTableOnceWithTypedPropertiesAndHandlers) {
  const QelSYPMetaClass* meta = QelSYPMetaClass::Find("ProbeControl");
  ASSERT_NE(meta, nullptr);
  EXPECT_EQ(QelSYPMetaClass::Find("ProbeControl"), meta);
  EXPECT_EQ(meta->GetBase(), QelSYPMetaClass::Find("QelVidCtl"));
  EXPECT_EQ(meta->FindProperty("Shade")->type, "QelVidColor");
  EXPECT_TRUE(meta->FindProperty("Title")->readOnly);
  EXPECT_FALSE(meta->FindProperty("Flag")->readOnly);
  EXPECT_NE(meta->FindHandler("OnEnter"), nullptr);
  EXPECT_EQ(QelSYPMetaClass::Find("NoSuchClass"), nullptr);

  auto probe = QelMakeVar<ProbeControl>();
  EXPECT_EQ(probe->GetSYPMetaClass(), meta);
  QelSYPValue value;
  ASSERT_TRUE(meta->GetProperty(probe.get(), "Shade", value));
  EXPECT_EQ(std::get<QelVidColor>(value), QelVidColor(1, 2, 3, 4));
  EXPECT_TRUE(meta->SetProperty(probe.get(), "Flag", 7));
  EXPECT_EQ(probe->flag, 7);
  EXPECT_FALSE(meta->SetProperty(probe.get(), "Title", QelUnicodeString("x")));  // read-only
  EXPECT_FALSE(meta->SetProperty(probe.get(), "Flag", QelUnicodeString("x")));  // wrong type
  EXPECT_FALSE(meta->GetProperty(probe.get(), "Missing", value));

  auto created = QelBaseUnknown_var::Adopt(meta->GetCreateFunction()());
  EXPECT_STREQ(created->IsA(), "ProbeControl");
}

TEST(QelSYPIntrospection, RemovingTheFrameworkForgetsItsBuildersAndTables) {
  auto creator = QelSYPMetaClassBuilder::FindCreator("ProbeControlSYPMetaClassBuilder");
  ASSERT_NE(creator, nullptr);
  QelSYPMetaClassBuilder::RemoveFramework("tests");
  EXPECT_EQ(QelSYPMetaClass::Find("ProbeControl"), nullptr);
  QelSYPMetaClassBuilder::Register("ProbeControlSYPMetaClassBuilder", creator, "tests");
  EXPECT_NE(QelSYPMetaClass::Find("ProbeControl"), nullptr);
}

TEST(QelSYPIntrospection, NotificationFromAForeignImplementationIsReportedAndNotDispatched) {
  QelAssertionCapture capture;
  auto foreign = QelMakeVar<ForeignIntrospectable>();
  QelSYPNotifyPropertyChange(foreign.get(), "Flag");
  EXPECT_EQ(foreign->dispatched, 0);
  EXPECT_EQ(capture.Count(kQelTkCheckKindCondition, "Bad Introspectable implementation!"), 1);

  auto plain = QelMakeVar<QelBoxedQelVidColor>(QelVidColor());  // answers no interface
  QelSYPNotifyPropertyChange(plain.get(), "Flag");
  EXPECT_EQ(capture.Count(), 1);
}

TEST(QelVidColor, PaletteColourBlendsTheFirstRoleTowardsTheSecond) {
  const QelVidColor plain(0.0, 150, QelVidPalette::Base, QelVidPalette::Text);
  const QelVidColor shaded(0.1, 150, QelVidPalette::Base, QelVidPalette::Text);
  EXPECT_EQ(plain, QelVidColor(255, 255, 255, 150));
  EXPECT_EQ(shaded, QelVidColor(230, 230, 230, 150));
  EXPECT_EQ(QelVidColor(300, -4, 12, 999), QelVidColor(255, 0, 12, 255));
  QelVidColor out;
  auto boxed = QelBaseUnknown_var::Adopt(QelBoxingOfQelVidColor::Box(shaded));
  ASSERT_TRUE(QelBoxingOfQelVidColor::Unbox(boxed.get(), out));
  EXPECT_EQ(out, shaded);
  EXPECT_FALSE(QelBoxingOfQelVidColor::Unbox(nullptr, out));
}
