#include "insight/timeline_event.h"

#include <algorithm>
#include <cstdio>

#include "insight/enumeration_names.h"
#include "insight/json_fields.h"
#include "insight/text_forms.h"
#include "values/text_form.h"

namespace vesk::insight {

namespace {

constexpr std::array<std::string_view, kEventKindCount> kKindNames{
    "gap",         "technology", "cell",          "handover",          "reselection",   "pingpong",
    "area",        "rrc",        "reestablished", "connection-failed", "drop",          "emm",
    "mm",          "gmm",        "reject",        "ca-configured",     "ca-activated",  "ca-deactivated",
    "ca-released", "bearer-up",  "bearer-down",   "cdrx-setup",        "cdrx-released", "sim",
    "no-service",  "service",    "alert",
};

constexpr std::array<std::string_view, 3> kEntryNames{"first", "reestablishment", "unknown"};

std::string inWords(const Text& name) {
  return withBlanks(shortName(name.view()));
}

std::string duration(std::int64_t milliseconds) {
  return durationText(static_cast<std::uint64_t>(milliseconds));
}

/// ", -101 dBm"; empty for an unknown level.
std::string levelText(const OptionalNumber<double>& level) {
  return level ? ", " + numberText(*level) + " dBm" : "";
}

std::string part(std::string_view before, const OptionalNumber<std::int64_t>& number, std::string_view unit) {
  return number ? std::string(before) + std::to_string(*number) + std::string(unit) : "";
}

/// What a person reads of the fields of an event.
struct TextWriter {
  std::string operator()(const Gap& gap) const {
    return gap.jump() < 0 ? duration(-gap.jump()) + " earlier" : duration(gap.jump()) + " later";
  }

  std::string operator()(const TechnologyChange& change) const {
    return (change.from ? std::string(nameOf(*change.from)) + " -> " : "") + std::string(nameOf(change.to));
  }

  std::string operator()(const CellChange& change) const {
    if (!change.from) return textOf(change.technology, change.to);
    const auto [from, to] = textsOf(change.technology, *change.from, change.to);
    return from + " -> " + to + levelText(change.level) + (change.stay ? ", after " + duration(*change.stay) : "");
  }

  std::string operator()(const PingPong& pingPong) const {
    return "back to " + textOf(pingPong.technology, pingPong.cell) + " after " + duration(pingPong.stay);
  }

  std::string operator()(const AreaChange& change) const {
    const std::string area(nameOf(change.area));
    return area + " " + (change.from ? textOf(*change.from) + " -> " : "") + textOf(change.to);
  }

  std::string operator()(const RrcChange& change) const {
    std::string out = inWords(change.to);
    if (change.cause) out += ", " + inWords(*change.cause);
    if (change.duration) out += ", after " + duration(*change.duration);
    if (change.duration && change.from) out += " in " + inWords(*change.from);
    return out;
  }

  std::string operator()(const Reestablishment& found) const {
    std::string out;
    if (found.from && found.to) {
      const auto [from, to] = textsOf(found.technology, *found.from, *found.to);
      out = from + " -> " + to + ", ";
    } else if (found.to) {
      out = textOf(found.technology, *found.to) + ", ";
    }
    out += causeText(found.cause);
    if (found.duration) out += ", " + duration(*found.duration);
    return out + (found.level ? levelText(found.level) + " before" : "");
  }

  std::string operator()(const ConnectionLoss& loss) const {
    const std::string cell = loss.cell ? ", " + textOf(loss.technology, *loss.cell) : "";
    return causeText(loss.cause) + cell + levelText(loss.level);
  }

  std::string operator()(const RegistrationChange& change) const {
    return (change.from ? inWords(*change.from) + " -> " : "") + inWords(change.to) +
           (change.procedure ? ", " + inWords(*change.procedure) : "");
  }

  std::string operator()(const Reject& reject) const {
    const auto code = causeCode(reject.cause.view());
    return std::string(nameOf(reject.registration)) + (code ? " #" + std::to_string(*code) : "") + " " +
           inWords(reject.cause);
  }

  std::string operator()(const ServiceChange& change) const {
    return change.duration ? "back after " + duration(*change.duration) : "no service";
  }

  std::string operator()(const CarrierChange& change) const {
    const CellIdentity cell{change.channel, change.code, std::nullopt};
    std::string out = "SCC " + std::to_string(change.index);
    if (!cell.isUnknown()) out += " " + textOf(Technology::lte, cell);
    return change.bandwidth ? out + ", " + numberText(*change.bandwidth) + " MHz" : out;
  }

  std::string operator()(const BearerChange& change) const {
    std::string out = "bearer " + std::to_string(change.bearer.number);
    if (kind != EventKind::bearerUp) return out;
    if (change.bearer.accessPoint) out += " " + std::string(change.bearer.accessPoint->view());
    return change.bearer.type ? out + " " + inWords(*change.bearer.type) : out;
  }

  std::string operator()(const CdrxChange& change) const {
    if (!change.parameters) return "off";
    const CdrxParameters& cdrx = *change.parameters;
    std::string out = part(", ", cdrx.onDuration, " ms") +
                      part(cdrx.onDuration ? " of " : ", cycle ", cdrx.longCycle, " ms") +
                      part(", short ", cdrx.shortCycle, " ms") + part(", inactivity ", cdrx.inactivity, " ms");
    return out.empty() ? "on" : out.substr(2);
  }

  std::string operator()(const SimRead& sim) const { return counted(sim.files, "file", "files"); }

  std::string operator()(const Alert& alert) const {
    if (!alert.value) return alert.rule;
    return alert.rule + ": " + numberText(*alert.value) + " since " + duration(time - alert.since);
  }

