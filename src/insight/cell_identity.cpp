#include "insight/cell_identity.h"

#include <array>

#include "messages/shared/lte_bands.h"

namespace vesk::insight {

namespace {

using Part = OptionalNumber<std::int64_t>;

bool differs(const Part& one, const Part& other) {
  return one && other && *one != *other;
}

void fill(Part& part, const Part& other) {
  if (!part) part = other;
}

void appendWord(std::string& out, std::string_view name, std::int64_t number) {
  if (!out.empty()) out += ' ';
  out += name;
  out += ' ';
  out += std::to_string(number);
}

void appendChannel(std::string& out, Technology technology, std::int64_t channel) {
  constexpr std::array<std::string_view, kTechnologies.size()> kNames{"EARFCN", "UARFCN", "ARFCN"};
  const LteBand* band = technology == Technology::lte ? lteBandOfDownlink(channel) : nullptr;
  if (band != nullptr) {
    appendWord(out, "B" + std::to_string(band->number), channel);
  } else {
    appendWord(out, kNames[indexOf(technology)], channel);
  }
}

}  // namespace

void CellIdentity::fillIn(const CellIdentity& other) {
  fill(channel, other.channel);
  fill(code, other.code);
  fill(cellId, other.cellId);
}

bool differ(const CellIdentity& one, const CellIdentity& other) {
  return differs(one.channel, other.channel) || differs(one.code, other.code) || differs(one.cellId, other.cellId);
}

std::string textOf(Technology technology, const CellIdentity& cell, bool withCellId) {
  constexpr std::array<std::string_view, kTechnologies.size()> kCodes{"PCI", "PSC", "BSIC"};
  std::string out;
  if (cell.code) {
    appendWord(out, kCodes[indexOf(technology)], *cell.code);
  } else if (cell.cellId) {
    appendWord(out, "CI", *cell.cellId);
  }
  if (cell.channel) appendChannel(out, technology, *cell.channel);
  if (withCellId && cell.code && cell.cellId) appendWord(out, "CI", *cell.cellId);
  return out;
}

std::pair<std::string, std::string> textsOf(Technology technology, const CellIdentity& from, const CellIdentity& to) {
  const bool lookAlike = from.code == to.code && from.channel == to.channel;
  return {textOf(technology, from, lookAlike), textOf(technology, to, lookAlike)};
}

}  // namespace vesk::insight
