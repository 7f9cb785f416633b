#pragma once
// QelSYPValue: one value of an introspectable property or of a widget attribute. Empty
// (monostate) means "no value", as for a property that could not be read.
#include <string>
#include <variant>

#include "QelUnicodeString.h"
#include "QelVidColor.h"

using QelSYPValue = std::variant<std::monostate, int, double, QelUnicodeString, QelVidColor>;

// Reads an int from an int or a double; `fallback` otherwise.
int QelSYPValueToInt(const QelSYPValue& value, int fallback = 0);
// Text for a person: ints and doubles formatted, colours as "#rrggbbaa".
std::string QelSYPValueToText(const QelSYPValue& value);
