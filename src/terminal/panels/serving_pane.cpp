#include "terminal/panels/serving_pane.h"

#include <algorithm>
#include <array>
#include <string>

#include "insight/enumeration_names.h"
#include "insight/text_forms.h"
#include "terminal/panels/cell_words.h"
#include "terminal/panels/kpi_look.h"
#include "terminal/panels/level_bar.h"
#include "terminal/panels/trend_span.h"

namespace vesk {

using insight::Kpi;
using insight::Technology;

namespace {

constexpr std::int64_t kRangeLength = 60'000;
/// From here on there is room for long bars and for the range of the last minute.
constexpr int kRoomyColumns = 60;
constexpr int kBarColumn = 18;
constexpr int kServingIndent = 2;

constexpr std::array kLteKpis{Kpi::lteRsrp, Kpi::lteRsrq, Kpi::lteSinr};
constexpr std::array kUmtsKpis{Kpi::umtsRscp, Kpi::umtsEcNo, Kpi::umtsRssi};
constexpr std::array kGsmKpis{Kpi::gsmRxLev, Kpi::gsmRxQual};

/// "PCI 338   eNB 191040 / 17   TAI 310-410 19980".
std::string identityText(const insight::Present& drive, Technology technology) {
  const auto& mobility = drive.timeline().mobility();
  std::string out;
  const auto add = [&](const std::string& part) { out += (out.empty() ? "" : "   ") + part; };
  if (const auto& cell = mobility.cell()) {
    const auto& [channel, code, cellId] = cell->identity;
    if (code) add(std::string(codeNameOf(technology)) + " " + std::to_string(*code));
    if (cellId) add(siteText(technology, *cellId));
  }
  const insight::Area area = technology == Technology::lte ? insight::Area::tracking : insight::Area::location;
  if (const auto& identity = mobility.area(area)) add(std::string(nameOf(area)) + " " + textOf(*identity));
  return out;
}

/// "EARFCN 5815   B17 742.5 MHz, UL 712.5 MHz   5 MHz wide".
std::string channelText(const insight::Present& drive, Technology technology) {
  const auto& cell = drive.timeline().mobility().cell();
  if (!cell || !cell->identity.channel) return {};
  const auto reading = channelReading(technology, *cell->identity.channel);
  const auto& bandwidth = drive.servingDetails().bandwidth();
  return std::string(channelNameOf(technology)) + " " + std::to_string(*cell->identity.channel) +
         (reading ? "   " + reading->text : "") +
         (bandwidth ? "   " + insight::numberText(*bandwidth) + " MHz wide" : "");
}

void drawUnknown(const Canvas& canvas, int line, const insight::Present& drive, Kpi kpi) {
  const auto age = drive.age(kpi);
  canvas.writeRight(kBarColumn - 1, line, "–", Role::Faint);
  canvas.write(kBarColumn, line, age ? "last " + lastingText(*age) + " ago" : "not reported", Role::Faint);
}

void drawKpi(const Canvas& canvas, int line, const insight::Present& drive, Kpi kpi, bool isSelected) {
  const Role labelRole = isSelected ? Role::Title : Role::Plain;
  if (isSelected) canvas.write(0, line, "▸", Role::Key);
  canvas.write(kServingIndent, line, labelOf(kpi), labelRole);
  const auto value = drive.value(kpi);
  if (!value) return drawUnknown(canvas, line, drive, kpi);
  canvas.writeRight(kBarColumn - 1, line, valueText(kpi, *value), roleOf(kpi, *value));
  const bool isRoomy = canvas.columns() >= kRoomyColumns;
  constexpr int kRangeColumn = 12;
  const int barEnd = kBarColumn + (isRoomy ? std::clamp(canvas.columns() - kRoomyColumns, 20, 40) : 10);
  drawLevelBar(canvas, kBarColumn, line, barEnd - kBarColumn, kpi, *value);
  const int gradeEnd = canvas.write(barEnd + 1, line, gradeText(kpi, *value), roleOf(kpi, *value));
  const auto range = valuesSince(drive.trend().points(kpi), drive.position() - kRangeLength);
  if (!isRoomy || !range) return;
  const std::string text = "60 s " + insight::numberText(range->min) + "…" + insight::numberText(range->max);
  const int column = std::max(gradeEnd + 2, barEnd + kRangeColumn);
  if (column + textWidth(text) <= canvas.columns()) canvas.write(column, line, text, Role::Faint);
}

/// The cell that was measured, where it is not the one that serves.
std::optional<std::int64_t> otherPci(const insight::Present& drive) {
  const auto& cell = drive.timeline().mobility().cell();
  const auto& measured = drive.servingDetails().samplePci();
  return cell && cell->identity.code && measured != cell->identity.code ? measured : std::nullopt;
}

/// "RRC CONNECTED 23 s   serves 4.4 s   age 0.3 s".
std::string stateText(const insight::Present& drive, Technology technology) {
  std::string out;
  const auto add = [&](const std::string& part) { out += (out.empty() ? "" : "   ") + part; };
  const std::int64_t now = drive.now().value_or(0);
  const auto& connections = drive.timeline().connections();
  if (const auto& state = connections.state(technology)) {
    add("RRC " + insight::withBlanks(insight::shortName(state->view())) + " " +
        lastingText(now - connections.stateSince(technology)));
  }
  if (const auto& cell = drive.timeline().mobility().cell()) add("serves " + lastingText(now - cell->since));
  if (const auto age = drive.age(levelOf(technology))) {
    const auto other = otherPci(drive);
    add("age " + lastingText(*age) + (other ? ", of PCI " + std::to_string(*other) : ""));
  }
  return out;
}

/// "Srxlev +26 dB over QRxLevMin -122 dBm   measured PCI agrees".
std::string detailsText(const insight::Present& drive) {
  std::string out;
  const auto& details = drive.servingDetails();
  const auto level = drive.value(Kpi::lteRsrp);
  if (const auto& least = details.leastLevel(); least && level && !otherPci(drive)) {
    const double margin = *level - *least;
    out = "Srxlev " + std::string(margin > 0 ? "+" : "") + insight::numberText(margin) + " dB over QRxLevMin " +
          insight::numberText(*least) + " dBm";
  }
  const auto& cell = drive.timeline().mobility().cell();
  if (level && cell && cell->identity.code && details.samplePci() == cell->identity.code)
    out += std::string(out.empty() ? "" : "   ") + "measured PCI agrees";
  return out;
}

/// "next PCI 62 B4 2000, -104 dBm, -8 dB". One that was told without its frequency only where there is no other, and
/// not when it may be the serving cell.
std::string neighborText(const insight::Present& drive, Technology technology) {
  const auto cells = drive.cellsHeard();
  const auto& serving = drive.timeline().mobility().cell();
  const auto findNeighbor = [&](bool hasChannel) {
    return std::find_if(cells.begin(), cells.end(), [&](const insight::HeardCell& cell) {
      const bool isNeighbor = cell.role == insight::HeardRole::neighbor && cell.key.technology == technology;
      return isNeighbor && cell.level && cell.key.channel.has_value() == hasChannel &&
             (hasChannel || !serving || cell.key.code != serving->identity.code);
    });
  };
  auto best = findNeighbor(true);
  if (best == cells.end()) best = findNeighbor(false);
  if (best == cells.end()) return {};
  return "next " + textOf(technology, {best->key.channel, best->key.code, std::nullopt}) + ", " +
         insight::numberText(*best->level) + " dBm" +
         (best->difference
              ? ", " + std::string(*best->difference > 0 ? "+" : "") + insight::numberText(*best->difference) + " dB"
              : "");
}

}  // namespace

std::span<const Kpi> servingKpis(Technology technology) {
  switch (technology) {
    case Technology::lte:
      return kLteKpis;
    case Technology::umts:
      return kUmtsKpis;
    case Technology::gsm:
      return kGsmKpis;
  }
  return {};
}

void drawServing(const Canvas& canvas, const insight::Present& drive, std::optional<Kpi> selected) {
  const auto& technology = drive.timeline().mobility().technology();
  if (drive.timeline().registrations().noServiceSince()) {
    const std::int64_t since = drive.now().value_or(0) - *drive.timeline().registrations().noServiceSince();
    canvas.write(kServingIndent, canvas.lines() - 1, "NO SERVICE for " + lastingText(since), Role::Alarm);
  }
  if (!technology) {
    canvas.write(kServingIndent, 0, "no technology yet", Role::Title);
    canvas.write(kServingIndent, 1, drive.counts().all == 0 ? "waiting for the first event" : "no cell was told so far",
                 Role::Faint);
    return;
  }
  const std::string identity = identityText(drive, *technology);
  canvas.write(kServingIndent, 0, identity.empty() ? "cell not known" : identity,
               identity.empty() ? Role::Faint : Role::Title);
  canvas.write(kServingIndent, 1, channelText(drive, *technology), Role::Plain);
  int line = kFirstKpiLine;
  for (const Kpi kpi : servingKpis(*technology))
    drawKpi(canvas, line++, drive, kpi, kpi == selected);
  const int room = canvas.lines() - (drive.timeline().registrations().noServiceSince() ? 1 : 0);
  canvas.write(kServingIndent, line++, stateText(drive, *technology), otherPci(drive) ? Role::Fair : Role::Plain);
  const std::string details = line + 1 < room ? detailsText(drive) : "";
  if (!details.empty()) canvas.write(kServingIndent, line++, details, Role::Plain);
  if (line < room) canvas.write(kServingIndent, line, neighborText(drive, *technology), Role::Faint);
}

}  // namespace vesk
