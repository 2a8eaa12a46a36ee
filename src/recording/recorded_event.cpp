#include "recording/recorded_event.h"

#include <algorithm>
#include <charconv>
#include <cstring>

#include "recording/hex.h"
#include "values/ascii.h"
#include "values/parse_number.h"
#include "values/text_form.h"
#include "values/utf8.h"

#ifdef __SSE2__
#define RAPIDJSON_SSE2
#endif
#include <rapidjson/reader.h>

namespace vesk {

namespace {

constexpr const char* kNotJson = "not valid JSON";
constexpr const char* kControlCharacter = "a text holds a control character";
constexpr const char* kNotClosed = "does not end with the object's closing brace: is the line cut off?";
constexpr std::string_view kBlanks = " \t\r";
/// Payloads of longer lines make the parser grow.
constexpr std::size_t kUsualPayload = 8192;
/// How deep the values of other keys may be nested. The reader calls itself for each level.
constexpr int kDeepest = 500;

constexpr unsigned kReading =
    rapidjson::kParseInsituFlag | rapidjson::kParseStopWhenDoneFlag | rapidjson::kParseNumbersAsStringsFlag;

/// Why no JSON text can hold these characters; null when one can. The reader leaves it unchecked whether texts are
/// UTF-8 and, where it looks at sixteen characters at once, some of the control characters.
const char* whyNoJson(std::string_view line) {
  while (!line.empty()) {
    const auto byte = static_cast<std::uint8_t>(line.front());
    if (byte < 0x20 && kBlanks.find(line.front()) == std::string_view::npos) return kControlCharacter;
    const std::size_t size = byte < 0x80 ? 1 : utf8CharacterSize(line);
    if (size == 0) return "not valid UTF-8";
    line.remove_prefix(size);
  }
  return nullptr;
}

/// A positive number in "0x…" text.
std::optional<std::int64_t> parseHexNumber(std::string_view text) {
  if (!text.starts_with("0x") && !text.starts_with("0X")) return std::nullopt;
  text.remove_prefix(2);
  // from_chars would take a sign.
  if (text.empty() || hexDigit(text[0]) >= 16) return std::nullopt;
  std::int64_t number = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number, 16);
  if (error != std::errc{} || end != text.data() + text.size()) return std::nullopt;
  return number;
}

}  // namespace

/// Seconds, thirty years: no replay waits longer, and every clock can hold it.
constexpr double kLatest = 1e9;

/// Takes what the reader finds in a line, piece by piece. The functions that it calls go by its names; false ends
/// the reading, and the parser's reason is set.
class RecordedEventParser::Fields : public rapidjson::BaseReaderHandler<rapidjson::UTF8<>, Fields> {
 public:
  explicit Fields(RecordedEventParser& parser) : parser_(parser) {}

  std::optional<double> at;
  std::optional<std::int64_t> metricId;
  bool hasPayload = false;

  bool Key(const char* text, rapidjson::SizeType length, bool /*copy*/) {
    if (depth_ > 1) return true;
    const std::string_view name(text, length);
    key_ = name == "at" ? Name::at : name == "metric" ? Name::metric : name == "payload" ? Name::payload : Name::other;
    const bool isGiven =
        (key_ == Name::at && at) || (key_ == Name::metric && metricId) || (key_ == Name::payload && hasPayload);
    return !isGiven || parser_.fail('"' + std::string(name) + "\": given twice");
  }

  bool String(const char* text, rapidjson::SizeType length, bool /*copy*/) {
    if (key_ == Name::metric) {
      metricId = parseHexNumber({text, length});
      return metricId || Default();
    }
    if (key_ == Name::payload) return hasPayload = parser_.decodePayload({text, length});
    return Default();
  }

  bool RawNumber(const char* text, rapidjson::SizeType length, bool /*copy*/) {
    if (key_ == Name::at) {
      at = parseNumber<double>({text, length});
      if (!at) return Default();
      if (*at > kLatest) return parser_.fail("\"at\": expected at most a billion seconds");
      return *at >= 0 || parser_.fail("\"at\": expected seconds that are not negative");
    }
    if (key_ == Name::metric) {
      metricId = parseNumber<std::int64_t>({text, length});
      return metricId || Default();
    }
    return Default();
  }

