// The annotation type facet: type and sub-type rows, the kind rows and their table, the
// choice a refresh or a rebuild leaves, the default-annotation switch under the choice
// of all annotations, and a catalog without a kind's key.
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "FacetModel.h"
#include "QelAssert.h"
#include "QelModelBuilder.h"
#include "QelMsgCatalog.h"
#include "QelRovFacetAnnotation.h"
#include "QelRovFacetPropertyGroup.h"

namespace {

enum { kAll = 1, kType, kCustom, kDefaultAnnot, kTolAnnot };

class TypeFacet : public ::testing::Test {
 protected:
  void SetUp() override {
    QelModelSetDesc setDesc;
    setDesc.alias = "S";
    QelBaseUnknown_var set = builder.AddSet(builder.Root(), setDesc);
    auto add = [&](const char* alias, const char* type, const char* subType, int code,
                   QelAnnotationVisu visu = QelAnnotationVisu::None) {
      QelModelAnnotationDesc desc;
      desc.alias = alias;
      desc.typeName = type;
      desc.subTypeName = subType;
      desc.typeCode = code;
      desc.visu = visu;
      desc.isDefault = alias[0] == 'A';
      desc.geometry = code == 13;
      return builder.AddAnnotation(set, desc);
    };
    a1 = add("A1", "Datum", "Simple", 3);
    add("A2", "Tol", "Flat", 5);
    add("B1", "Datum", "Simple", 3);
    add("B2", "Datum", "Target", 3);
    add("F1", "Note", "Flag", 4);
    add("X1", "Tol", "Odd", 11);
    add("T1", "Note", "Text", 9, QelAnnotationVisu::Text);
    add("D1", "Dim", "Distance", 6, QelAnnotationVisu::Dimension);
    b3 = add("B3", "Geo", "Face", 13);
    model = std::make_unique<FacetModel>(builder.Finish());
    facet = Make<QelRovFacetAnnotation>(model->group.get());
    model->group->SetFacets(model->other.get(), model->other.get(), facet.get(), model->filter.get());
    QelAssertionCapture capture;
    facet->Refresh();
    refreshReports = capture.Count();
    oddCodeReports = capture.Count(kQelAssertKindBool);
  }
  QelRovFacetProperty* At(int position) { return PropertyOf(facet.get(), position); }
  QelRovFacetPropertyGroup* GroupAt(int position) { return QelSysDynamicCast<QelRovFacetPropertyGroup>(At(position)); }
  std::vector<std::string> KindRows(int kind) {
    return ChildLabels(GroupAt(kCustom)->GetPropertyList()[kind].get());
  }
  std::vector<QelCheckState> Choices() {
    return {At(kAll)->GetCheckState(), At(kType)->GetCheckState(), At(kCustom)->GetCheckState()};
  }

