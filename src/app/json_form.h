#pragma once

#include <string>
#include <string_view>

#include "platform/value.h"

namespace vesk {

/// Appends `value` as JSON: numbers and booleans as such, bytes as "0x…" text, invalid UTF-8 as U+FFFD. Control
/// characters are escaped, those beyond ASCII too, so that a terminal may show what comes out.
void appendJson(std::string& out, const Value& value);
void appendJson(std::string& out, const Array& array);
void appendJson(std::string& out, const Dictionary& dictionary);
void appendJson(std::string& out, std::string_view text);

}  // namespace vesk
