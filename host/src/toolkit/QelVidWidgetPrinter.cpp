#include "QelVidWidgetPrinter.h"

#include <charconv>
#include <cmath>
#include <nlohmann/json.hpp>
#include <string_view>

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

// The JSON form is written straight into one text: a panel of a large model has tens of
// thousands of widgets, and a tree of JSON values first would cost several times more.
void AppendText(std::string& out, std::string_view text) {
  static constexpr char kHex[] = "0123456789abcdef";
  out += '"';
  for (size_t i = 0; i < text.size();) {
    const auto c = static_cast<unsigned char>(text[i]);
    if (c >= 0x80) {
      // A well-formed UTF-8 sequence is kept; any other byte becomes U+FFFD.
      const size_t length = c >= 0xF0 && c <= 0xF4 ? 4 : c >= 0xE0 ? 3 : c >= 0xC2 && c < 0xE0 ? 2 : 0;
      bool whole = length > 0 && i + length <= text.size();
      for (size_t k = 1; whole && k < length; ++k) whole = (static_cast<unsigned char>(text[i + k]) & 0xC0) == 0x80;
      if (whole && length == 3) {
        const auto second = static_cast<unsigned char>(text[i + 1]);
        whole = !(c == 0xE0 && second < 0xA0) && !(c == 0xED && second >= 0xA0);
      }
      if (whole && length == 4) {
        const auto second = static_cast<unsigned char>(text[i + 1]);
        whole = !(c == 0xF0 && second < 0x90) && !(c == 0xF4 && second >= 0x90);
      }
      if (whole) {
        out.append(text.substr(i, length));
        i += length;
      } else {
        out += "\xEF\xBF\xBD";
        ++i;
      }
      continue;
    }
    if (c == '"' || c == '\\') {
      out += '\\';
      out += char(c);
    } else if (c == '\n') {
      out += "\\n";
    } else if (c == '\t') {
      out += "\\t";
    } else if (c < 0x20) {
      out += "\\u00";
      out += kHex[c >> 4];
      out += kHex[c & 0xF];
    } else {
      out += char(c);
    }
    ++i;
  }
  out += '"';
}

void AppendNumber(std::string& out, double value) {
  if (!std::isfinite(value)) {
    out += "null";
    return;
  }
  char text[32];
  const auto written = std::to_chars(text, text + sizeof text, value);
  out.append(text, written.ptr);
}

void AppendValue(std::string& out, const QelSYPValue& value) {
  if (const int* i = std::get_if<int>(&value)) {
    out += std::to_string(*i);
  } else if (const double* d = std::get_if<double>(&value)) {
    AppendNumber(out, *d);
  } else if (const auto* s = std::get_if<QelUnicodeString>(&value)) {
    AppendText(out, s->Utf8());
  } else if (const auto* c = std::get_if<QelVidColor>(&value)) {
    out += '[' + std::to_string(c->Red()) + ',' + std::to_string(c->Green()) + ',' + std::to_string(c->Blue()) + ',' +
           std::to_string(c->Alpha()) + ']';
  } else {
    out += "null";
  }
}

// With `seenOnly`, the nodes a person cannot see (hidden widgets, the body of a closed
// section) keep their place and id but lose their children: at 10k rows that is most of the
// tree.
void AppendWidget(QelVidWidget* w, std::string& id, std::string& out, const QelVidGridConstraints* cell,
                  double rowWeight, bool seenOnly, bool pruned) {
  auto key = [&out](const char* name) {
    out += ",\"";
    out += name;
    out += "\":";
  };
  out += "{\"id\":";
  AppendText(out, id);
  key("kind");
  AppendText(out, w->GetWidgetKind());
  key("class");
  AppendText(out, w->IsA());
  key("name");
  AppendText(out, w->GetName().Str());
  key("visible");
  out += w->GetVisibleFlag() ? "true" : "false";
  key("takesRoom");
  out += w->TakesRoom() ? "true" : "false";
  key("enabled");
  out += w->IsEnabled() ? "true" : "false";
  key("attributes");
  out += '{';
  bool first = true;
  for (const QelVidAttribute& attribute : w->GetAttributes()) {
    if (attribute.Name() == "visible" || attribute.Name() == "enabled") continue;
    if (!first) out += ',';
    first = false;
    AppendText(out, attribute.Name());
    out += ':';
    AppendValue(out, attribute.value);
  }
  out += '}';
  if (auto* expander = dynamic_cast<QelVidCtlExpander*>(w)) {
    key("expanded");
    out += expander->GetExpandedState() ? "true" : "false";
  }
  if (auto* combo = dynamic_cast<QelVidCtlImageAndLabelCombo*>(w)) {
    key("lines");
    out += '[';
    for (int i = 0; i < combo->GetLineCount(); ++i) {
      if (i) out += ',';
      AppendText(out, combo->GetLine(i).Utf8());
    }
    out += ']';
    key("selectedIndex");
    out += std::to_string(combo->GetSelectedIndex());
  }
  if (cell) {
    key("row");
    out += std::to_string(cell->row);
    key("column");
    out += std::to_string(cell->column);
    key("rowWeight");
    AppendNumber(out, rowWeight);
  }
  key("children");
  out += '[';
  if (pruned) {
    out += "]}";
    return;
  }
  auto* closed = dynamic_cast<QelVidCtlExpander*>(w);
  if (closed && closed->GetExpandedState()) closed = nullptr;
  const size_t idLength = id.size();
  auto child = [&](size_t index, size_t count, QelVidWidget* c, const QelVidGridConstraints* constraints,
                   double weight) {
    if (index) out += ',';
    id += '.';
    id += std::to_string(index);
    // A section's body is its last child.
    const bool unseen = seenOnly && (!c->GetVisibleFlag() || (closed && index + 1 == count));
    AppendWidget(c, id, out, constraints, weight, seenOnly, unseen);
    id.resize(idLength);
  };
  if (auto* grid = dynamic_cast<QelVidLayGrid*>(w)) {
    const auto cells = grid->GetCellsInOrder();
    for (size_t i = 0; i < cells.size(); ++i)
      child(i, cells.size(), cells[i].first, &cells[i].second, grid->GetRowWeight(cells[i].second.row));
  } else {
    const size_t count = static_cast<size_t>(w->GetChildCount());
    for (size_t i = 0; i < count; ++i) child(i, count, w->GetChild(static_cast<int>(i)), nullptr, 0.0);
  }
  out += "]}";
}
}  // namespace

std::string QelVidPrintText(QelVidWidget* root) {
  std::string out;
  Walk(root, 0, out);
  return out;
}

std::string QelVidPrintJson(QelVidWidget* root, int indent) {
  std::string out;
  QelVidAppendJson(root, out);
  // A person reads the indented form; the compact one is the fast path for the web view.
  return indent < 0 || !root ? out : nlohmann::json::parse(out).dump(indent);
}

void QelVidAppendJson(QelVidWidget* root, std::string& out, bool seenOnly) {
  if (!root) {
    out += "null";
    return;
  }
  std::string id = "0";
  AppendWidget(root, id, out, nullptr, 0.0, seenOnly, false);
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
