#include "QelUnicodeString.h"

#include <gtest/gtest.h>

#include <climits>

#include "QelString.h"

namespace {
// "Zoë ⌀12 𝄞": 1-, 2-, 3- and 4-byte characters.
const char* kMixed = "Zo\xC3\xAB \xE2\x8C\x80" "12 \xF0\x9D\x84\x9E";

TEST(QelUnicodeStringLength, CountsCodePointsNotBytes) {
  QelUnicodeString mixed(kMixed);
  EXPECT_EQ(mixed.Utf8().size(), 15u);
  EXPECT_EQ(mixed.GetLengthInChar(), 9);
  EXPECT_EQ(QelUnicodeString().GetLengthInChar(), 0);
  EXPECT_EQ(QelString(kMixed).GetLengthInChar(), 15);  // the 8-bit string counts bytes
}

TEST(QelUnicodeStringLength, InvalidBytesBecomeOneReplacementCharacterEach) {
  const std::string replacement = "\xEF\xBF\xBD";
  EXPECT_EQ(QelUnicodeString("a\xFF" "b").Utf8(), "a" + replacement + "b");
  EXPECT_EQ(QelUnicodeString("\xC0\xAF").GetLengthInChar(), 2);          // overlong '/'
  EXPECT_EQ(QelUnicodeString("\xED\xA0\x80").GetLengthInChar(), 3);      // surrogate
  EXPECT_EQ(QelUnicodeString("ok\xE2\x8C").Utf8(), "ok" + replacement + replacement);  // cut short
  EXPECT_TRUE(QelUnicodeString::IsValidUtf8(kMixed));
  EXPECT_FALSE(QelUnicodeString::IsValidUtf8("\xF4\x90\x80\x80"));  // above U+10FFFF
}

TEST(QelUnicodeStringSubString, WorksInCharacterPositions) {
  QelUnicodeString mixed(kMixed);
  EXPECT_EQ(mixed.SubString(2, 3).Utf8(), "\xC3\xAB \xE2\x8C\x80");
  EXPECT_EQ(mixed.SubString(8, 1).Utf8(), "\xF0\x9D\x84\x9E");
  EXPECT_EQ(mixed.SubString(4, -1).Utf8(), "\xE2\x8C\x80" "12 \xF0\x9D\x84\x9E");
  EXPECT_EQ(mixed.SubString(7, INT_MAX).GetLengthInChar(), 2);
  EXPECT_EQ(mixed.SubString(9, 3).Utf8(), "");
  EXPECT_EQ(mixed.SubString(10, 1).Utf8(), "");
  EXPECT_EQ(mixed.SubString(-1, 2).Utf8(), "");
  EXPECT_EQ(mixed.SubString(0, 0).Utf8(), "");
}

TEST(QelUnicodeStringSearch, AnswersCharacterPositionOrMinusOne) {
  QelUnicodeString text("\xC3\xA9t\xC3\xA9 \xC3\xA9t\xC3\xA9");  // "été été"
  EXPECT_EQ(text.SearchSubString("t"), 1);
  EXPECT_EQ(text.SearchSubString("t", 2), 5);
  EXPECT_EQ(text.SearchSubString("\xC3\xA9t\xC3\xA9", 1), 4);
  EXPECT_EQ(text.SearchSubString("x"), -1);
  EXPECT_EQ(text.SearchSubString("t", 6), -1);
  EXPECT_EQ(text.SearchSubString("t", -1), -1);
  EXPECT_EQ(text.SearchSubString("", 7), 7);
  EXPECT_EQ(text.SearchSubString("", 8), -1);
}

TEST(QelUnicodeStringBuildFromNum, FormatsOneNumberOfTheRightType) {
  QelUnicodeString text;
  text.BuildFromNum(1.5);
  EXPECT_EQ(text.Utf8(), "1.5");
  text.BuildFromNum(2.0 / 3.0, "Value: %6.2f mm");
  EXPECT_EQ(text.Utf8(), "Value:   0.67 mm");
  text.BuildFromNum(42);
  EXPECT_EQ(text.Utf8(), "42");
  text.BuildFromNum(255, "%%%04X");
  EXPECT_EQ(text.Utf8(), "%00FF");
  text.BuildFromNum(0.5, "%lf");  // 'l' has no effect on a double's conversion
  EXPECT_EQ(text.Utf8(), "0.500000");
  text.BuildFromNum(1e300, "%.400f");  // far longer than any fixed buffer
  EXPECT_EQ(text.GetLengthInChar(), 301 + 1 + 400);
}

TEST(QelUnicodeStringBuildFromNum, RefusedFormatLeavesTheTextEmpty) {
  for (const char* format : {"%d", "%s", "%f %f", "%*f", "%.*f", "no conversion", "%Lf", "%n", "%", "%1$f", "%.1025f", "%999999999f"}) {
    QelUnicodeString text("previous");
    text.BuildFromNum(1.5, format);
    EXPECT_TRUE(text.IsEmpty()) << format;
  }
  // A length modifier would make printf read a wider argument than the int passed.
  for (const char* format : {"%f", "%s", "%lld", "%hd", "%d%d", "%p", "%ld", "%lx", "%lu", "%li", "%zd", "%jd", "%1025d",
                             "%99999999999999999999999d"}) {
    QelUnicodeString text("previous");
    text.BuildFromNum(-1, format);
    EXPECT_TRUE(text.IsEmpty()) << format;
  }
  QelUnicodeString text("previous");
  text.BuildFromNum(1.5, nullptr);
  EXPECT_TRUE(text.IsEmpty());
}

TEST(QelUnicodeStringConvertToNum, ReadsOneWholeNumber) {
  double value = 0;
  EXPECT_EQ(QelUnicodeString("1.5").ConvertToNum(&value), 1);
  EXPECT_EQ(value, 1.5);
  EXPECT_EQ(QelUnicodeString("  -2.5e3 \t").ConvertToNum(&value, "%le"), 1);
  EXPECT_EQ(value, -2500.0);
  EXPECT_EQ(QelUnicodeString("x=0.25").ConvertToNum(&value, "x=%lf"), 1);
  EXPECT_EQ(value, 0.25);
  EXPECT_EQ(QelUnicodeString("12%").ConvertToNum(&value, "%lg%%"), 1);
  EXPECT_EQ(value, 12.0);
}

TEST(QelUnicodeStringConvertToNum, FailureAnswersZeroAndKeepsTheValue) {
  for (const char* text : {"", "   ", "abc", "1.5mm", "1.5 2.5", "1e999", "-1e999", "nan", "-inf", "INFINITY",
                           "nan(0x1)"}) {
    double value = 7;
    EXPECT_EQ(QelUnicodeString(text).ConvertToNum(&value, "%le"), 0) << text;
    EXPECT_EQ(value, 7) << text;
  }
  for (const char* format : {"%d", "%f", "%lf %lf", "%s", "value", "%Lf"}) {
    double value = 7;
    EXPECT_EQ(QelUnicodeString("3").ConvertToNum(&value, format), 0) << format;
    EXPECT_EQ(value, 7) << format;
  }
  EXPECT_EQ(QelUnicodeString(std::string_view("1\0x", 3)).ConvertToNum(nullptr), 0);
  double value = 7;
  EXPECT_EQ(QelUnicodeString(std::string_view("1\0x", 3)).ConvertToNum(&value), 0);
  EXPECT_EQ(QelUnicodeString("y=1").ConvertToNum(&value, "x=%lf"), 0);
}
}  // namespace
