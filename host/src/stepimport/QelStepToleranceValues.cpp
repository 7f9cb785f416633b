#include "QelStepToleranceValues.h"

#include <cctype>
#include <cstdlib>
#include <string>
#include <vector>

#include "QelStepStatementIndex.h"

namespace {

// A quoted string starting at `at` (on the quote); moves `at` past it.
bool QuotedString(std::string_view s, size_t& at, std::string& value) {
  if (at >= s.size() || s[at] != '\'') return false;
  value.clear();
  for (++at; at < s.size(); ++at) {
    if (s[at] == '\'' && at + 1 < s.size() && s[at + 1] == '\'') {
      value += '\'';
      ++at;
    } else if (s[at] == '\'') {
      ++at;
      return true;
    } else {
      value += s[at];
    }
  }
  return false;
}

long Reference(std::string_view s, size_t& at) {
  while (at < s.size() && (s[at] == ',' || std::isspace(static_cast<unsigned char>(s[at])))) ++at;
  if (at >= s.size() || s[at] != '#') return -1;
  char* end = nullptr;
  const long id = std::strtol(s.data() + at + 1, &end, 10);
  at = static_cast<size_t>(end - s.data());
  return id;
}

// Millimetres per unit of a unit entity; 1 for what is not recognised.
double UnitScale(std::string_view unit) {
  std::string u(unit);
  for (char& c : u) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
  if (u.find("CONVERSION_BASED_UNIT('INCH'") != std::string::npos) return 25.4;
  if (u.find("CONVERSION_BASED_UNIT('FOOT'") != std::string::npos) return 304.8;
  if (u.find(".METRE.") != std::string::npos) {
    if (u.find(".MILLI.") != std::string::npos) return 1.0;
    if (u.find(".CENTI.") != std::string::npos) return 10.0;
    if (u.find(".MICRO.") != std::string::npos) return 0.001;
    if (u.find("SI_UNIT($") != std::string::npos) return 1000.0;
  }
  return 1.0;
}

// The value of a measure entity: "...MEASURE(<number>),#unit..." in a simple or complex instance.
bool Measure(std::string_view measure, const QelStepStatementIndex& statements, double& value) {
  const size_t key = measure.find("_MEASURE(");
  if (key == std::string_view::npos) return false;
  size_t at = key + 9;
  const std::string number(measure.substr(at, measure.find(')', at) - at));
  char* end = nullptr;
  value = std::strtod(number.c_str(), &end);
  if (end == number.c_str()) return false;
  at = measure.find(')', at);
  if (at == std::string_view::npos) return true;
  ++at;
  const long unit = Reference(measure, at);
  if (const std::string_view unitStatement = statements.At(unit); !unitStatement.empty()) value *= UnitScale(unitStatement);
  return true;
}
}  // namespace

QelStepToleranceValues QelStepToleranceValues::Scan(std::string_view text) {
  QelStepToleranceValues found;
  const QelStepStatementIndex statements(text);
  for (long id : statements.Order()) {
    const std::string_view statement = statements.At(id);
    // GEOMETRIC_TOLERANCE('name','description',#magnitude,#target) or one of its subtypes;
    // the value and plus-minus tolerances have no name and are not matched.
    const size_t key = statement.find("TOLERANCE('");
    if (key == std::string_view::npos) continue;
    size_t at = key + 10;
    std::string name, description;
    if (!QuotedString(statement, at, name)) continue;
    while (at < statement.size() && statement[at] != '\'' && statement[at] != '$') ++at;
    if (at < statement.size() && statement[at] == '$') ++at;
    else if (!QuotedString(statement, at, description)) continue;
    const long magnitude = Reference(statement, at);
    const std::string_view measure = statements.At(magnitude);
    double value = 0.0;
    if (!measure.empty() && Measure(measure, statements, value)) found.values_.emplace(name, value);
  }
  return found;
}

bool QelStepToleranceValues::Find(const std::string& name, double& value) const {
  auto it = values_.find(name);
  if (it == values_.end()) return false;
  value = it->second;
  return true;
}
