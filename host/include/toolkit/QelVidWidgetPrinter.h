#pragma once
// The widget tree as a person sees it. One walk gives two forms: text for a terminal
// (indented rows, "[x]" "[ ]" "[-]" check boxes, "(o)" "( )" radios, "v"/">" for an open or
// closed section, "~" before a shaded (alternate) row, "*" before a hovered one, hidden
// widgets absent, disabled parts in braces) and JSON (every widget with its kind, name,
// visible and enabled state, attributes and children), for a later web view.
#include <string>

class QelVidWidget;

std::string QelVidPrintText(QelVidWidget* root);
std::string QelVidPrintJson(QelVidWidget* root, int indent = 2);