  QelModelBuilder builder;
  QelBaseUnknown_var a1, b3;
  std::unique_ptr<FacetModel> model;
  QelVar<QelRovFacetAnnotation> facet;
  int refreshReports = 0;
  int oddCodeReports = 0;
};

TEST_F(TypeFacet, TypeRowsShareOneRowPerTypeAndSubTypeInOrderOfFirstAppearance) {
  EXPECT_EQ(ChildLabels(GroupAt(kType)), (std::vector<std::string>{"Datum", "Tol", "Note", "Geo"}));
  auto* datum = GroupAt(kType)->GetPropertyList()[1].get();
  EXPECT_EQ(ChildLabels(datum), (std::vector<std::string>{"Simple", "Target"}));
  auto* simple = QelSysDynamicCast<QelRovFacetProperty>(QelSysDynamicCast<QelRovFacetPropertyGroup>(datum)->GetPropertyList()[1].get());
  EXPECT_EQ(simple->CountItems(), 2);
  // Code 4 and the odd code appear by type; text and dimension objects nowhere.
  EXPECT_EQ(ChildLabels(GroupAt(kType)->GetPropertyList()[2].get()), (std::vector<std::string>{"Flat", "Odd"}));
  EXPECT_EQ(ChildLabels(GroupAt(kType)->GetPropertyList()[3].get()), (std::vector<std::string>{"Flag"}));
}

TEST_F(TypeFacet, KindRowsFollowTheCodeTableAndReportOnlyUnknownCodes) {
  EXPECT_EQ(KindRows(1), (std::vector<std::string>{"A1", "B1", "B2"}));
  EXPECT_EQ(KindRows(2), (std::vector<std::string>{"A2"}));
  EXPECT_TRUE(KindRows(3).empty());  // the dimension object is left out
  EXPECT_TRUE(KindRows(6).empty());  // the flag note (code 4) silently, the text object too
  EXPECT_EQ(KindRows(7), (std::vector<std::string>{"B3"}));
  EXPECT_EQ(refreshReports, 1);  // code 11 only
  EXPECT_EQ(oddCodeReports, 1);
  const int table[][2] = {{3, 1}, {5, 2}, {6, 3}, {7, 4}, {8, 5}, {9, 6}, {13, 7},
                          {4, 0}, {10, 0}, {11, 0}, {12, 0}, {2, 0}, {14, 0}, {-3, 0}};
  for (const auto& [code, kind] : table) EXPECT_EQ(QelRovFacetAnnotation::KindOfTypeCode(code), kind) << code;
  EXPECT_EQ(ChildLabels(GroupAt(kCustom)),
            (std::vector<std::string>{"Datums", "Geometric Tolerances", "Dimensions", "Roughness", "Welds", "Notes",
                                      "Annotated Geometries"}));
}

TEST_F(TypeFacet, RefreshChoosesByKindAndRebuildKeepsTheUsersChoice) {
  QelAssertionCapture capture;  // the odd type code, once per pass
  EXPECT_EQ(Choices(), (std::vector<QelCheckState>{Unchecked, Unchecked, Checked}));
  EXPECT_EQ(At(kType)->SetCheck(true), S_OK);  // type rows start unchecked: everything is hidden
  EXPECT_FALSE(Shown(a1));
  facet->Rebuild();
  EXPECT_EQ(Choices(), (std::vector<QelCheckState>{Unchecked, Checked, Unchecked}));
  EXPECT_EQ(GroupAt(kType)->GetPropertyList().Size(), 4);
  facet->Refresh();
  EXPECT_EQ(Choices(), (std::vector<QelCheckState>{Unchecked, Unchecked, Checked}));
}

TEST_F(TypeFacet, RefreshRenewsAnnotationRowsInPlaceInTheListedOrderWithStatesReadAgain) {
  auto* datums = QelSysDynamicCast<QelRovFacetPropertyGroup>(GroupAt(kCustom)->GetPropertyList()[1].get());
  auto rowAt = [&](int position) { return QelSysDynamicCast<QelRovFacetProperty>(datums->GetPropertyList()[position].get()); };
  QelRovFacetProperty* rows[] = {rowAt(1), rowAt(2), rowAt(3)};
  // Rows left in a state a new row would not have, and the previous order reversed, so
  // the rows must be found by annotation rather than by position.
  rows[0]->SetVisibleFlag(false);
  rows[0]->SetFlags(QelRovFacetProperty::FlagsRadio);
  rows[2]->SetCheckState(PartiallyChecked);
  auto& list = datums->GetPropertyList();
  QelListValQelBaseUnknown_var reversed;
  for (int position = list.Size(); position >= 1; --position) reversed.Append(list[position]);
  list = reversed;
  QelModelBuilder::SetShown(a1, false);
  QelAssertionCapture capture;
  facet->Refresh();
  EXPECT_EQ(capture.Count(), 1);  // the odd type code, as on the first pass
  ASSERT_EQ(datums->GetPropertyList().Size(), 3);
  for (int position = 1; position <= 3; ++position) EXPECT_EQ(rowAt(position), rows[position - 1]) << position;
  EXPECT_EQ(KindRows(1), (std::vector<std::string>{"A1", "B1", "B2"}));
  EXPECT_TRUE(rows[0]->GetVisibleFlag());
  EXPECT_EQ(rows[0]->GetFlags(), QelRovFacetProperty::FlagsCheckBox);
  EXPECT_EQ(rows[0]->GetCheckState(), Unchecked);
  EXPECT_EQ(rows[2]->GetCheckState(), Checked);
  QelUnicodeString icon;
  EXPECT_EQ(rows[1]->GetIconName(icon), S_OK);
  EXPECT_EQ(icon.Utf8().rfind("normal\\", 0), 0u);
}

TEST_F(TypeFacet, UntickingDefaultOnlyUnderAllShowsEveryAnnotationAgain) {
  EXPECT_EQ(At(kAll)->SetCheck(true), S_OK);
  EXPECT_EQ(At(kDefaultAnnot)->SetCheck(true), S_OK);
  EXPECT_TRUE(model->filter->DefaultAnnot);
  EXPECT_TRUE(Shown(a1));
  EXPECT_FALSE(Shown(b3));
  model->TakeChanges();
  EXPECT_EQ(At(kDefaultAnnot)->SetCheck(false), S_OK);
  EXPECT_FALSE(model->filter->DefaultAnnot);
  EXPECT_TRUE(Shown(b3));
  const auto changes = model->TakeChanges();
  EXPECT_NE(std::find(changes.begin(), changes.end(), "+B3"), changes.end());
  EXPECT_EQ(At(kAll)->GetCheckState(), Checked);
  EXPECT_EQ(model->other->refreshes, 3);  // the view facet, once per change
}

TEST_F(TypeFacet, TolerenceSwitchKeepsTheRangeAndReappliesTheKindChoice) {
  const double low = 0.1;
  model->filter->SetToleranceValues(QelPropertyOperatorLess, &low, QelPropertyOperatorLessOrEqual, nullptr);
  EXPECT_EQ(At(kTolAnnot)->SetCheck(true), S_OK);
  EXPECT_TRUE(model->filter->TolAnnot);
  QelPropertyOperator leftOp, rightOp;
  double *left = nullptr, *right = nullptr;
  model->filter->GetToleranceValues(leftOp, left, rightOp, right);
  ASSERT_TRUE(left);
  EXPECT_EQ(*left, low);
  EXPECT_EQ(leftOp, QelPropertyOperatorLess);
  EXPECT_EQ(right, nullptr);
  EXPECT_FALSE(Shown(a1));  // no tolerance value: outside every range
}

// Annotations that fall in no kind leave the seven kind groups empty: no fault to report.
TEST(TypeFacetKinds, AnnotationsOfNoKindLeaveTheKindGroupsEmptyWithoutReport) {
  QelModelBuilder builder;
  QelModelSetDesc setDesc;
  setDesc.alias = "S";
  QelBaseUnknown_var set = builder.AddSet(builder.Root(), setDesc);
  QelModelAnnotationDesc desc;
  desc.alias = "Flag";
  desc.typeName = "Note";
  desc.typeCode = 4;
  builder.AddAnnotation(set, desc);
  FacetModel model(builder.Finish());
  auto facet = Make<QelRovFacetAnnotation>(model.group.get());
  model.group->SetFacets(model.other.get(), model.other.get(), facet.get(), model.filter.get());
  QelAssertionCapture capture;
  facet->Refresh();
  EXPECT_EQ(capture.Count(), 0);
  auto* custom = QelSysDynamicCast<QelRovFacetPropertyGroup>(PropertyOf(facet.get(), kCustom));
  EXPECT_EQ(custom->CountItems(), 0);
  EXPECT_EQ(ChildLabels(PropertyOf(facet.get(), kType)), (std::vector<std::string>{"Note"}));
}

// The catalogs are read once per process, so the missing key is tried in a fresh one.
TEST(TypeFacetCatalog, MissingKindKeyGivesAnEmptyLabelAndOneReport) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_EXIT(
      {
        namespace fs = std::filesystem;
        const fs::path folder = fs::temp_directory_path() / ("qel-catalogs-" + std::to_string(::getpid()));
        fs::create_directories(folder / "catalogs");
        std::ifstream in(QelMsgCatalog::CatalogFolder() + "/QelTPSLightBase.qelcat");
        std::ofstream out(folder / "catalogs" / "QelTPSLightBase.qelcat");
        for (std::string line; std::getline(in, line);)
          if (line.find("SubNode.Notes") == std::string::npos) out << line << '\n';
        out.close();
        ::setenv("QEL_RESOURCES_DIR", folder.c_str(), 1);
        QelAssertionCapture capture;
        FacetModel model{QelBaseUnknown_var()};
        auto facet = Make<QelRovFacetAnnotation>(model.group.get());
        auto* custom = QelSysDynamicCast<QelRovFacetPropertyGroup>(PropertyOf(facet.get(), kCustom));
        const bool ok = capture.Count() == 1 && capture.Reports()[0].detail == "QelTPS.SubNode.Notes" &&
                        LabelOf(custom->GetPropertyList()[6].get()).empty() &&
                        LabelOf(custom->GetPropertyList()[5].get()) == "Welds";
        fs::remove_all(folder);
        std::exit(ok ? 0 : 1);
      },
      ::testing::ExitedWithCode(0), "");
}

}  // namespace
