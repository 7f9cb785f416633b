#pragma once
// The widget tree as a person sees it. One walk gives two forms: text for a terminal
// (indented rows, "[x]" "[ ]" "[-]" check boxes, "(o)" "( )" radios, "v"/">" for an open or
// closed section, "~" before a shaded (alternate) row, "*" before a hovered one, hidden
// widgets absent, disabled parts in braces) and JSON (every widget with its kind, name,
// visible and enabled state, attributes and children), for a web view. Each JSON node
// carries "id", its path of child indices from the root ("0", "0.3", "0.3.1"), which
// QelVidFindById resolves again; an id names a widget only until the tree is rebuilt.
#include <string>
#include <string_view>

class QelVidWidget;

std::string QelVidPrintText(QelVidWidget* root);
// indent -1: the compact form.
std::string QelVidPrintJson(QelVidWidget* root, int indent = 2);
// The compact form appended to `out`, for an answer that holds the tree among other things.
// With `seenOnly`, hidden widgets and the bodies of closed sections are sent without their
// children (ids stay those of the whole tree): what a view draws, at a fraction of the size.
void QelVidAppendJson(QelVidWidget* root, std::string& out, bool seenOnly = false);
// The widget at `id` under `root`, or null for a malformed id or a path that leads nowhere.
QelVidWidget* QelVidFindById(QelVidWidget* root, std::string_view id);
