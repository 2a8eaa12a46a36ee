#pragma once

#include <array>
#include <cstdlib>
#include <gtest/gtest.h>
#include <string>
#include <string_view>

#include "diag/translation/translator.h"
#include "messages/registry/metric_classes.h"
#include "support/bytes.h"
#include "values/text_form.h"

namespace vesk::diag {

/// Puts `value` into `width` bits of a little-endian number of `bytes` bytes.
inline void putBits(Bytes& body, std::size_t at, std::size_t bytes, unsigned bit, unsigned width, std::int64_t value) {
  for (unsigned index = 0; index < width; ++index) {
    const std::size_t place = bit + index;
    ASSERT_LT(place / 8, bytes);
    if ((value >> index & 1) != 0) body[at + place / 8] |= static_cast<std::uint8_t>(1U << place % 8);
  }
}

/// The bytes of a message, points between them passed over: "07.4171".
inline Bytes messageOf(std::string_view hex) {
  std::string digits(hex);
  std::erase(digits, '.');
  return bytesOf(digits);
}

/// The same with their number before them.
inline std::string withLength(std::string_view hex) {
  return hexOf(std::array{static_cast<std::uint8_t>(messageOf(hex).size())}) + std::string(hex);
}

/// A body from its fields: "b7=3 h4=185 w16=5780" are the byte, 16-bit and 32-bit numbers at an offset,
/// "w16[10:12]=640" is 12 bits from bit 10 on, "x19=2A.02" are bytes, "n19=0.1011.00" bits from the first byte's most
/// significant on. The offsets behind "@12" count from 12. The body is as long as its last field needs.
inline Bytes bodyOf(std::string_view fields) {
  Bytes body;
  std::size_t origin = 0;
  while (!fields.empty()) {
    const std::string token(fields.substr(0, fields.find(' ')));
    fields.remove_prefix(std::min(token.size() + 1, fields.size()));
    char* rest = nullptr;
    const char kind = token.at(0);
    const std::size_t number = std::strtoul(token.c_str() + 1, &rest, 10);
    if (kind == '@') {
      origin = number;
      continue;
    }
    const std::size_t at = origin + number;
    std::size_t bytes = kind == 'b' ? 1 : kind == 'h' ? 2 : 4;
    unsigned bit = 0;
    auto width = static_cast<unsigned>(8 * bytes);
    if (*rest == '[') {
      bit = static_cast<unsigned>(std::strtoul(rest + 1, &rest, 10));
      width = static_cast<unsigned>(std::strtoul(rest + 1, &rest, 10));
      ++rest;
    }
    const std::string value = rest + 1;
    if (kind == 'x') {
      const Bytes more = messageOf(value);
      body.resize(std::max(body.size(), at));
      body.insert(body.end(), more.begin(), more.end());
    } else if (kind == 'n') {
      std::size_t place = 8 * at;
      for (const char c : value) {
        if (c == '.') continue;
        body.resize(std::max(body.size(), place / 8 + 1));
        if (c == '1') body[place / 8] |= static_cast<std::uint8_t>(128U >> place % 8);
        ++place;
      }
    } else {
      body.resize(std::max(body.size(), at + bytes));
      putBits(body, at, bytes, bit, width, std::atoll(value.c_str()));
    }
  }
  return body;
}

inline constexpr std::uint64_t kPacketMs = 1'500'000'000'000;

/// What a translation tells: "damaged", "passed over", or each event's class, without the "KCellular" before it, and
/// its fields, without the timestamp, which must be the packet's: "LteRrcState {state: 1}".
inline std::string told(const Translation& translation, std::uint64_t milliseconds = kPacketMs) {
  if (translation.reading != Reading::read) {
    EXPECT_TRUE(translation.events.empty());
    return translation.reading == Reading::damaged ? "damaged" : "passed over";
  }
  std::string text;
  for (const Event& event : translation.events) {
    EXPECT_EQ(event.milliseconds, milliseconds);
    const MetricClass* metric = findMetricClass(event.metricId);
    const auto fields = metric->decode(event.payload);
    std::string shown = textOf(fields.value());
    const std::string timestamp = "timestamp: " + std::to_string(milliseconds);
    EXPECT_EQ(shown.substr(1, timestamp.size()), timestamp);
    shown.erase(1, timestamp.size() + (shown.size() > timestamp.size() + 2 ? 2 : 0));
    text += (text.empty() ? "" : " ") + std::string(metric->name.substr(std::string_view("KCellular").size())) + shown;
  }
  return text;
}

inline std::string told(Translator& translator, std::uint16_t code, std::span<const std::uint8_t> body,
                        std::uint64_t milliseconds = kPacketMs, std::uint32_t sim = 1) {
  return told(translator.translate({code, milliseconds, sim, body}), milliseconds);
}

inline std::string told(Translator& translator, std::uint16_t code, std::string_view fields,
                        std::uint64_t milliseconds = kPacketMs, std::uint32_t sim = 1) {
  return told(translator, code, std::span<const std::uint8_t>(bodyOf(fields)), milliseconds, sim);
}

/// One packet that is as long as what is read of it, and what it tells.
struct TranslationCase {
  std::uint16_t code;
  std::string_view body;
  std::string_view isTold;
};

/// Cut off anywhere, the packet is damaged and leaves no trace: whole, it then tells what it tells at first.
inline void expectTranslation(const TranslationCase& row) {
  const Bytes body = bodyOf(row.body);
  Translator translator;
  for (std::size_t size = 0; size < body.size(); ++size)
    EXPECT_EQ(told(translator, row.code, std::span(body).first(size)), "damaged") << row.body << ", " << size;
  EXPECT_EQ(told(translator, row.code, body), row.isTold) << std::hex << row.code << ' ' << row.body;
}

}  // namespace vesk::diag