  static std::string causeText(const std::optional<Text>& cause) { return cause ? inWords(*cause) : "no cause"; }

  EventKind kind;
  std::int64_t time;
};

/// The fields of an event as those of its JSON object.
struct FieldWriter {
  void operator()(const Gap& gap) {
    field("from", std::optional(gap.from));
    field("jump_ms", std::optional(gap.jump()));
  }

  void operator()(const TechnologyChange& change) {
    field("from", change.from);
    field("to", std::optional(change.to));
  }

  void operator()(const CellChange& change) {
    field("technology", nameOf(change.technology));
    if (change.how) field("how", kEntryNames[static_cast<std::size_t>(*change.how)]);
    field("from", change.from);
    field("to", std::optional(change.to));
    field("level", change.level);
    field("stay_ms", change.stay);
  }

  void operator()(const PingPong& pingPong) {
    field("technology", nameOf(pingPong.technology));
    field("cell", std::optional(pingPong.cell));
    field("other", std::optional(pingPong.other));
    field("stay_ms", std::optional(pingPong.stay));
  }

  void operator()(const AreaChange& change) {
    field("area", nameOf(change.area));
    field("from", change.from ? std::optional(textOf(*change.from)) : std::nullopt);
    field("to", std::string_view(textOf(change.to)));
  }

  void operator()(const RrcChange& change) {
    field("technology", nameOf(change.technology));
    name("from", change.from);
    name("to", change.to);
    name("cause", change.cause);
    field("duration_ms", change.duration);
  }

  void operator()(const Reestablishment& found) {
    field("technology", nameOf(found.technology));
    name("cause", found.cause);
    field("duration_ms", found.duration);
    field("from", found.from);
    field("to", found.to);
    field("level", found.level);
  }

  void operator()(const ConnectionLoss& loss) {
    field("technology", nameOf(loss.technology));
    name("cause", loss.cause);
    field("cell", loss.cell);
    field("level", loss.level);
  }

  void operator()(const RegistrationChange& change) {
    name("from", change.from);
    name("to", change.to);
    name("procedure", change.procedure);
  }

  void operator()(const Reject& reject) {
    const auto code = causeCode(reject.cause.view());
    field("registration", nameOf(reject.registration));
    name("cause", reject.cause);
    field("code", code ? OptionalNumber<std::int64_t>(*code) : std::nullopt);
    name("procedure", reject.procedure);
  }

  void operator()(const ServiceChange& change) {
    field("technology", change.technology);
    if (change.duration) field("duration_ms", change.duration);
  }

  void operator()(const CarrierChange& change) {
    field("index", std::optional(change.index));
    field("channel", change.channel);
    field("code", change.code);
    field("mhz", change.bandwidth);
  }

  void operator()(const BearerChange& change) {
    field("bearer", std::optional(change.bearer.number));
    if (kind != EventKind::bearerUp) return;
    fields.plainKey("apn");
    if (change.bearer.accessPoint) {
      json.write(*change.bearer.accessPoint);
    } else {
      json.writeNull();
    }
    name("type", change.bearer.type);
  }

  void operator()(const CdrxChange& change) {
    if (!change.parameters) return;
    field("on_ms", change.parameters->onDuration);
    field("inactivity_ms", change.parameters->inactivity);
    field("long_ms", change.parameters->longCycle);
    field("short_ms", change.parameters->shortCycle);
  }

  void operator()(const SimRead& sim) { field("files", std::optional(static_cast<std::int64_t>(sim.files))); }

  void operator()(const Alert& alert) {
    field("rule", std::string_view(alert.rule));
    field("since", std::optional(alert.since));
    field("value", alert.value);
  }

  template <class Held>
  void field(std::string_view key, const Held& value) {
    writeField(json, fields, key, value);
  }
  void name(std::string_view key, const std::optional<Text>& value) { writeName(json, fields, key, value); }

  EventKind kind;
  JsonWriter& json;
  JsonObject& fields;
};

}  // namespace

std::string_view nameOf(EventKind kind) {
  return kKindNames[static_cast<std::size_t>(kind)];
}

std::optional<EventKind> eventKindNamed(std::string_view name) {
  const auto* found = std::find(kKindNames.begin(), kKindNames.end(), name);
  if (found == kKindNames.end()) return std::nullopt;
  return static_cast<EventKind>(found - kKindNames.begin());
}

std::string textOf(const TimelineEvent& event) {
  return std::visit(TextWriter{event.kind, event.moment.time}, event.fields);
}

void writeJson(JsonWriter& json, const TimelineEvent& event) {
  JsonObject fields(json);
  fields.plainKey("timestamp");
  json.write(event.moment.time);
  fields.plainKey("event");
  json.write(event.moment.event);
  fields.plainKey("kind");
  json.write(nameOf(event.kind));
  fields.plainKey("text");
  json.write(std::string_view(textOf(event)));
  std::visit(FieldWriter{event.kind, json, fields}, event.fields);
  fields.end();
}

std::string timeOfDay(std::int64_t time) {
  const std::int64_t inDay = time % 86'400'000;
  std::array<char, 40> text;
  std::snprintf(text.data(), text.size(), "%02d:%02d:%02d.%03d", static_cast<int>(inDay / 3'600'000),
                static_cast<int>(inDay / 60'000 % 60), static_cast<int>(inDay / 1000 % 60),
                static_cast<int>(inDay % 1000));
  return text.data();
}

std::string lineOf(const TimelineEvent& event) {
  return timeOfDay(event.moment.time) + "  " + std::string(nameOf(event.kind)) + "  " + textOf(event);
}

}  // namespace vesk::insight
