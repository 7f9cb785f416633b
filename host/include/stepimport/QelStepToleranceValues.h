#pragma once
// QelStepToleranceValues: the magnitude of each geometric tolerance of a STEP file, by the
// tolerance's name, read from the file's text. The translator drops a magnitude written as
// a complex measure instance (length measure and representation item together), which
// AP242 files commonly use; the importer takes the value from here when it is missing.
// A plain value; values are in millimetres, the unit of the imported model.
#include <string>
#include <string_view>
#include <unordered_map>

class QelStepToleranceValues {
 public:
  // Scans a whole file's text; entities it cannot make sense of are left out.
  static QelStepToleranceValues Scan(std::string_view text);

  // The magnitude of the first tolerance of that name, or false.
  bool Find(const std::string& name, double& value) const;
  size_t Size() const { return values_.size(); }

 private:
  std::unordered_map<std::string, double> values_;
};
