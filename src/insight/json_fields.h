#pragma once

#include <optional>
#include <string_view>

#include "insight/cell_identity.h"
#include "insight/enumeration_names.h"
#include "values/json_form.h"
#include "values/text.h"

/// Fields of this room's JSON: numbers without a point where they are whole, null for what is absent.
namespace vesk::insight {

/// Rounded to 2 decimals: -13, -9.85.
void writeRounded(JsonWriter& json, double number);
/// In full: 0.3529.
void writeNumber(JsonWriter& json, double number);

/// Writes `key` with what `write` writes of the value, or null.
template <class Held, class Write>
void writeField(JsonWriter& json, JsonObject& fields, std::string_view key, const std::optional<Held>& value,
                Write write) {
  fields.plainKey(key);
  if (value) {
    write(*value);
  } else {
    json.writeNull();
  }
}

inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key,
                       const std::optional<std::int64_t>& value) {
  writeField(json, fields, key, value, [&](std::int64_t number) { json.write(number); });
}
inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key, const std::optional<double>& value) {
  writeField(json, fields, key, value, [&](double number) { writeRounded(json, number); });
}
inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key, std::string_view text) {
  fields.plainKey(key);
  json.write(text);
}
inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key,
                       const std::optional<std::string>& text) {
  writeField(json, fields, key, text, [&](const std::string& each) { json.write(std::string_view(each)); });
}
inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key,
                       const std::optional<Technology>& technology) {
  writeField(json, fields, key, technology, [&](Technology each) { json.write(nameOf(each)); });
}
/// {"channel":…,"code":…,"cell_id":…}
void writeCell(JsonWriter& json, const CellIdentity& cell);
inline void writeField(JsonWriter& json, JsonObject& fields, std::string_view key,
                       const std::optional<CellIdentity>& cell) {
  writeField(json, fields, key, cell, [&](const CellIdentity& each) { writeCell(json, each); });
}
/// The short name.
inline void writeName(JsonWriter& json, JsonObject& fields, std::string_view key, const std::optional<Text>& name) {
  writeField(json, fields, key, name, [&](const Text& each) { json.write(shortName(each.view())); });
}

}  // namespace vesk::insight
