#include "QelVidWidgetPrinter.h"

#include <nlohmann/json.hpp>

#include "QelVidCtlButton.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidCtlExpander.h"
#include "QelVidCtlFrame.h"
#include "QelVidCtlImageAndLabelCombo.h"
#include "QelVidCtlLineEditor.h"
#include "QelVidLabel.h"
#include "QelVidLayGrid.h"
#include "QelVidSpacer.h"

namespace {
// The widgets that share a line with their neighbours in a row.
bool IsInline(QelVidWidget* w) {
  return dynamic_cast<QelVidLabel*>(w) || dynamic_cast<QelVidCtlButton*>(w) ||
         dynamic_cast<QelVidCtlCheckButton*>(w) || dynamic_cast<QelVidCtlImageAndLabelCombo*>(w) ||
         dynamic_cast<QelVidCtlLineEditor*>(w);
}

std::vector<QelVidWidget*> ChildrenInOrder(QelVidWidget* w) {
  if (auto* grid = dynamic_cast<QelVidLayGrid*>(w)) return grid->GetWidgetsInOrder();
  std::vector<QelVidWidget*> children;
  for (int i = 0; i < w->GetChildCount(); ++i) children.push_back(w->GetChild(i));
  return children;
}

std::string Inline(QelVidWidget* w) {
  if (!w || !w->GetVisibleFlag() || dynamic_cast<QelVidSpacer*>(w)) return "";
  std::string piece;
  const std::string text = w->TextAttribute("text").Utf8();
  if (auto* check = dynamic_cast<QelVidCtlCheckButton*>(w)) {
    const int state = check->GetCheckState();
    piece = check->IsRadio() ? (state ? "(o)" : "( )") : (state == 2 ? "[-]" : state ? "[x]" : "[ ]");
    if (!text.empty()) piece += " " + text;
  } else if (dynamic_cast<QelVidCtlButton*>(w)) {
    piece = "<" + text + ">";
  } else if (dynamic_cast<QelVidCtlImageAndLabelCombo*>(w)) {
    piece = "[" + w->TextAttribute("selected").Utf8() + " v]";
  } else if (dynamic_cast<QelVidCtlLineEditor*>(w)) {
    piece = "|" + text + "|";
  } else if (dynamic_cast<QelVidLabel*>(w)) {
    piece = text.empty() && !w->TextAttribute("icon").IsEmpty() ? "#" : text;
  } else {
    for (QelVidWidget* child : ChildrenInOrder(w)) {
      std::string part = Inline(child);
      if (part.empty()) continue;
      if (!piece.empty()) piece += " ";
      piece += part;
    }
    return piece;
  }
  return w->IsEnabled() ? piece : "{" + piece + "}";
}

// "* " for a hovered row, "~ " for a shaded one, "  " otherwise.
std::string Marker(QelVidWidget* row) {
  if (!row) return "  ";
  QelSYPValue value = row->GetAttribute("background");
  const auto* color = std::get_if<QelVidColor>(&value);
  if (!color || color->Alpha() == 0) return "  ";
  if (color->SameRgb(QelVidColor(106, 158, 190))) return "* ";
  if (color->SameRgb(QelVidColor(0.0, 255, QelVidPalette::Base, QelVidPalette::Text))) return "  ";
  return "~ ";
}

void Walk(QelVidWidget* w, int indent, std::string& out) {
  if (!w || !w->GetVisibleFlag() || dynamic_cast<QelVidSpacer*>(w)) return;
  const std::string pad(static_cast<size_t>(indent), ' ');
  if (auto* expander = dynamic_cast<QelVidCtlExpander*>(w)) {
    QelVidWidget* header = expander->GetHeader();
    std::string title = header ? Inline(header) : expander->TextAttribute("text").Utf8();
    if (!header && title.empty()) title = expander->GetName().Str();
    out += Marker(header) + pad + (expander->GetExpandedState() ? "v " : "> ") + title + "\n";
    if (expander->GetExpandedState()) Walk(expander->GetBody(), indent + 2, out);
    return;
  }
  auto* frame = dynamic_cast<QelVidCtlFrame*>(w);
  if (IsInline(w) || (frame && frame->IsRow())) {
    const std::string line = Inline(w);
    if (!line.empty()) out += Marker(frame) + pad + line + "\n";
    return;
  }
  for (QelVidWidget* child : ChildrenInOrder(w)) Walk(child, indent, out);
}

nlohmann::json ValueJson(const QelSYPValue& value) {
  if (const int* i = std::get_if<int>(&value)) return *i;
  if (const double* d = std::get_if<double>(&value)) return *d;
  if (const auto* s = std::get_if<QelUnicodeString>(&value)) return s->Utf8();
  if (const auto* c = std::get_if<QelVidColor>(&value)) return {c->Red(), c->Green(), c->Blue(), c->Alpha()};
  return nullptr;
}

nlohmann::json WidgetJson(QelVidWidget* w, const std::string& id) {
  nlohmann::json node;
  node["id"] = id;
  node["kind"] = w->GetWidgetKind();
  node["class"] = w->IsA();
  node["name"] = w->GetName().Str();
  node["visible"] = w->GetVisibleFlag() != 0;
  node["takesRoom"] = w->TakesRoom();
  node["enabled"] = w->IsEnabled() != 0;
  nlohmann::json attributes = nlohmann::json::object();
  for (const auto& [name, value] : w->GetAttributes())
    if (name != "visible" && name != "enabled") attributes[name] = ValueJson(value);
  node["attributes"] = std::move(attributes);
  if (auto* expander = dynamic_cast<QelVidCtlExpander*>(w)) node["expanded"] = expander->GetExpandedState();
  if (auto* combo = dynamic_cast<QelVidCtlImageAndLabelCombo*>(w)) {
    nlohmann::json lines = nlohmann::json::array();
    for (int i = 0; i < combo->GetLineCount(); ++i) lines.push_back(combo->GetLine(i).Utf8());
    node["lines"] = lines;
    node["selectedIndex"] = combo->GetSelectedIndex();
  }
  auto* grid = dynamic_cast<QelVidLayGrid*>(w);
  nlohmann::json children = nlohmann::json::array();
  const std::vector<QelVidWidget*> inOrder = ChildrenInOrder(w);
  for (size_t i = 0; i < inOrder.size(); ++i) {
    QelVidWidget* child = inOrder[i];
    nlohmann::json c = WidgetJson(child, id + "." + std::to_string(i));
    QelVidGridConstraints cell;
    if (grid && grid->GetConstraints(child, cell)) {
      c["row"] = cell.row;
      c["column"] = cell.column;
      c["rowWeight"] = grid->GetRowWeight(cell.row);
    }
    children.push_back(std::move(c));
  }
  // Moved, not copied: a copy at every level costs the depth times the tree's size.
  node["children"] = std::move(children);
  return node;
}
}  // namespace

std::string QelVidPrintText(QelVidWidget* root) {
  std::string out;
  Walk(root, 0, out);
  return out;
}

std::string QelVidPrintJson(QelVidWidget* root, int indent) {
  if (!root) return "null";
  return WidgetJson(root, "0").dump(indent);
}

QelVidWidget* QelVidFindById(QelVidWidget* root, std::string_view id) {
  if (!root || id.substr(0, 1) != "0") return nullptr;
  QelVidWidget* w = root;
  for (id.remove_prefix(1); !id.empty();) {
    if (id[0] != '.') return nullptr;
    id.remove_prefix(1);
    size_t index = 0, digits = 0;
    for (; digits < id.size() && digits < 9 && id[digits] >= '0' && id[digits] <= '9'; ++digits)
      index = index * 10 + static_cast<size_t>(id[digits] - '0');
    if (digits == 0 || (digits > 1 && id[0] == '0')) return nullptr;
    id.remove_prefix(digits);
    const std::vector<QelVidWidget*> children = ChildrenInOrder(w);
    if (index >= children.size()) return nullptr;
    w = children[index];
  }
  return w;
}
