#include "app/commands/stores_command.h"

#include "app/output/data_output.h"
#include "app/source/play_recording.h"
#include "intake/metric_validator.h"
#include "values/json_form.h"

namespace vesk {

namespace {

template <class Field>
void write(JsonWriter& json, const Field& field) {
  json.write(field);
}

void write(JsonWriter& json, const RecordList& list) {
  writeJsonArray(json, list, [&](const Record& record) { json.write(record); });
}

template <class Store>
void writeStore(JsonWriter& json, const Store& store) {
  JsonObject fields(json);
  visitFields(store, [&](std::string_view name, const auto& field) {
    fields.key(name);
    write(json, field);
  });
  fields.end();
}

void writeLatestRecords(JsonWriter& json, const Stores& stores) {
  JsonObject fields(json);
  visitLatestRecords(stores, [&](std::string_view name, const LatestRecord& record) {
    fields.key(name);
    if (record) {
      json.write(*record);
    } else {
      json.writeNull();
    }
  });
  fields.end();
}

void writeStores(JsonWriter& json, const Stores& stores) {
  JsonObject fields(json);
  fields.key("dictionaries");
  writeLatestRecords(json, stores);
  fields.key("LTE");
  writeStore(json, stores.myLTE);
  fields.key("UMTS");
  writeStore(json, stores.myUMTS);
  fields.key("GSM");
  writeStore(json, stores.myGSM);
  fields.key("Common");
  writeStore(json, stores.myCommon);
  fields.end();
}

std::string storesAsJson(const Stores& stores) {
  std::string out;
  JsonWriter json(out);
  writeStores(json, stores);
  json.finish();
  return out;
}

}  // namespace

Outcome runStores(const RecordingInput& input) {
  DataOutput output;
  const Outcome outcome = playRecording(input, [&](NavigationController& /*root*/) {
    output.writeLine(storesAsJson(MetricValidator::shared()->stores));
  });
  return output.finish(outcome);
}

}  // namespace vesk
