// qelhost's command line: what it accepts and, above all, what it refuses and how it says so.
#include <gtest/gtest.h>

#include "QelHostOptions.h"

namespace {

bool Parse(std::vector<std::string> args, QelHostOptions& options, std::string& error) {
  return QelHostOptions::Parse(args, options, error);
}

TEST(QelHostOptionsTest, DisplayChangesKeepTheirOrderAndTheModelFileIsTaken) {
  QelHostOptions options;
  std::string error;
  ASSERT_TRUE(Parse({"--hide", "Datum A", "model.json", "--show", "Datum A", "--default-only", "--export-json", "out.json"},
                    options, error));
  EXPECT_EQ(options.modelPath, "model.json");
  EXPECT_EQ(options.exportJsonPath, "out.json") << "the export's file is not taken for the model";
  ASSERT_EQ(options.displayChanges.size(), 2u);
  EXPECT_FALSE(options.displayChanges[0].show);
  EXPECT_TRUE(options.displayChanges[1].show);
  EXPECT_TRUE(options.defaultOnly);
  EXPECT_EQ(options.modulePath, "libQelRovFacets.so");
}

TEST(QelHostOptionsTest, RefusalsNameTheArgument) {
  struct Case {
    std::vector<std::string> args;
    std::string mentions;
  } cases[] = {
      {{"--bogus"}, "'--bogus'"},
      {{"--hide"}, "'--hide' needs a value"},
      {{"a.json", "b.json"}, "'b.json'"},
      {{"--tolerance", "0.1"}, "'0.1'"},
      {{"--setting", "novalue"}, "'novalue'"},
      {{"--setting", "repo/"}, "'repo/'"},
      {{"--hide", "x", ""}, "model file name '' is empty"},
      {{"--module", ""}, "'--module'"},
      {{"--tolerance", "t<nan"}, "'t<nan'"},
      {{"--export-json"}, "'--export-json' needs a value"},
      {{"--export-json", "", "model.stp"}, "'--export-json'"},
  };
  for (const auto& c : cases) {
    QelHostOptions options;
    std::string error;
    EXPECT_FALSE(Parse(c.args, options, error)) << c.args[0];
    EXPECT_NE(error.find(c.mentions), std::string::npos) << error;
  }
}

TEST(QelHostOptionsTest, HelpAndVersionWinOverEverythingAfterThem) {
  QelHostOptions options;
  std::string error;
  ASSERT_TRUE(Parse({"--help", "--bogus"}, options, error));
  EXPECT_EQ(options.action, QelHostOptions::Action::Help);
  ASSERT_TRUE(Parse({"-V"}, options, error));
  EXPECT_EQ(options.action, QelHostOptions::Action::Version);
}

TEST(QelHostOptionsTest, ToleranceRangesBecomeTheFilterOperators) {
  struct Case {
    const char* text;
    QelPropertyOperator leftOp;
    std::optional<double> left;
    QelPropertyOperator rightOp;
    std::optional<double> right;
  } cases[] = {
      {"0.05<=t<0.2", QelPropertyOperatorGreaterOrEqual, 0.05, QelPropertyOperatorLess, 0.2},
      {"0.05 < t <= 0.2", QelPropertyOperatorGreater, 0.05, QelPropertyOperatorLessOrEqual, 0.2},
      {"t<=0.1", QelPropertyOperatorLessOrEqual, std::nullopt, QelPropertyOperatorLessOrEqual, 0.1},
      {"1e-2<t", QelPropertyOperatorGreater, 0.01, QelPropertyOperatorLessOrEqual, std::nullopt},
      {"t=0.05", QelPropertyOperatorEqual, 0.05, QelPropertyOperatorLessOrEqual, std::nullopt},
      {"0.05=t", QelPropertyOperatorEqual, 0.05, QelPropertyOperatorLessOrEqual, std::nullopt},
      {"any", QelPropertyOperatorLessOrEqual, std::nullopt, QelPropertyOperatorLessOrEqual, std::nullopt},
  };
  for (const auto& c : cases) {
    QelToleranceRange range;
    std::string error;
    ASSERT_TRUE(QelHostOptions::ParseToleranceRange(c.text, range, error)) << c.text << ": " << error;
    EXPECT_EQ(range.leftOp, c.leftOp) << c.text;
    EXPECT_EQ(range.left, c.left) << c.text;
    EXPECT_EQ(range.rightOp, c.rightOp) << c.text;
    EXPECT_EQ(range.right, c.right) << c.text;
  }
}

TEST(QelHostOptionsTest, MalformedToleranceRangesAreRefused) {
  for (const char* text : {"", "t", "0.1", "t<", "x<t", "0.1<t<", "t>0.1", "0.1<=t=0.2", "t=0.1<0.2", "0.1<t<0.2t",
                           "tt", "0.1<t<abc", "1e999<t", "t<nan", "nan<t", "t=inf", "-inf<=t<=inf",
                           "t<NAN(1)"}) {
    QelToleranceRange range;
    std::string error;
    EXPECT_FALSE(QelHostOptions::ParseToleranceRange(text, range, error)) << text;
    EXPECT_NE(error.find("--tolerance"), std::string::npos) << text;
  }
}

}  // namespace