  bool StartObject() { return depth_ == 0 ? ++depth_ != 0 : enter(); }
  bool StartArray() { return enter(); }
  bool EndObject(rapidjson::SizeType /*count*/) { return leave(); }
  bool EndArray(rapidjson::SizeType /*count*/) { return leave(); }

  /// A value of a kind that is not expected here.
  bool Default() {
    switch (key_) {
      case Name::at:
        return parser_.fail("\"at\": expected seconds, a number");
      case Name::metric:
        return parser_.fail("\"metric\": expected an integer or \"0x…\" text, at most 64 bits");
      case Name::payload:
        return parser_.fail("\"payload\": expected hex text");
      case Name::other:
        break;
    }
    return true;
  }

 private:
  enum class Name { at, metric, payload, other };

  bool enter() {
    if (!Default()) return false;
    return ++depth_ <= kDeepest || parser_.fail("nested too deeply");
  }
  bool leave() {
    --depth_;
    return true;
  }

  RecordedEventParser& parser_;
  int depth_ = 0;
  /// Whose value comes next; `other` within the values of other keys.
  Name key_ = Name::other;
};

void appendMetricId(std::string& out, std::int64_t metricId) {
  if (metricId < 0) {
    appendDecimal(out, metricId);
    return;
  }
  out += "\"0x";
  appendUpperHex(out, static_cast<std::uint64_t>(metricId));
  out += '"';
}

void appendRecordedEvent(std::string& out, const RecordedEvent& event) {
  out += "{\"at\": ";
  appendDecimal(out, event.at);
  out += ", \"metric\": ";
  appendMetricId(out, event.metricId);
  out += ", \"payload\": \"";
  appendHex(out, event.payload);
  out += "\"}\n";
}

std::optional<RecordedEvent> RecordedEventParser::parse(std::span<char> line) {
  Fields fields(*this);
  if (!readFields(line, fields)) return std::nullopt;
  if (!fields.at) {
    fail("\"at\": missing");
  } else if (!fields.metricId) {
    fail("\"metric\": missing");
  } else if (!fields.hasPayload) {
    fail("\"payload\": missing");
  } else {
    return RecordedEvent{*fields.at, *fields.metricId, {payload_.data(), payloadSize_}};
  }
  return std::nullopt;
}

bool RecordedEventParser::readFields(std::span<char> line, Fields& fields) {
  std::string_view text(line.data(), line.size());
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos || text[first] != '{') return fail("no JSON object");
  text = text.substr(0, text.find_last_not_of(kBlanks) + 1);
  if (printableAsciiSize(text) < text.size()) {
    if (const char* reason = whyNoJson(text)) return fail(reason);
  }
  const bool isClosed = text.back() == '}';
  line.data()[text.size()] = '\0';

  rapidjson::InsituStringStream stream(line.data());
  rapidjson::Reader reader;
  const rapidjson::ParseResult result = reader.Parse<kReading>(stream, fields);
  switch (result.Code()) {
    case rapidjson::kParseErrorNone:
      if (stream.Tell() == text.size()) return true;
      return fail(isClosed ? "more than one object" : kNotClosed);
    case rapidjson::kParseErrorTermination:
      return false;
    case rapidjson::kParseErrorStringEscapeInvalid:
      return fail(text[result.Offset()] == '\\' ? kNotJson : kControlCharacter);
    case rapidjson::kParseErrorStringMissQuotationMark:
      return fail("a text has no closing quote: is the line cut off?");
    case rapidjson::kParseErrorNumberTooBig:
      return fields.Default() && fail("a number is beyond all bounds");
    default:
      return fail(isClosed && result.Offset() < text.size() ? kNotJson : kNotClosed);
  }
}

bool RecordedEventParser::decodePayload(std::string_view digits) {
  payloadSize_ = digits.size() / 2;
  if (payload_.size() < payloadSize_) payload_.resize(std::max(kUsualPayload, payloadSize_));
  if (digits.size() % 2 == 0 && decodeHex(digits, payload_.data())) return true;

  for (std::size_t index = 0; index < digits.size(); ++index) {
    if (hexDigit(digits[index]) < 16) continue;
    return fail("\"payload\": character " + std::to_string(index + 1) + " is no hex digit");
  }
  return fail("\"payload\": odd number of hex digits");
}

bool RecordedEventParser::fail(std::string reason) {
  reason_ = std::move(reason);
  return false;
}

}  // namespace vesk
