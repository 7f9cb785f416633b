// The host's display-capture command: activating a capture shows exactly what its view
// holds, whichever set holds the rest, and what the panel hid before does not matter.
#include "BrowserFixture.h"
#include "QelDbrDisplayCaptureCommand.h"
#include "QelRovFacetServices.h"

namespace {
class DisplayCaptureTest : public BrowserFixture {
 protected:
  static bool Shown(const QelBaseUnknown_var& object) {
    return QelRovFacetServices::IsDisplayEnabled(object.get()) == S_OK;
  }
  static void Hide(const QelBaseUnknown_var& object) { QelRovFacetServices::EnableDisableDisplay(object.get(), 0, nullptr); }
};
}  // namespace

TEST_F(DisplayCaptureTest, ShowsExactlyItsViewWhateverWasHiddenAndWhicheverSetHoldsTheRest) {
  auto part = b_.AddProduct(b_.Root(), {.alias = "Part"});
  auto mine = b_.AddSet(part, {.alias = "Mine", .light = true});
  auto held = b_.AddAnnotation(mine, {.alias = "Held", .typeName = "Datum"});
  auto left = b_.AddAnnotation(mine, {.alias = "Left", .typeName = "Datum"});
  auto other = b_.AddSet(b_.Root(), {.alias = "Other"});
  auto theirs = b_.AddAnnotation(other, {.alias = "Theirs", .typeName = "Weld"});
  auto view = b_.AddView(mine, {.alias = "V", .elements = {held.get()}});
  auto capture = b_.AddCapture(mine, {.alias = "C", .view = view.get()});
  ShowModel();
  // The panel had unticked the datum and the whole set.
  Hide(held);
  Hide(mine);

  ASSERT_EQ(QelDbrDisplayCaptureCommand::Display(capture.get(), viewer_.get()), S_OK);
  EXPECT_TRUE(Shown(held));
  EXPECT_TRUE(Shown(mine)) << "the capture's set is shown with it";
  EXPECT_FALSE(Shown(left));
  EXPECT_FALSE(Shown(theirs)) << "another set's annotation stays drawn";
  EXPECT_TRUE(Shown(other)) << "other sets keep their own state";
  EXPECT_EQ(QelDbrDisplayCaptureCommand::Display(nullptr, viewer_.get()), E_FAIL);
}
