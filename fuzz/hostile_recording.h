#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "values/data.h"

namespace vesk {

/// Texts that would act on a terminal, or mislead its reader, were they sent to it as they are.
inline constexpr std::array<std::string_view, 14> kHostileTexts{
    "\x1B[2J\x1B[31;1mred\x1B[10000;10000H",
    "\x1B]0;a title\x07\x1B]52;c;Y29weQ==\x1B\\",
    "\x1BPq#0;2;0;0;0\x1B\\\x1B_a\x1B\\\x1B^b\x1B\\\x1B"
    "c",
    "\x9B"
    "31m\x90q\x9C\x84\x85\x8D",
    "\xC2\x9B"
    "31m\xC2\x90q\xC2\x9C\xC2\x85",
    "\x01\x02\x03\x04\x05\x06\x07\b\t\n\v\f\r\x0E\x0F\x10\x11\x12\x13\x14\x15\x16\x17\x18\x19\x1A\x1C\x1D\x1E\x1F\x7F",
    {"\0a\0\0b", 5},
    "user\u202Egnp.exe\u202C\u2066\u200F\u061C\u2028\u2029\u200B\uFEFF\u00AD",
    "\xFF\xFE\xC0\x80\xC1\xBF\xED\xA0\x80\xF4\x90\x80\x80\xF8\x88\x80\x80\x80\xE2\x82",
    "e\u0301\u0302\u0303\u0304\u0305\u0306\u0307\u0308\u0309\u030A\u030B\u030C\u0489\u20DD",
    "\u4E00\u4E8C\uFF21\U0001F468\u200D\U0001F469\u200D\U0001F467\U0001F1E9\U0001F1EA",
    "\u0301\u200D\uFE0F\u3099",
    "a\r\nb\r\r\n\n\nc\td\be",
    "%s%n$<5>$<1000/>\\x1B",
};

struct HostileEvent {
  std::int64_t metricId;
  Data payload;
};

/// Events whose payloads hold every kind of value as long and as far out as it can be, in every metric: files of 64
/// KiB, hostile texts up to 64 KiB, lists of hundreds, numbers at their ends; and some that are damaged, or of no
/// metric.
[[nodiscard]] std::vector<HostileEvent> hostileEvents();

/// The lines of them, a tenth of a second apart.
[[nodiscard]] std::string hostileRecording();

}  // namespace vesk
