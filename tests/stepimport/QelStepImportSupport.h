#pragma once
// What the STEP import tests share: the NIST models' paths, an import that must succeed, a
// refusal that must leave nothing behind, and the model seen as the JSON model file it writes to (a tree the tests can search).
#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

#include <nlohmann/json.hpp>

#include "QelModelJsonWriter.h"
#include "QelStepImporter.h"

namespace QelStepTest {
inline const std::string kCtc01 = std::string(QEL_NIST_MODELS) + "/nist_ctc_01_asme1_ap242-e1.stp";
inline const std::string kFtc06 = std::string(QEL_NIST_MODELS) + "/nist_ftc_06_asme1_ap242-e2.stp";
inline const std::string kStc06 = std::string(QEL_NIST_MODELS) + "/nist_stc_06_asme1_ap242-e3.stp";

inline QelBaseUnknown_var Import(const std::string& path, std::vector<std::string>* notes = nullptr) {
  QelBaseUnknown_var root;
  std::string error;
  std::vector<std::string> lines;
  EXPECT_EQ(QelStepImporter::ImportFile(path, root, error, lines), S_OK) << error;
  if (notes) *notes = lines;
  return root;
}

// The refusal's message, after checking that nothing was made and the file is named.
inline std::string Refusal(const std::string& path) {
  const int64_t before = QelBaseUnknown::LiveObjectCount();
  QelBaseUnknown_var root;
  std::string error;
  std::vector<std::string> notes;
  EXPECT_EQ(QelStepImporter::ImportFile(path, root, error, notes), E_FAIL) << path;
  EXPECT_FALSE(root);
  EXPECT_EQ(error.rfind(path + ": ", 0), 0u) << error;
  EXPECT_EQ(QelBaseUnknown::LiveObjectCount(), before) << "half-imported objects left behind";
  return error;
}

inline nlohmann::json Dump(QelBaseUnknown* root) {
  std::ostringstream out;
  EXPECT_TRUE(QelModelJsonWriter::Write(root, out));
  return nlohmann::json::parse(out.str());
}
}  // namespace QelStepTest

#define QEL_REQUIRE_NIST_MODELS()                                                              \
  if (!QelStepImporter::IsStepFile(QelStepTest::kCtc01)) GTEST_SKIP() << "no NIST models in " \
                                                                      << QEL_NIST_MODELS
