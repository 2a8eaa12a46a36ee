#include "insight/reading.h"

#include "insight/text_forms.h"

namespace vesk::insight {

namespace {

/// The optional fields of a reading: each is written where it is there.
class Fields {
 public:
  explicit Fields(JsonWriter& json) : json_(json), object_(json) {}

  void write(std::string_view key, std::optional<std::string_view> text) {
    if (!text) return;
    object_.plainKey(key);
    json_.write(*text);
  }
  void write(std::string_view key, std::optional<std::int64_t> number) {
    if (!number) return;
    object_.plainKey(key);
    json_.write(*number);
  }
  /// Takes a number as it stands in texts.
  void writeDecimal(std::string_view key, std::string_view number) {
    object_.plainKey(key);
    for (const char digit : number)
      json_.put(digit);
  }
  void writeNull(std::string_view key) {
    object_.plainKey(key);
    json_.writeNull();
  }
  void end() { object_.end(); }

 private:
  JsonWriter& json_;
  JsonObject object_;
};

template <class Enumeration>
std::optional<std::string_view> nameIfAny(const std::optional<Enumeration>& value) {
  return value ? std::optional(nameOf(*value)) : std::nullopt;
}

}  // namespace

std::string_view nameOf(Mark mark) {
  switch (mark) {
    case Mark::impossible:
      return "impossible";
    case Mark::floor:
      return "floor";
    case Mark::reserved:
      return "reserved";
    case Mark::mismatch:
      return "mismatch";
    case Mark::ambiguous:
      return "ambiguous";
    case Mark::high:
      return "high";
  }
  return {};
}

Reading impossibleReading() {
  return {.text = "impossible", .mark = Mark::impossible};
}

void writeReading(JsonWriter& json, const Reading& reading) {
  Fields fields(json);
  fields.write("text", std::string_view(reading.text));
  if (reading.value) fields.writeDecimal("value", numberText(*reading.value));
  if (!reading.unit.empty()) fields.write("unit", reading.unit);
  fields.write("grade", nameIfAny(reading.grade));
  fields.write("mark", nameIfAny(reading.mark));
  fields.write("band", reading.band);
  if (reading.downlink) fields.writeDecimal("dl_mhz", megahertzText(*reading.downlink));
  if (reading.uplink) {
    fields.writeDecimal("ul_mhz", megahertzText(*reading.uplink));
  } else if (reading.downlink) {
    fields.writeNull("ul_mhz");
  }
  fields.write("duplex", nameIfAny(reading.duplex));
  fields.write("enb", reading.enb);
  fields.write("sector", reading.sector);
  fields.write("rnc", reading.rnc);
  fields.write("cell", reading.cell);
  fields.write("plmn", reading.plmn);
  fields.write("code", reading.code);
  fields.end();
}

}  // namespace vesk::insight
