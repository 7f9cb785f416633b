// What the importer refuses, and says, before and during translation: files that are not
// STEP, cut short, empty, without products or with broken data; a STEP file of another
// protocol opens without annotations and says so. Also the header and the tolerance
// magnitudes read from the file's text.
#include <BRepPrimAPI_MakeBox.hxx>
#include <STEPControl_Writer.hxx>

#include <fstream>
#include <iterator>

#include "QelStepFileHeader.h"
#include "QelStepImportSupport.h"
#include "QelStepToleranceValues.h"

using namespace QelStepTest;

namespace {
std::string Write(const std::string& name, const std::string& text) {
  const std::string path = ::testing::TempDir() + name;
  std::ofstream(path, std::ios::binary) << text;
  return path;
}

std::string Head(const std::string& path, size_t bytes) {
  std::ifstream in(path, std::ios::binary);
  std::string text(bytes, '\0');
  in.read(text.data(), static_cast<std::streamsize>(bytes));
  text.resize(static_cast<size_t>(in.gcount()));
  return text;
}

const std::string kAP242Header =
    "ISO-10303-21;\nHEADER;\nFILE_DESCRIPTION((''),'2;1');\nFILE_NAME('x','',(''),(''),'','','');\n"
    "FILE_SCHEMA(('AP242_MANAGED_MODEL_BASED_3D_ENGINEERING_MIM_LF { 1 0 10303 442 1 1 4 }'));\nENDSEC;\n";

}  // namespace

TEST(QelStepRefusalTest, EachKindOfBadFileIsRefusedWithItsReason) {
  EXPECT_NE(Refusal(Write("model.stp", R"({"format": "qel-product-model", "version": 1, "root": {"id": "r"}})"))
                .find("not a STEP file"),
            std::string::npos);
  EXPECT_NE(Refusal(Write("empty.stp", "")).find("the file is empty"), std::string::npos);
  EXPECT_NE(Refusal(::testing::TempDir() + "no-such-file.stp").find("cannot open"), std::string::npos);
  EXPECT_NE(Refusal(Write("nothing.stp", kAP242Header + "DATA;\nENDSEC;\nEND-ISO-10303-21;\n")).find("holds no product"),
            std::string::npos);
  EXPECT_NE(Refusal(Write("garbage.stp", kAP242Header + "DATA;\n#1=PRODUCT('a',,;\n((#2=;\nENDSEC;\nEND-ISO-10303-21;\n"))
                .find(": line 8, #1: the statement ends inside a list"),
            std::string::npos);
  QEL_REQUIRE_NIST_MODELS();
  EXPECT_NE(Refusal(Write("cut.stp", Head(kCtc01, 200000))).find("cut short"), std::string::npos);
}

TEST(QelStepRefusalTest, AnotherProtocolOpensWithItsShapeAndNoAnnotation) {
  STEPControl_Writer writer;
  ASSERT_EQ(writer.Transfer(BRepPrimAPI_MakeBox(10.0, 20.0, 30.0).Shape(), STEPControl_AsIs), IFSelect_RetDone);
  const std::string path = ::testing::TempDir() + "box-ap214.stp";
  ASSERT_EQ(writer.Write(path.c_str()), IFSelect_RetDone);
  std::vector<std::string> notes;
  QelBaseUnknown_var root = Import(path, &notes);
  ASSERT_TRUE(root);
  const nlohmann::json model = Dump(root.get());
  EXPECT_TRUE(model["sets"].empty());
  EXPECT_EQ(model["root"]["shape"]["triangles"]["faces"].size(), 12u) << "a box is two triangles a face";
  ASSERT_EQ(notes.size(), 1u);
  EXPECT_NE(notes[0].find("not AP242"), std::string::npos) << notes[0];
  EXPECT_EQ(notes[0].rfind(path, 0), 0u);
}

TEST(QelStepRefusalTest, HeaderTellsStepFilesAndTheirProtocol) {
  QelStepFileHeader h = QelStepFileHeader::Parse("\xEF\xBB\xBF  " + kAP242Header, "ENDSEC;\nend-iso-10303-21;\r\n");
  EXPECT_TRUE(h.isStep);
  EXPECT_TRUE(h.complete);
  EXPECT_TRUE(h.IsAP242());
  // Named by its object identifier only.
  h = QelStepFileHeader::Parse("ISO-10303-21;\nHEADER;\nFILE_SCHEMA(('MY_SCHEMA { 1 0 10303 442 3 1 4 }'));", "");
  EXPECT_TRUE(h.IsAP242());
  EXPECT_FALSE(h.complete);
  h = QelStepFileHeader::Parse("ISO-10303-21;\nFILE_SCHEMA(('AUTOMOTIVE_DESIGN','O''Brien'));", "END-ISO-10303-21;");
  EXPECT_EQ(h.schemas, (std::vector<std::string>{"AUTOMOTIVE_DESIGN", "O'Brien"}));
  EXPECT_FALSE(h.IsAP242());
  EXPECT_FALSE(QelStepFileHeader::Parse("{\"ISO-10303-21;\"}", "END-ISO-10303-21;").isStep);
}

TEST(QelStepRefusalTest, ToleranceMagnitudesComeInMillimetresByName) {
  const QelStepToleranceValues values = QelStepToleranceValues::Scan(
      "DATA;\n"
      "#1=FLATNESS_TOLERANCE('Flat;ness','',#2,#9);\n"
      "#2=(LENGTH_MEASURE_WITH_UNIT() MEASURE_REPRESENTATION_ITEM() MEASURE_WITH_UNIT(LENGTH_MEASURE(0.75),#3) "
      "REPRESENTATION_ITEM(''));\n"
      "#3=(LENGTH_UNIT() NAMED_UNIT(*) SI_UNIT(.MILLI.,.METRE.));\n"
      "#4=(GEOMETRIC_TOLERANCE('Pos ''1''',$,#5,#9) POSITION_TOLERANCE());\n"
      "#5=LENGTH_MEASURE_WITH_UNIT(LENGTH_MEASURE(0.01),#6);\n"
      "#6=(CONVERSION_BASED_UNIT('INCH',#7) LENGTH_UNIT() NAMED_UNIT(#8));\n"
      "#10=TOLERANCE_VALUE(#5,#2);\n"
      "#11=PLUS_MINUS_TOLERANCE(#10,#12);\n"
      "ENDSEC;\n");
  double value = 0.0;
  ASSERT_TRUE(values.Find("Flat;ness", value));
  EXPECT_DOUBLE_EQ(value, 0.75);
  ASSERT_TRUE(values.Find("Pos '1'", value));
  EXPECT_DOUBLE_EQ(value, 0.254);
  EXPECT_EQ(values.Size(), 2u) << "value and plus-minus tolerances have no magnitude of their own";
}
