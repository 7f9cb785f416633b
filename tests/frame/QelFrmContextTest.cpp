#include "QelFrmContext.h"

#include <vector>

#include "FrameTestFixture.h"

namespace {

using ContextTest = FrameTest;

TEST_F(ContextTest, DuringASwitchTheNextWorkbenchIsTheOneBeingEntered) {
  QelFrmContext* context = QelFrmContext::GetContext();
  ASSERT_EQ(context, frame_->GetContext());
  std::vector<std::string> seen;
  auto subscriber = NewObject();
  frame_->AddCallback(frame_->GetDispatcher(), kQelAfrAccessChanged, subscriber.get(),
                      [&](QelBaseUnknown*, QelBaseUnknown* payload) {
                        EXPECT_EQ(payload, context);
                        seen.push_back(context->GetWorkbenchName().Str() + ">" + context->GetNextWorkbenchName().Str());
                      });
  EXPECT_EQ(context->SwitchWorkbench("TPSCfg"), S_OK);
  EXPECT_EQ(context->SwitchWorkbench("TPSCfg"), S_FALSE);
  EXPECT_EQ(context->GetWorkbenchName(), QelString("TPSCfg"));
  EXPECT_EQ(context->GetNextWorkbenchName(), QelString("TPSCfg"));
  EXPECT_EQ(seen, (std::vector<std::string>{"LumReview>TPSCfg"}));
  EXPECT_EQ(frame_->RemoveCallbacksOn(frame_->GetDispatcher(), subscriber.get(), kQelAfrAccessChanged), 1);
  context->SwitchWorkbench("GopLookoutWorkbench");
  EXPECT_EQ(seen.size(), 1u);
}

}  // namespace
