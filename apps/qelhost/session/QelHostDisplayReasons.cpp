#include "QelHostDisplayReasons.h"

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <memory>

#include "QelIAlias.h"
#include "QelILumSet.h"
#include "QelINavigateObject.h"
#include "QelISetMember.h"
#include "QelITPS.h"
#include "QelListValQelUnicodeString.h"
#include "QelModelPrinter.h"
#include "QelRovFacetServices.h"

namespace QelHostDisplayReasons {
namespace {
using Row = QelHostPanelRow;

bool IsShown(QelBaseUnknown* object) { return QelRovFacetServices::IsDisplayEnabled(object) == S_OK; }

std::string Alias(QelBaseUnknown* object) {
  QelUnicodeString alias;
  if (QelVar<QelIAlias> named{object}) named->GetAlias(alias);
  return alias.Utf8();
}


std::string Lower(std::string text) {
  for (char& c : text) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  return text;
}

std::string Join(const std::string& parent, const std::string& label) {
  return parent.empty() ? label : parent + "/" + label;
}

const Row* Chosen(const Row& facet) {
  for (const Row& row : facet.children)
    if (row.kind == Row::Kind::Radio && row.state == 1) return &row;
  return nullptr;
}

// The choice a facet has after opening: its first radio that holds rows.
const Row* GroupChoice(const Row& facet) {
  for (const Row& row : facet.children)
    if (row.kind == Row::Kind::Radio && !row.children.empty()) return &row;
  return nullptr;
}

// What a facet's parts are called in the summary.
std::string Prefix(const Row& facet, const Row* chosen) {
  if (facet.label.find("Set") != std::string::npos) return "sets";
  if (facet.label.find("View") != std::string::npos) return "views";
  if (chosen && chosen->label.rfind("By ", 0) == 0) return Lower(chosen->label.substr(3)) + "s";
  return "annotations";
}

// A group's select-all row stands for its siblings, not for an object.
bool IsSelectAll(const Row& parent, size_t index) {
  return index == 0 && parent.children.size() > 1 && parent.children[0].children.empty() &&
         Lower(parent.children[0].label).rfind("select all", 0) == 0;
}

// The highest rows under `parent` that are not ticked: a whole unticked group is one.
void Unticked(const Row& parent, const std::string& path, std::vector<std::pair<const Row*, std::string>>& found) {
  for (size_t i = 0; i < parent.children.size(); ++i) {
    const Row& row = parent.children[i];
    if (IsSelectAll(parent, i) || !row.check) continue;
    const std::string at = Join(path, row.label);
    if (row.state == 0)
      found.emplace_back(&row, at);
    else if (row.state == 2)
      Unticked(row, at, found);
  }
}

const Row* FindFacet(const std::vector<Row>& rows, const char* word) {
  for (const Row& row : rows)
    if (row.kind == Row::Kind::Facet && row.label.find(word) != std::string::npos) return &row;
  return nullptr;
}

// Every row under `parent` labelled `label`, with its path.
void Labelled(const Row& parent, const std::string& path, const std::string& label,
              std::vector<std::pair<const Row*, std::string>>& found) {
  for (const Row& row : parent.children) {
    const std::string at = Join(path, row.label);
    if (row.label == label || (row.label.size() > label.size() + 1 &&
                               row.label.compare(row.label.size() - label.size(), label.size(), label) == 0 &&
                               row.label[row.label.size() - label.size() - 1] == '/'))
      found.emplace_back(&row, at);
    Labelled(row, at, label, found);
  }
}

std::string Number(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}

struct Range {
  std::string lower, upper;
  double low = 0, high = 0;
};

bool ReadRange(const Row& row, Range& range) {
  const std::string text = QelHostPanel::RangeInEffect(row);
  if (text.empty() || text == "off") return false;
  // "t = V" or "L op t op H", as RangeInEffect writes it.
  if (text.rfind("t = ", 0) == 0) {
    range.lower = "=";
    range.low = range.high = std::strtod(text.c_str() + 4, nullptr);
    return true;
  }
  char lower[4] = {}, upper[4] = {};
  if (std::sscanf(text.c_str(), "%lf %3s t %3s %lf", &range.low, lower, upper, &range.high) != 4) return false;
  range.lower = lower;
  range.upper = upper;
  return true;
}

bool InRange(const Range& range, double value) {
  if (range.lower == "=") return value == range.low;
  const bool low = range.lower == "<" ? value > range.low : value >= range.low;
  const bool high = range.upper == "<" ? value < range.high : value <= range.high;
  return low && high;
}

// Why the set is hidden, read off the set facet.
std::string SetReason(const std::vector<Row>& rows, QelBaseUnknown* set) {
  const std::string name = Alias(set);
  const std::string head = "its set \"" + name + "\" is hidden";
  const Row* facet = FindFacet(rows, "Set");
  const Row* chosen = facet ? Chosen(*facet) : nullptr;
  if (!chosen) return head;
  if (chosen->children.empty()) return head + ": the choice \"" + facet->label + "/" + chosen->label + "\" hides it";
  std::vector<std::pair<const Row*, std::string>> found;
  Labelled(*chosen, Join(facet->label, chosen->label), name, found);
  for (const auto& [row, path] : found)
    if (row->check && row->state == 0) return head + ": row \"" + path + "\" is not ticked";
  return head;
}
}  // namespace

std::string RowName(QelBaseUnknown* object) {
  if (QelVar<QelINavigateObject> navigate{object}) {
    std::unique_ptr<QelListValQelUnicodeString> names(navigate->GetIdentificators());
    if (names && names->Size() > 0 && !(*names)[1].IsEmpty()) return (*names)[1].Utf8();
  }
  return Alias(object);
}

std::string NameOf(QelBaseUnknown* object) {
  const std::string alias = Alias(object);
  if (alias.empty()) return "(no name)";
  if (!QelVar<QelITPS>(object)) return alias;
  const std::string row = RowName(object);
  return row == alias ? alias : alias + " (row: " + row + ")";
}

bool Why(QelBaseUnknown* root, QelDbrFraPanel* panel, const std::string& name, const std::string& capture,
         std::vector<std::string>& reasons, std::string& error) {
  reasons.clear();
  QelListValQelBaseUnknown_var found = QelModelPrinter::FindByAlias(root, name);
  QelBaseUnknown* object = found.Size() > 0 ? found[1].get() : nullptr;
  if (!object) {
    error = "the model has no object \"" + name + "\"";
    return false;
  }
  reasons = WhyNotDrawn(object, panel ? QelHostPanel::ReadRows(panel) : std::vector<Row>(), capture);
  return true;
}

std::vector<std::string> WhyNotDrawn(QelBaseUnknown* object, const std::vector<Row>& rows,
                                     const std::string& capture) {
  std::vector<std::string> reasons;
  const std::string name = Alias(object);
  if (QelVar<QelILumSet>(object)) {
    reasons.push_back(IsShown(object) ? "\"" + name + "\" is shown" : SetReason(rows, object));
    return reasons;
  }
  QelVar<QelISetMember> member{object};
  QelBaseUnknown_var set;
  if (member) member->GetOwner(set);
  const bool setShown = !set || IsShown(set.get());
  const bool shown = IsShown(object);
  if (setShown && shown) {
    reasons.push_back("\"" + name + "\" is drawn");
    return reasons;
  }
  if (!setShown) reasons.push_back(SetReason(rows, set.get()));
  if (shown) return reasons;

  const Row* types = FindFacet(rows, "Type");
  const Row* chosen = types ? Chosen(*types) : nullptr;
  if (chosen && !chosen->children.empty()) {
    std::vector<std::pair<const Row*, std::string>> standing;
    Labelled(*chosen, Join(types->label, chosen->label), RowName(object), standing);
    for (const auto& [row, path] : standing)
      if (row->check && row->state == 0) reasons.push_back("row \"" + path + "\" is not ticked");
  }
  QelVar<QelITPS> annotation{object};
  for (const Row& row : types ? types->children : std::vector<Row>()) {
    if (row.state != 1 || !annotation) continue;
    const std::string path = Join(types->label, row.label);
    if (row.kind == Row::Kind::CheckBox && row.children.empty()) {
      bool isDefault = true;
      annotation->IsDefaultAnnotation(isDefault);
      if (!isDefault) reasons.push_back("the switch \"" + path + "\" is on and it is not a default annotation");
    } else if (row.kind == Row::Kind::Range) {
      Range range;
      double value = 0;
      if (!ReadRange(row, range)) continue;
      if (annotation->GetToleranceValue(value) != S_OK)
        reasons.push_back("the range \"" + path + "\" (" + QelHostPanel::RangeInEffect(row) +
                          ") is on and it has no tolerance value");
      else if (!InRange(range, value))
        reasons.push_back("the range \"" + path + "\" (" + QelHostPanel::RangeInEffect(row) +
                          ") is on and its value " + Number(value) + " is outside");
    }
  }
  // The capture hid it first; the rows only read what it left.
  if (!capture.empty())
    reasons.insert(reasons.begin(), "the capture \"" + capture + "\" was activated and shows only what its view holds");
  if (reasons.empty()) reasons.push_back("it was hidden outside the panel; no row, switch or range hides it now");
  return reasons;
}

std::vector<Part> Summary(QelDbrFraPanel* panel) {
  return panel ? Summary(QelHostPanel::ReadRows(panel)) : std::vector<Part>();
}

std::vector<Part> Summary(const std::vector<Row>& rows) {
  std::vector<Part> parts;
  for (const Row& facet : rows) {
    if (facet.kind != Row::Kind::Facet) continue;
    const Row* chosen = Chosen(facet);
    const std::string prefix = Prefix(facet, chosen);
    if (chosen && chosen->children.empty() && Lower(chosen->label).rfind("all", 0) != 0) {
      const Row* back = GroupChoice(facet);
      parts.push_back({prefix + ": " + Lower(chosen->label), back ? Join(facet.label, back->label) : std::string()});
    } else if (chosen) {
      std::vector<std::pair<const Row*, std::string>> unticked;
      Unticked(*chosen, Join(facet.label, chosen->label), unticked);
      for (const auto& [row, path] : unticked) parts.push_back({prefix + ": no " + row->label, path});
    }
    for (const Row& row : facet.children) {
      if (row.state != 1) continue;
      const std::string path = Join(facet.label, row.label);
      if (row.kind == Row::Kind::Range)
        parts.push_back({QelHostPanel::RangeInEffect(row), path, true});
      else if (row.kind == Row::Kind::CheckBox && row.children.empty())
        parts.push_back({Lower(row.label), path, true});
    }
  }
  return parts;
}

std::string SummaryLine(const std::vector<Part>& parts) {
  constexpr int kNamed = 4;  // rows named per facet before "and N more"
  std::string line;
  std::string lastPrefix;
  int named = 0, more = 0;
  auto closeGroup = [&] {
    if (more > 0) line += " and " + std::to_string(more) + " more";
    named = more = 0;
  };
  for (const Part& part : parts) {
    // Parts of one facet share their prefix once: "kinds: no Datums, Welds".
    const size_t colon = part.text.find(": ");
    const std::string prefix = colon == std::string::npos ? std::string() : part.text.substr(0, colon);
    if (!prefix.empty() && prefix == lastPrefix) {
      std::string rest = part.text.substr(colon + 2);
      if (rest.rfind("no ", 0) == 0) rest = rest.substr(3);
      if (++named > kNamed)
        ++more;
      else
        line += ", " + rest;
      continue;
    }
    closeGroup();
    line += (line.empty() ? "" : " \u00b7 ") + part.text;
    lastPrefix = prefix;
    named = 1;
  }
  closeGroup();
  return line.empty() ? "no filter" : line;
}
}  // namespace QelHostDisplayReasons
