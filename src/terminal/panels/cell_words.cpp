#include "terminal/panels/cell_words.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>

#include "insight/readings.h"
#include "insight/text_forms.h"
#include "insight/timeline_event.h"
#include "values/value.h"

namespace vesk {

using insight::Technology;

namespace {

/// Where records say who a cell is.
struct CellNames {
  std::string_view code;
  std::string_view channel;
  std::string_view recordClass;
  std::string_view channelKey;
};

const CellNames& namesOf(Technology technology) {
  static constexpr std::array<CellNames, insight::kTechnologies.size()> kNames{{
      {"PCI", "EARFCN", "KCellularLteScellInfo", "dl_freq"},
      {"PSC", "UARFCN", "KCellularWcdmaCellInfo", "dl_uarfcn"},
      {"BSIC", "ARFCN", "KCellularGsmScellInfo", "arfcn"},
  }};
  return kNames[indexOf(technology)];
}

std::optional<insight::Reading> readingOfNumber(Technology technology, std::string_view key, std::int64_t number) {
  Dictionary record;
  record.set(Text::copy(key), Value(number));
  auto reading = insight::readingOf(namesOf(technology).recordClass, record, key);
  return reading && reading->mark != insight::Mark::impossible ? std::move(reading) : std::nullopt;
}

}  // namespace

std::string_view codeNameOf(Technology technology) {
  return namesOf(technology).code;
}

std::string_view channelNameOf(Technology technology) {
  return namesOf(technology).channel;
}

std::optional<insight::Reading> channelReading(Technology technology, std::int64_t channel) {
  return readingOfNumber(technology, namesOf(technology).channelKey, channel);
}

std::string siteText(Technology technology, std::int64_t cellId) {
  const auto reading = readingOfNumber(technology, "cell_id", cellId);
  return reading ? reading->text : "cell " + std::to_string(cellId);
}

std::string dateText(std::int64_t time) {
  const std::chrono::sys_time<std::chrono::milliseconds> instant{std::chrono::milliseconds(time)};
  const std::chrono::year_month_day day(std::chrono::floor<std::chrono::days>(instant));
  std::array<char, 40> text;
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02u ", static_cast<int>(day.year()),
                static_cast<unsigned>(day.month()), static_cast<unsigned>(day.day()));
  return text.data() + insight::timeOfDay(time).substr(0, 8) + " UTC";
}

std::string lastingText(std::int64_t milliseconds) {
  const auto shown = static_cast<std::uint64_t>(std::max<std::int64_t>(milliseconds, 0));
  return shown < 1000 ? "0." + std::to_string(shown / 100) + " s" : insight::durationText(shown);
}

}  // namespace vesk
