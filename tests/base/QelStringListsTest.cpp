#include <gtest/gtest.h>

#include "QelAssert.h"
#include "QelListValQelUnicodeString.h"
#include "QelSetValQelUnicodeString.h"

namespace {
TEST(QelListValQelUnicodeString, KeepsOrderAndDuplicatesAtOneBasedPositions) {
  QelListValQelUnicodeString list;
  list.Append("Set B");
  list.Append("Set A");
  list.Append("Set B");
  ASSERT_EQ(list.Size(), 3);
  EXPECT_EQ(list[1], QelUnicodeString("Set B"));
  EXPECT_EQ(list[2], QelUnicodeString("Set A"));
  EXPECT_EQ(list.Locate("Set B"), 1);
  EXPECT_EQ(list.Locate("Set C"), 0);
  list.RemovePosition(1);
  EXPECT_EQ(list.Locate("Set B"), 2);
  list.Append(list);
  EXPECT_EQ(list.Size(), 4);
  EXPECT_EQ(list[4], QelUnicodeString("Set B"));
  list.RemoveAll();
  EXPECT_EQ(list.Size(), 0);
}

TEST(QelListValQelUnicodeString, PositionOutOfRangeAssertsAndReadsEmpty) {
  QelAssertionCapture capture;
  QelListValQelUnicodeString list;
  list.Append("only");
  list[0] = "written into the stand-in";
  EXPECT_TRUE(list[2].IsEmpty());  // the earlier write did not stick
  list.RemovePosition(5);
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 3);
  EXPECT_EQ(list.Size(), 1);
  EXPECT_EQ(list[1], QelUnicodeString("only"));
}

TEST(QelSetValQelUnicodeString, KeepsDistinctTextsInCodePointOrder) {
  QelSetValQelUnicodeString set;
  EXPECT_TRUE(set.Add("Welds"));
  EXPECT_TRUE(set.Append("\xC3\x89paisseur"));  // "Épaisseur" sorts after ASCII letters
  EXPECT_TRUE(set.Add("Datums"));
  EXPECT_FALSE(set.Add("Welds"));
  ASSERT_EQ(set.Size(), 3);
  EXPECT_EQ(set[1], QelUnicodeString("Datums"));
  EXPECT_EQ(set[2], QelUnicodeString("Welds"));
  EXPECT_EQ(set.Locate("\xC3\x89paisseur"), 3);
  EXPECT_EQ(set.Locate("Notes"), 0);
  EXPECT_TRUE(set.Remove("Datums"));
  EXPECT_FALSE(set.Remove("Datums"));
  EXPECT_EQ(set.Locate("Welds"), 1);

  QelAssertionCapture capture;
  EXPECT_TRUE(set[3].IsEmpty());
  EXPECT_EQ(capture.Count(kQelAssertKindBool), 1);
}
}  // namespace
