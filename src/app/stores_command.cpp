#include "app/stores_command.h"

#include "app/data_output.h"
#include "app/json_form.h"
#include "app/road.h"
#include "intake/metric_validator.h"

namespace vesk {

namespace {

void appendJson(std::string& out, const RecordList& list) {
  char separator = '[';
  for (const Record& record : list) {
    out += separator;
    appendJson(out, record);
    separator = ',';
  }
  if (list.size() == 0) out += '[';
  out += ']';
}

/// Writes the fields of one JSON object, one after another.
class ObjectFields {
 public:
  explicit ObjectFields(std::string& out) : out_(out) {}

  /// Starts a field, whose value follows.
  void name(std::string_view name) {
    out_ += separator_;
    separator_ = ',';
    vesk::appendJson(out_, name);
    out_ += ':';
  }
  void end() { out_ += '}'; }

 private:
  std::string& out_;
  char separator_ = '{';
};

template <class Store>
void appendStore(std::string& out, const Store& store) {
  ObjectFields fields(out);
  visitFields(store, [&](std::string_view name, const auto& field) {
    fields.name(name);
    appendJson(out, field);
  });
  fields.end();
}

void appendLatestRecords(std::string& out, const MetricValidator& intake) {
  ObjectFields fields(out);
  for (const auto& [name, member] : kLatestRecords) {
    fields.name(name);
    if (const auto& record = intake.*member) {
      vesk::appendJson(out, *record);
    } else {
      out += "null";
    }
  }
  fields.end();
}

std::string storesAsJson(const MetricValidator& intake) {
  std::string out;
  ObjectFields fields(out);
  fields.name("dictionaries");
  appendLatestRecords(out, intake);
  fields.name("LTE");
  appendStore(out, intake.myLTE);
  fields.name("UMTS");
  appendStore(out, intake.myUMTS);
  fields.name("GSM");
  appendStore(out, intake.myGSM);
  fields.name("Common");
  appendStore(out, intake.myCommon);
  fields.end();
  return out;
}

}  // namespace

Outcome runStores(const std::string& path) {
  DataOutput output;
  const Outcome outcome = playRecording(
      path, [&](NavigationController& /*root*/) { output.writeLine(storesAsJson(*MetricValidator::shared())); });
  return output.finish(outcome);
}

}  // namespace vesk
