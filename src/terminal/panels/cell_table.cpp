#include "terminal/panels/cell_table.h"

#include <algorithm>
#include <array>
#include <string>
#include <string_view>

#include "insight/text_forms.h"
#include "terminal/panels/cell_words.h"
#include "terminal/panels/kpi_look.h"
#include "terminal/panels/level_bar.h"

namespace vesk {

using insight::HeardCell;

namespace {

using Number = std::optional<double>;

std::string textOfNumber(const Number& number) {
  return number ? insight::numberText(*number) : "";
}
std::string textOfInteger(const std::optional<std::int64_t>& number) {
  return number ? std::to_string(*number) : "";
}

std::optional<insight::Reading> channelOf(const HeardCell& cell) {
  return cell.key.channel ? channelReading(cell.key.technology, *cell.key.channel) : std::nullopt;
}

std::string technologyText(const HeardCell& cell) {
  return std::string(nameOf(cell.key.technology));
}
std::string bandText(const HeardCell& cell) {
  const auto reading = channelOf(cell);
  if (!reading || !reading->band) return "";
  return (cell.key.technology == insight::Technology::lte ? "B" : "") + *reading->band;
}
std::string channelNumberText(const HeardCell& cell) {
  return textOfInteger(cell.key.channel);
}
std::string frequencyText(const HeardCell& cell) {
  const auto reading = channelOf(cell);
  return reading && reading->downlink ? insight::megahertzText(*reading->downlink) : "";
}
std::string codeText(const HeardCell& cell) {
  return textOfInteger(cell.key.code);
}
std::string levelText(const HeardCell& cell) {
  return cell.level ? textOfNumber(cell.level) : "–";
}
std::string differenceText(const HeardCell& cell) {
  if (cell.role == insight::HeardRole::serving || !cell.difference) return "";
  return (*cell.difference > 0 ? "+" : "") + textOfNumber(cell.difference);
}
std::string qualityText(const HeardCell& cell) {
  return textOfNumber(cell.quality);
}
std::string nothing(const HeardCell& /*cell*/) {
  return "";
}
std::string ageText(const HeardCell& cell) {
  return lastingText(cell.age);
}

Number number(const std::optional<std::int64_t>& integer) {
  return integer ? Number(static_cast<double>(*integer)) : std::nullopt;
}
Number technologyRank(const HeardCell& cell) {
  return static_cast<double>(cell.key.technology);
}
Number channelRank(const HeardCell& cell) {
  return number(cell.key.channel);
}
Number frequencyRank(const HeardCell& cell) {
  const auto reading = channelOf(cell);
  return reading && reading->downlink ? Number(*reading->downlink) : std::nullopt;
}
Number codeRank(const HeardCell& cell) {
  return number(cell.key.code);
}
Number levelRank(const HeardCell& cell) {
  return cell.level;
}
Number differenceRank(const HeardCell& cell) {
  return cell.difference;
}
Number qualityRank(const HeardCell& cell) {
  return cell.quality;
}
Number ageRank(const HeardCell& cell) {
  return static_cast<double>(cell.age);
}
Number noteRank(const HeardCell& cell) {
  return cell.role == insight::HeardRole::neighbor ? number(cell.servedAgo) : Number(-1);
}

struct CellColumn {
  std::string_view head;
  int width;
  bool isAtRight;
  /// The width of a table that has room for it.
  int fromColumns;
  std::string (*text)(const HeardCell&);
  /// Null for a column that cells are not sorted by.
  Number (*rank)(const HeardCell&) = nullptr;
  bool isFallingFirst = false;
};

// clang-format off
constexpr std::array kColumns{
    CellColumn{"RAT", 4, false, 0, technologyText, technologyRank},
    CellColumn{"band", 9, false, 70, bandText, frequencyRank},
    CellColumn{"channel", 7, true, 0, channelNumberText, channelRank},
    CellColumn{"MHz", 6, true, 60, frequencyText, frequencyRank},
    CellColumn{"code", 5, true, 0, codeText, codeRank},
    CellColumn{"level", 6, true, 0, levelText, levelRank, true},
    CellColumn{"diff", 5, true, 0, differenceText, differenceRank, true},
    CellColumn{"quality", 8, true, 50, qualityText, qualityRank, true},
    CellColumn{"", 20, false, 104, nothing},
    CellColumn{"age", 6, true, 64, ageText, ageRank},
    CellColumn{"note", 25, false, 78, nothing, noteRank},
};
// clang-format on
constexpr std::size_t kLevelBarColumn = 8;
constexpr std::size_t kNoteColumn = 10;
constexpr int kTableGutter = 2;

constexpr int gapAfter(const CellColumn& column) {
  return column.isAtRight ? 1 : 2;
}

/// What all columns take but the bar, whose width is what they leave.
constexpr int kBesideBar = [] {
  int columns = kTableGutter - kColumns[kLevelBarColumn].width - gapAfter(kColumns.back());
  for (const CellColumn& column : kColumns)
    columns += column.width + gapAfter(column);
  return columns;
}();
static_assert(kColumns[kLevelBarColumn].fromColumns > kBesideBar, "a bar has some width wherever there is one");

Role textRole(std::size_t column, const HeardCell& cell) {
  constexpr std::size_t kLevel = 5;
  constexpr std::size_t kQuality = 7;
  if (column == kLevel && cell.level) return roleOf(levelOf(cell.key.technology), *cell.level);
  const auto quality = qualityOf(cell.key.technology);
  if (column == kQuality && cell.quality && quality) return roleOf(*quality, *cell.quality);
  return Role::Plain;
}

/// Beyond it nobody looks for a cell's past.
constexpr std::int64_t kRemembered = 60'000;

}  // namespace

CellNotes::CellNotes(const insight::Present& drive, const std::vector<HeardCell>& cells) {
  const std::int64_t now = drive.now().value_or(0);
  const auto& happenings = drive.happenings();
  for (std::size_t index = happenings.size(); index-- > 0;) {
    const insight::TimelineEvent& each = happenings[index];
    const std::int64_t ago = now - each.moment.time;
    if (ago > kRemembered) break;
    const auto* entry = std::get_if<insight::Reestablishment>(&each.fields);
    if (entry != nullptr && entry->to)
      reestablished_.push_back({{entry->technology, entry->to->channel, entry->to->code}, ago});
  }
  for (const insight::Technology technology : insight::kTechnologies) {
    const HeardCell* best = nullptr;
    for (const HeardCell& cell : cells) {
      if (cell.key.technology == technology && cell.quality && (best == nullptr || cell.quality > best->quality))
        best = &cell;
    }
    if (best != nullptr && best->role == insight::HeardRole::neighbor) best_.push_back(best->key);
  }
}

std::string CellNotes::of(const HeardCell& cell) const {
  if (cell.role != insight::HeardRole::neighbor) return std::string(nameOf(cell.role));
  const auto entered = std::find_if(reestablished_.begin(), reestablished_.end(),
                                    [&](const Entered& each) { return each.cell == cell.key; });
  if (entered != reestablished_.end()) return "re-established " + lastingText(entered->ago) + " ago";
  if (cell.servedAgo) return "served " + lastingText(*cell.servedAgo) + " ago";
  return std::find(best_.begin(), best_.end(), cell.key) != best_.end() ? "best quality" : "";
}

CellTable::CellTable(int columns) {
  int start = kTableGutter;
  for (std::size_t column = 0; column < kColumns.size(); ++column) {
    const CellColumn& each = kColumns[column];
    if (columns < each.fromColumns) continue;
    const int width = column == kLevelBarColumn ? std::min(each.width, columns - kBesideBar) : each.width;
    places_.push_back({column, start, std::min(start + width, columns)});
    start += width + gapAfter(each);
  }
}

void CellTable::drawHeads(const Canvas& canvas, const std::optional<CellOrder>& order) const {
  for (const Place& place : places_) {
    const CellColumn& column = kColumns[place.column];
    std::string head(column.head);
    if (order && order->column == place.column) head += order->isFalling ? "↓" : "↑";
    if (column.isAtRight) {
      canvas.writeRight(place.end, 0, head, Role::Faint);
    } else {
      canvas.write(place.start, 0, head, Role::Faint, place.end);
    }
  }
}

void CellTable::drawRow(const Canvas& canvas, int line, const HeardCell& cell, const CellNotes& notes,
                        bool isSelected) const {
  if (isSelected) canvas.fill(line, Role::Selected);
  const auto roleFor = [&](Role role) { return isSelected ? Role::Selected : role; };
  if (cell.role == insight::HeardRole::serving) canvas.write(0, line, "▸", roleFor(Role::Key));
  for (const Place& place : places_) {
    const CellColumn& column = kColumns[place.column];
    const Role role = roleFor(textRole(place.column, cell));
    if (place.column == kLevelBarColumn && cell.level) {
      drawLevelBar(canvas, place.start, line, place.end - place.start, levelOf(cell.key.technology), *cell.level);
    } else if (place.column == kNoteColumn) {
      canvas.write(place.start, line, notes.of(cell), role, place.end);
    } else if (column.isAtRight) {
      canvas.writeRight(place.end, line, column.text(cell), role);
    } else {
      canvas.write(place.start, line, column.text(cell), role, place.end);
    }
  }
}

std::optional<std::size_t> CellTable::columnAt(int column) const {
  for (const Place& place : places_) {
    const bool hasRank = kColumns[place.column].rank != nullptr;
    if (hasRank && place.start - 1 <= column && column < place.end) return place.column;
  }
  return std::nullopt;
}

CellOrder naturalOrder(std::size_t column) {
  return {column, kColumns[column].isFallingFirst};
}

std::optional<CellOrder> orderAfter(const std::optional<CellOrder>& order) {
  for (std::size_t column = order ? order->column + 1 : 0; column < kColumns.size(); ++column)
    if (kColumns[column].rank != nullptr) return naturalOrder(column);
  return std::nullopt;
}

void sortCells(std::vector<HeardCell>& cells, const CellOrder& order) {
  const auto rank = kColumns[order.column].rank;
  std::stable_sort(cells.begin(), cells.end(), [&](const HeardCell& one, const HeardCell& other) {
    const Number first = rank(one);
    const Number second = rank(other);
    if (!first || !second) return first.has_value() && !second.has_value();
    return order.isFalling ? *first > *second : *first < *second;
  });
}

}  // namespace vesk
