// What the importer reads of a file's presentation from its text: where each saved view's
// camera stands (its projection point is in the camera's own placement) and whether it
// clips, which annotations each view lists however its callouts are linked, each
// annotation's drawn lines placed by its annotation plane, and the unit of each dimension.
#include <gtest/gtest.h>

#include "QelStepDraughting.h"

namespace {
// One view 'V1' of a camera placed at (100, 0, 0) looking along -x, its projection point
// 10 along its own axis; it shows a tolerance (linked directly), a dimension (through its
// shape aspect) and a datum (through a shape aspect of its own on the datum's face).
const char* kFile =
    "DATA;\n"
    "#1=CARTESIAN_POINT('',(100.,0.,0.));\n"
    "#2=DIRECTION('',(-1.,0.,0.));\n"
    "#3=DIRECTION('',(0.,1.,0.));\n"
    "#4=AXIS2_PLACEMENT_3D('',#1,#2,#3);\n"
    "#5=CARTESIAN_POINT('',(0.,0.,10.));\n"
    "#6=VIEW_VOLUME(.PARALLEL.,#5,50.,5.,.F.,0.,.T.,.F.,#7);\n"
    "#8=CAMERA_MODEL_D3('V1',#4,#6);\n"
    "#9=(CHARACTERIZED_OBJECT(*,*) DRAUGHTING_MODEL() REPRESENTATION('V1',(#8,#40,#41,#42),#99));\n"
    "#10=FLATNESS_TOLERANCE('Flatness.1','',#11,#20);\n"
    "#20=SHAPE_ASPECT('','',#98,.T.);\n"
    "#21=SHAPE_ASPECT('','',#98,.T.);\n"
    "#22=DIMENSIONAL_SIZE(#21,'diameter');\n"
    "#23=DIMENSIONAL_SIZE(#24,'diameter');\n"
    "#25=(DATUM_FEATURE('Datum Feature.1','',#98,.T.) SHAPE_ASPECT('Datum Feature.1','',#98,.T.));\n"
    "#26=DATUM('','',#98,.F.,'A');\n"
    "#27=SHAPE_ASPECT_RELATIONSHIP('','',#25,#26);\n"
    "#28=SHAPE_ASPECT('','DATUM',#98,.T.);\n"
    "#29=GEOMETRIC_ITEM_SPECIFIC_USAGE('','',#25,#97,#96);\n"
    "#30=GEOMETRIC_ITEM_SPECIFIC_USAGE('','DATUM',#28,#97,(#96));\n"
    "#40=DRAUGHTING_CALLOUT('Flatness.1',(#50));\n"
    "#41=ANNOTATION_PLANE('Linear Size.1',(#60),#61,(#43));\n"
    "#43=DRAUGHTING_CALLOUT('Linear Size.1',(#51));\n"
    "#42=DRAUGHTING_CALLOUT('Datum.1',(#52));\n"
    "#44=DRAUGHTING_MODEL_ITEM_ASSOCIATION('','',#10,#9,#40);\n"
    "#45=DRAUGHTING_MODEL_ITEM_ASSOCIATION('','',#21,#9,#43);\n"
    "#46=DRAUGHTING_MODEL_ITEM_ASSOCIATION_WITH_PLACEHOLDER('','',#28,#9,#52,#53);\n"
    "#51=TESSELLATED_ANNOTATION_OCCURRENCE('',(#60),#54);\n"
    "#54=TESSELLATED_CURVE_SET('',#55,((1,2,3)));\n"
    "#55=COORDINATES_LIST('',3,((0.,0.,0.),(1.,0.,0.),(1.,2.,0.)));\n"
    "#61=PLANE('',#62);\n"
    "#62=AXIS2_PLACEMENT_3D('',#63,#64,#65);\n"
    "#63=CARTESIAN_POINT('',(5.,5.,5.));\n"
    "#64=DIRECTION('',(0.,0.,1.));\n"
    "#65=DIRECTION('',(0.,1.,0.));\n"
    "#70=(CONVERSION_BASED_UNIT('INCH',#71) LENGTH_UNIT() NAMED_UNIT(#72));\n"
    "#73=DIMENSIONAL_CHARACTERISTIC_REPRESENTATION(#23,#74);\n"
    "#74=SHAPE_DIMENSION_REPRESENTATION('',(#75),#99);\n"
    "#75=(LENGTH_MEASURE_WITH_UNIT() MEASURE_REPRESENTATION_ITEM() MEASURE_WITH_UNIT(LENGTH_MEASURE(0.5),#70) "
    "REPRESENTATION_ITEM('nominal value'));\n"
    "ENDSEC;\n";

void ExpectNear(const QelMathPoint& a, const QelMathPoint& b) { EXPECT_LT((a - b).Norm(), 1e-9) << a.x << " " << a.y << " " << a.z; }
}  // namespace

