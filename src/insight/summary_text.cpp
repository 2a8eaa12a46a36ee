#include <array>
#include <cmath>
#include <cstdio>
#include <utility>

#include "insight/summary_form.h"
#include "insight/text_forms.h"
#include "values/text_form.h"

namespace vesk::insight {

namespace {

/// Rounded half up, as people do; in whole numbers, as 14.5 % is no exact fraction.
std::string percent(std::int64_t part, std::int64_t whole) {
  return std::to_string(whole == 0 ? 0 : (200 * part + whole) / (2 * whole)) + " %";
}

std::string whole(double number) {
  return std::to_string(static_cast<long>(std::floor(number + 0.5)));
}

std::string oneDecimal(double number) {
  std::array<char, 32> text;
  std::snprintf(text.data(), text.size(), "%.1f", std::floor(number * 10 + 0.5) / 10);
  return text.data();
}

std::string spanText(std::int64_t milliseconds) {
  return durationText(static_cast<std::uint64_t>(milliseconds));
}

std::string right(std::string text, std::size_t width) {
  return text.size() < width ? text.insert(0, width - text.size(), ' ') : text;
}

std::string left(std::string text, std::size_t width) {
  if (text.size() < width) text.append(width - text.size(), ' ');
  return text;
}

/// Appends `text` so that it ends at `column`, and behind it where there is no room for it and a blank.
void appendUpTo(std::string& line, std::size_t column, const std::string& text) {
  const std::size_t taken = line.size() + text.size();
  line.append(taken < column ? column - taken : 1, ' ').append(text);
}

/// A day of the calendar.
struct Date {
  std::int64_t year;
  unsigned month;
  unsigned day;
};

/// From days since 1970-01-01. Years are counted from March, so that the leap day is the last of a year.
Date dateOf(std::int64_t days) {
  constexpr std::int64_t kDaysOfEra = 146'097;
  const std::int64_t shifted = days + 719'468;
  const auto dayOfEra = static_cast<unsigned>(shifted % kDaysOfEra);
  const unsigned yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36'524 - dayOfEra / 146'096) / 365;
  const unsigned dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
  const unsigned month = (5 * dayOfYear + 2) / 153;
  const unsigned calendarMonth = month < 10 ? month + 3 : month - 9;
  return {shifted / kDaysOfEra * 400 + yearOfEra + (calendarMonth <= 2 ? 1 : 0), calendarMonth,
          dayOfYear - (153 * month + 2) / 5 + 1};
}

/// "2016-01-17 03:40:41".
std::string dateText(std::int64_t time) {
  constexpr std::int64_t kDay = 86'400'000;
  const Date date = dateOf(time / kDay);
  std::array<char, 40> text;
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02u ", static_cast<int>(date.year), date.month, date.day);
  return text.data() + timeOfDay(time).substr(0, 8);
}

/// The lines, in order; what has no content has none.
class SummaryLines {
 public:
  explicit SummaryLines(const Insight& insight)
      : insight_(insight), summary_(insight.summary()), timeline_(insight.timeline()) {}

  std::vector<std::string> lines(std::size_t height) {
    addHead();
    addTechnologies();
    addKpis();
    for (const Technology each : kTechnologies) {
      addConnections(each);
      addMobility(each);
    }
    addCarriers();
    addTxPower();
    addRegistration();
    addCells(height);
    if (lines_.size() > height) lines_.resize(height);
    return std::move(lines_);
  }

 private:
  void add(std::string line) { lines_.push_back(std::move(line)); }

  /// One line where they fit in it, else several.
  void addJoined(const std::vector<std::string>& parts, std::string_view separator) {
    std::string line;
    for (const std::string& part : parts) {
      if (!line.empty() && line.size() + separator.size() + part.size() > kWidth) add(std::exchange(line, ""));
      if (!line.empty()) line += separator;
      line += part;
    }
    if (!line.empty()) add(std::move(line));
  }

  void addHead() {
    const EventCounts& counts = insight_.counts();
    std::string line = std::to_string(counts.stored) + " of " + counted(counts.all, "event", "events");
    if (insight_.now())
      line += ", " + dateText(*insight_.clock().first()) + " to " + dateText(*insight_.now()) + " UTC";
    add(line);
    if (!insight_.now()) return;
    const std::uint64_t stretches = insight_.clock().stretches();
    std::vector<std::string> parts{spanText(insight_.clock().counted()) + " counted in " +
                                   counted(stretches, "stretch", "stretches") + ", " +
                                   counted(stretches - 1, "gap", "gaps")};
    const std::uint64_t noService = summary_.count(EventKind::noService);
    if (noService > 0)
      parts.push_back("no service " + counted(noService, "time", "times") + ", " + spanText(summary_.noService()));
    addJoined(parts, "; ");
  }

  void addTechnologies() {
    std::string line = "technology ";
    bool isAny = false;
    const auto append = [&](std::string_view name, std::int64_t time) {
      if (time == 0) return;
      line += (isAny ? "   " : " ") + std::string(name) + " " + percent(time, insight_.clock().counted());
      isAny = true;
    };
    for (const Technology each : kTechnologies)
      append(nameOf(each), summary_.time(each));
    append("none", summary_.time(std::nullopt));
    if (isAny) add(line);
  }

