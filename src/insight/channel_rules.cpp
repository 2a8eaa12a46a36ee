#include <string>
#include <utility>

#include "insight/channels.h"
#include "insight/reading_rules.h"
#include "insight/text_forms.h"

namespace vesk::insight {

namespace {

std::string bandText(const LteBand& band) {
  return "B" + std::to_string(band.number);
}

std::string withMegahertz(std::string text, int frequency) {
  return std::move(text) + " " + megahertzText(frequency) + " MHz";
}

/// The band and the frequency of the downlink, and what there is to say of the uplink.
Reading downlinkReading(const LteBand& band, std::int64_t earfcn) {
  const int downlink = band.downlink.frequencyOf(earfcn);
  Reading reading{.text = withMegahertz(bandText(band), downlink),
                  .band = std::to_string(band.number),
                  .downlink = downlink,
                  .uplink = band.uplinkFrequencyOf(earfcn),
                  .duplex = band.duplex};
  switch (band.duplex) {
    case Duplex::FDD:
      if (reading.uplink) reading.text = withMegahertz(reading.text + ", UL", *reading.uplink);
      break;
    case Duplex::TDD:
    case Duplex::SDL:
      reading.text += ' ';
      reading.text += nameOf(band.duplex);
      break;
  }
  return reading;
}

Reading uplinkReading(const LteBand& band, std::int64_t earfcn) {
  const int uplink = band.uplink.frequencyOf(earfcn);
  const bool isShared = band.duplex == Duplex::TDD;
  return {.text = withMegahertz(bandText(band) + (isShared ? "" : " UL"), uplink) + (isShared ? " TDD" : ""),
          .band = std::to_string(band.number),
          .uplink = uplink,
          .duplex = band.duplex};
}

Reading channelReading(const Channel& channel, std::string bandInText) {
  const std::string downlink = withMegahertz(std::move(bandInText), channel.downlink);
  return {.text = withMegahertz(downlink + ", UL", channel.uplink),
          .band = std::string(channel.band),
          .downlink = channel.downlink,
          .uplink = channel.uplink};
}

/// Of a number; absent for what is none. `find` answers with a null or absent channel where no band has the number.
template <class Find, class Read>
std::optional<Reading> readChannel(const Value& value, Find find, Read read) {
  if (!value.number()) return std::nullopt;
  const std::optional<std::int64_t> number = value.integer();
  if (!number) return impossibleReading();
  const auto found = find(*number);
  return found ? read(*found, *number) : impossibleReading();
}

/// The GSM band that a record says it is in, under the keys that records have for it.
std::optional<SharedGsmBand> indicatedBand(const Dictionary& record) {
  const Value* indicator = record.find("gsm_band");
  return sharedGsmBand(indicator != nullptr ? indicator : record.find("scell_band"));
}

}  // namespace

std::optional<Reading> readEarfcn(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  return readChannel(value, lteBandOfDownlink, downlinkReading);
}

std::optional<Reading> readUplinkEarfcn(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  return readChannel(value, lteBandOfUplink, uplinkReading);
}

std::optional<Reading> readBand(const ReadingRule& rule, const Value& value, const Dictionary& record) {
  return readChannel(value, findLteBand, [&](const LteBand& band, std::int64_t number) {
    Reading reading{.text = bandText(band) + " ", .band = std::to_string(number), .duplex = band.duplex};
    reading.text += nameOf(band.duplex);
    const Value* channel = rule.sibling.empty() ? nullptr : record.find(rule.sibling);
    const std::optional<std::int64_t> earfcn = channel == nullptr ? std::nullopt : channel->integer();
    const LteBand* bandOfChannel = earfcn ? lteBandOfDownlink(*earfcn) : nullptr;
    if (bandOfChannel != nullptr && bandOfChannel != &band) {
      reading.text += ", EARFCN is " + bandText(*bandOfChannel);
      reading.mark = Mark::mismatch;
    }
    return reading;
  });
}

std::optional<Reading> readUarfcn(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  return readChannel(value, umtsChannel, [](const Channel& channel, std::int64_t /*uarfcn*/) {
    return channelReading(channel, "band " + std::string(channel.band));
  });
}

std::optional<Reading> readArfcn(const ReadingRule& /*rule*/, const Value& value, const Dictionary& record) {
  const auto find = [&](std::int64_t arfcn) { return gsmChannel(arfcn, indicatedBand(record)); };
  return readChannel(value, find, [](const GsmChannel& channel, std::int64_t /*arfcn*/) {
    Reading reading = channelReading(channel, std::string(channel.band));
    if (channel.otherwise) {
      reading.text = withMegahertz(std::string(channel.band), channel.downlink) + " or " +
                     withMegahertz(std::string(channel.otherwise->band), channel.otherwise->downlink);
      reading.mark = Mark::ambiguous;
    }
    return reading;
  });
}

}  // namespace vesk::insight