TEST(QelStepDraughtingTest, CameraStandsAtItsPlacementAndClipsOnlyWhereAsked) {
  const QelStepDraughting file = QelStepDraughting::Scan(kFile);
  const QelStepDraughting::Camera* camera = file.FindCamera("V1");
  ASSERT_TRUE(camera);
  // The projection point (0, 0, 10) of the placement: 10 along its axis -x from (100, 0, 0).
  ExpectNear(camera->eye, {90, 0, 0});
  EXPECT_FALSE(camera->frontClipping);
  EXPECT_TRUE(camera->backClipping);
  EXPECT_EQ(file.FindCamera("V2"), nullptr);
}

TEST(QelStepDraughtingTest, ViewListsItsCalloutsAnnotationsHoweverTheyAreLinked) {
  const QelStepDraughting file = QelStepDraughting::Scan(kFile);
  EXPECT_EQ(file.DimensionNames(), (std::vector<std::string>{"diameter", "diameter"}));
  EXPECT_EQ(file.DimensionScale(0), 1.0) << "no value of its own";
  EXPECT_EQ(file.DimensionScale(1), 25.4) << "its value is in inches";
  EXPECT_EQ(file.DimensionNominal(1), 0.5) << "as the file writes it";
  EXPECT_FALSE(file.DimensionNominal(0));
  // The dimension is the first of its name; the datum's callout names only a shape aspect
  // on the datum feature's face.
  EXPECT_EQ(file.FindCamera("V1")->shows, (std::vector<std::string>{"T:Flatness.1", "D:0", "A:A"}));
  // The dimension's lines are given in its annotation plane, placed at (5, 5, 5) with its
  // x along the model's y.
  const std::vector<QelModelSegment>& lines = file.Drawing("D:0");
  ASSERT_EQ(lines.size(), 2u);
  ExpectNear(lines[0].from, {5, 5, 5});
  ExpectNear(lines[0].to, {5, 6, 5});
  ExpectNear(lines[1].to, {3, 6, 5});
  EXPECT_TRUE(file.Drawing("T:Flatness.1").empty()) << "its occurrence is missing from the file";
}

TEST(QelStepDraughtingTest, DamagedPresentationEntitiesAreLeftOutWithoutHarm) {
  std::string text = kFile;
  for (const char* cut : {"#55=COORDINATES_LIST('',3,((0.,0.,0.),(1.,0.,0.),(1.,2.,0.)));",
                          "#54=TESSELLATED_CURVE_SET('',#55,((1,2,3)));", "#4=AXIS2_PLACEMENT_3D('',#1,#2,#3);"}) {
    const size_t at = text.find(cut);
    ASSERT_NE(at, std::string::npos);
    text.replace(at, std::string(cut).size(), std::string(cut).substr(0, std::string(cut).size() / 2));
  }
  text += "#200=TESSELLATED_CURVE_SET('',#201,((1,7,99,-3)));\n#201=COORDINATES_LIST('',1,((1.,2.)));\n";
  const QelStepDraughting file = QelStepDraughting::Scan(text);
  EXPECT_TRUE(file.Drawing("D:0").empty());
  EXPECT_EQ(QelStepDraughting::Scan("").DimensionScale(0), 1.0);
  EXPECT_EQ(QelStepDraughting::Scan("DATA;#1=CAMERA_MODEL_D3('X',#1,#1);#2=('").FindCamera("Y"), nullptr);
}
