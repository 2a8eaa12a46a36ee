#include "terminal/panels/connection_pane.h"

#include <array>
#include <span>
#include <string>
#include <vector>

#include "insight/enumeration_names.h"
#include "terminal/panels/cell_words.h"
#include "terminal/panels/kpi_look.h"

namespace vesk {

using insight::Kpi;
using insight::Technology;

namespace {

std::string nameInWords(const Text& name) {
  return insight::withBlanks(insight::shortName(name.view()));
}

/// What a line says beside its label; nothing where it is not known.
struct ConnectionLine {
  std::string_view label;
  std::string text;
  Role role = Role::Value;
};

ConnectionLine rrcLine(const insight::Present& drive, Technology technology) {
  const auto& connections = drive.timeline().connections();
  const auto& state = connections.state(technology);
  ConnectionLine line{"RRC", ""};
  if (!state) return line;
  line.text = nameInWords(*state) + "   " + lastingText(drive.now().value_or(0) - connections.stateSince(technology));
  if (const auto& cause = connections.cause(technology)) line.text += "   " + nameInWords(*cause);
  if (connections.isReestablishing()) line.role = Role::Alarm;
  return line;
}

ConnectionLine registrationLine(const insight::Present& drive, insight::Registration registration) {
  const auto& registrations = drive.timeline().registrations();
  ConnectionLine line{nameOf(registration), ""};
  if (const auto& status = registrations.status(registration)) line.text = nameInWords(*status);
  if (const auto& cause = registrations.rejectCause(registration)) {
    const auto code = insight::causeCode(cause->view());
    line.text += "   rejected" + (code ? " #" + std::to_string(*code) : "") + " " + nameInWords(*cause);
    line.role = Role::Alarm;
  }
  return line;
}

/// "on 10 of 320 ms, short 80   TM3   inactivity 100".
ConnectionLine drxLine(const insight::Present& drive) {
  const auto& parameters = drive.timeline().connectedDrx().parameters();
  const auto& mode = drive.servingDetails().transmissionMode();
  const std::string transmission = mode ? "   TM" + std::to_string(*mode) : "";
  if (!parameters) return {"C-DRX", "off" + transmission};
  const auto part = [](std::string_view before, const std::optional<std::int64_t>& number) {
    return number ? std::string(before) + std::to_string(*number) : "";
  };
  return {"C-DRX", "on" + part(" ", parameters->onDuration) + part(" of ", parameters->longCycle) + " ms" +
                       part(", short ", parameters->shortCycle) + transmission +
                       part("   inactivity ", parameters->inactivity)};
}

ConnectionLine carriersLine(const insight::Present& drive) {
  std::string text;
  for (const insight::Carrier& each : drive.timeline().carriers().configured()) {
    const insight::CarrierChange shown{each.index, each.channel, each.code, each.bandwidth};
    if (!text.empty()) text += "   ";
    text += textOf(insight::TimelineEvent{{}, insight::EventKind::caConfigured, shown});
    text += each.state == insight::CarrierState::activated ? ", active" : ", configured";
  }
  return {"CA", text.empty() ? "none" : text};
}

ConnectionLine powerLine(const insight::Present& drive, std::span<const Kpi> kpis) {
  ConnectionLine line{"Tx", ""};
  for (const Kpi kpi : kpis) {
    const auto value = drive.value(kpi);
    if (!value) continue;
    const std::string_view label = labelOf(kpi);
    if (!line.text.empty()) line.text += "   ";
    if (label.starts_with("Tx ")) line.text += std::string(label.substr(3)) + " ";
    line.text += valueText(kpi, *value);
    const std::string grade = gradeText(kpi, *value);
    if (!grade.empty()) line.text += ", " + grade;
    if (line.role == Role::Value) line.role = roleOf(kpi, *value);
  }
  return line;
}

ConnectionLine bearersLine(const insight::Present& drive) {
  const auto bearers = drive.timeline().bearers().active();
  ConnectionLine line{"Bearers", std::to_string(bearers.size())};
  for (const insight::Bearer& each : bearers) {
    line.text += "   " + std::to_string(each.number);
    if (each.accessPoint) line.text += " " + std::string(each.accessPoint->view());
  }
  return line;
}

std::vector<ConnectionLine> linesOf(const insight::Present& drive, Technology technology) {
  using insight::Registration;
  constexpr std::array kLtePower{Kpi::ltePuschTxPower, Kpi::ltePucchTxPower};
  constexpr std::array kUmtsPower{Kpi::umtsTxPower};
  constexpr std::array kGsmPower{Kpi::gsmTxPower};
  switch (technology) {
    case Technology::lte:
      return {rrcLine(drive, technology),
              registrationLine(drive, Registration::emm),
              drxLine(drive),
              carriersLine(drive),
              powerLine(drive, kLtePower),
              bearersLine(drive)};
    case Technology::umts:
      return {rrcLine(drive, technology), registrationLine(drive, Registration::gmm),
              registrationLine(drive, Registration::mm), powerLine(drive, kUmtsPower), bearersLine(drive)};
    case Technology::gsm:
      return {rrcLine(drive, technology), registrationLine(drive, Registration::gmm),
              registrationLine(drive, Registration::mm), powerLine(drive, kGsmPower), bearersLine(drive)};
  }
  return {};
}

}  // namespace

void drawConnection(const Canvas& canvas, const insight::Present& drive) {
  constexpr int kIndentOfLabel = 1;
  constexpr int kIndentOfText = 9;
  const auto& technology = drive.timeline().mobility().technology();
  if (!technology) return;
  int line = 0;
  for (const ConnectionLine& each : linesOf(drive, *technology)) {
    canvas.write(kIndentOfLabel, line, each.label, Role::Plain);
    canvas.write(kIndentOfText, line, each.text.empty() ? "–" : each.text, each.text.empty() ? Role::Faint : each.role);
    ++line;
  }
}

}  // namespace vesk