  void addKpis() {
    bool isAny = false;
    for (const KpiDescription& each : kKpis) {
      const KpiSummary& kpi = summary_.kpi(each.kpi);
      const auto stats = kpi.values.stats();
      if (!each.isGraded || !stats) continue;
      if (!isAny) add("kpi          count     min    mean  median     max   excellent  good  fair  poor");
      isAny = true;
      std::string line = left(std::string(each.name), 10) + right(std::to_string(stats->count), 8);
      for (const std::string& figure :
           {numberText(stats->min), oneDecimal(stats->mean), numberText(stats->median), numberText(stats->max)})
        line += right(figure, 8);
      const auto graded = [&](Grade grade) { return percent(kpi.graded(grade), kpi.known()); };
      add(line + right(graded(Grade::excellent), 12) + right(graded(Grade::good), 6) + right(graded(Grade::fair), 6) +
          right(graded(Grade::poor), 6));
    }
  }

  void addConnections(Technology technology) {
    const ConnectionCounts& counts = timeline_.connections().counts(technology);
    const std::string name(nameOf(technology));
    const std::uint64_t ended = counts.failed.total() + counts.dropped.total() + counts.released.total();
    if (counts.attempted + counts.established + ended > 0)
      addJoined(
          {name + " connections: " + std::to_string(counts.attempted) + " attempted",
           std::to_string(counts.established) + " established", std::to_string(counts.failed.total()) + " failed",
           std::to_string(counts.dropped.total()) + " dropped", std::to_string(counts.released.total()) + " released"},
          ", ");
    if (counts.reestablishments.total() > 0)
      add(name + " re-established: " + std::to_string(counts.reestablished) + " of " +
          std::to_string(counts.reestablishments.total()));
  }

  void addMobility(Technology technology) {
    const MobilityCounts& counts = summary_.mobility(technology);
    const std::uint64_t other = counts.reestablishments + counts.unknown;
    if (counts.handovers + counts.reselections + other == 0) return;
    add(std::string(nameOf(technology)) + " cell changes: " + counted(counts.handovers, "handover", "handovers") +
        ", " + counted(counts.reselections, "reselection", "reselections") + ", " + std::to_string(other) + " other, " +
        counted(counts.pingPongs, "ping-pong", "ping-pongs"));
  }

  void addCarriers() {
    if (summary_.carriersConfigured() == 0) return;
    add("carrier aggregation " + percent(summary_.carriersConfigured(), summary_.time(Technology::lte)) +
        " of LTE, activated " + spanText(summary_.carriersActivated()));
  }

  void addTxPower() {
    std::vector<std::string> powers;
    for (const KpiDescription& each : kKpis) {
      const KpiSummary& kpi = summary_.kpi(each.kpi);
      const auto stats = kpi.values.stats();
      if (!each.isTransmitPower || !stats) continue;
      powers.push_back(std::string(each.name) + " max " + numberText(stats->max) + " dBm, " +
                       percent(kpi.high(), kpi.known()) + " high");
    }
    addJoined(powers, "  ");
  }

  void addRegistration() {
    const auto& registrations = timeline_.registrations();
    const auto count = [this](EventKind kind) { return std::to_string(summary_.count(kind)); };
    std::uint64_t rejects = 0;
    for (const Registration each : {Registration::emm, Registration::mm, Registration::gmm})
      rejects += registrations.rejects(each).total();
    const std::uint64_t changes = summary_.count(EventKind::emm) + summary_.count(EventKind::mm) +
                                  summary_.count(EventKind::gmm) + summary_.count(EventKind::bearerUp) + rejects;
    if (changes == 0) return;
    addJoined({"registration changes: " + count(EventKind::emm) + " EMM, " + count(EventKind::mm) + " MM, " +
                   count(EventKind::gmm) + " GMM",
               "rejects " + std::to_string(rejects),
               "bearers " + count(EventKind::bearerUp) + " up, " + count(EventKind::bearerDown) + " down"},
              "; ");
  }

  void addCells(std::size_t height) {
    if (summary_.cells().count() == 0 || lines_.size() + 2 > height) return;
    add("cell                                  time share visits   min mean  max quality");
    for (const VisitedCell* cell : summary_.cells().byTime()) {
      if (lines_.size() == height) return;
      const auto level = cell->level.stats();
      const auto quality = cell->quality.stats();
      std::string line = textOf(cell->technology, cell->identity, true);
      appendUpTo(line, 42, spanText(cell->time));
      appendUpTo(line, 48, percent(cell->time, insight_.clock().counted()));
      appendUpTo(line, 55, std::to_string(cell->visits));
      appendUpTo(line, 61, level ? numberText(level->min) : "-");
      appendUpTo(line, 66, level ? whole(level->mean) : "-");
      appendUpTo(line, 71, level ? numberText(level->max) : "-");
      appendUpTo(line, 79, quality ? whole(quality->mean) : "-");
      add(std::move(line));
    }
  }

  static constexpr std::size_t kWidth = 80;

  const Insight& insight_;
  const Summary& summary_;
  const Timeline& timeline_;
  std::vector<std::string> lines_;
};

}  // namespace

std::string summaryText(const Insight& insight, std::size_t height) {
  std::string out;
  for (const std::string& line : SummaryLines(insight).lines(height))
    out += (out.empty() ? "" : "\n") + line;
  return out;
}

}  // namespace vesk::insight
