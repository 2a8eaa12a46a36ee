#include "insight/json_fields.h"

#include <array>
#include <charconv>
#include <string>

#include "insight/text_forms.h"

namespace vesk::insight {

namespace {

void put(JsonWriter& json, std::string_view characters) {
  for (const char character : characters)
    json.put(character);
}

}  // namespace

void writeRounded(JsonWriter& json, double number) {
  put(json, numberText(number));
}

void writeNumber(JsonWriter& json, double number) {
  std::array<char, 32> digits;
  const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
  put(json, {digits.data(), static_cast<std::size_t>(end - digits.data())});
}

void writeCell(JsonWriter& json, const CellIdentity& cell) {
  JsonObject fields(json);
  writeField(json, fields, "channel", cell.channel);
  writeField(json, fields, "code", cell.code);
  writeField(json, fields, "cell_id", cell.cellId);
  fields.end();
}

}  // namespace vesk::insight
