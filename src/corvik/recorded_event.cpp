#include "corvik/recorded_event.h"

#include <array>
#include <charconv>
#include <simdjson.h>

#include "corvik/hex.h"
#include "platform/text_form.h"

namespace corvik {

namespace {

namespace ondemand = simdjson::ondemand;

static_assert(RecordedEventParser::kPadding >= simdjson::SIMDJSON_PADDING);

/// Longer lines make the parser grow.
constexpr std::size_t kUsualLine = 16384;

std::string_view inWords(simdjson::error_code error) {
  switch (error) {
    case simdjson::UNCLOSED_STRING:
      return "a text has no closing quote: is the line cut off?";
    case simdjson::INCOMPLETE_ARRAY_OR_OBJECT:
      return "does not end with the object's closing brace: is the line cut off?";
    case simdjson::UNESCAPED_CHARS:
      return "a text holds a control character";
    case simdjson::UTF8_ERROR:
      return "not valid UTF-8";
    default:
      return "not valid JSON";
  }
}

/// The characters between the quotes of a string token, escapes as written.
std::string_view betweenQuotes(std::string_view token) {
  const std::size_t end = token.rfind('"');
  return end == 0 || end == std::string_view::npos ? std::string_view{} : token.substr(1, end - 1);
}

bool isText(std::string_view token) {
  return token.starts_with('"');
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

struct RecordedEventParser::Json {
  ondemand::parser parser;
};

struct RecordedEventParser::Fields {
  std::optional<double> at;
  std::optional<std::int64_t> metricId;
  bool hasPayload = false;
};

void appendMetricId(std::string& out, std::int64_t metricId) {
  if (metricId < 0) {
    vesk::appendDecimal(out, metricId);
    return;
  }
  out += "\"0x";
  vesk::appendUpperHex(out, static_cast<std::uint64_t>(metricId));
  out += '"';
}

void appendRecordedEvent(std::string& out, const RecordedEvent& event) {
  out += "{\"at\": ";
  vesk::appendDecimal(out, event.at);
  out += ", \"metric\": ";
  appendMetricId(out, event.metricId);
  out += ", \"payload\": \"";
  vesk::appendHex(out, event.payload);
  out += "\"}\n";
}

RecordedEventParser::RecordedEventParser() : json_(std::make_unique<Json>()) {}
RecordedEventParser::RecordedEventParser(RecordedEventParser&&) noexcept = default;
RecordedEventParser& RecordedEventParser::operator=(RecordedEventParser&&) noexcept = default;
RecordedEventParser::~RecordedEventParser() = default;

std::optional<RecordedEvent> RecordedEventParser::parse(std::string_view line) {
  Fields fields;
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

bool RecordedEventParser::readFields(std::string_view line, Fields& fields) {
  const std::size_t first = line.find_first_not_of(" \t\r");
  if (first == std::string_view::npos || line[first] != '{') return fail("no JSON object");

  ondemand::parser& parser = json_->parser;
  if (parser.capacity() < line.size() && parser.allocate(std::max(kUsualLine, line.size() * 2)) != simdjson::SUCCESS) {
    return fail("too long for the memory there is");
  }
  ondemand::document document;
  ondemand::object object;
  simdjson::error_code error = parser.iterate(line.data(), line.size(), line.size() + kPadding).get(document);
  if (error == simdjson::SUCCESS) error = document.get_object().get(object);
  if (error != simdjson::SUCCESS) return fail(std::string(inWords(error)));

  for (auto entry : object) {
    ondemand::field field;
    std::string_view key;
    if ((error = std::move(entry).get(field)) || (error = field.unescaped_key().get(key))) {
      return fail(std::string(inWords(error)));
    }
    ondemand::value& value = field.value();
    const std::string_view token = value.raw_json_token();
    if (key == "at") {
      double at = 0;
      if (fields.at) return fail("\"at\": given twice");
      if (value.get_double().get(at) != simdjson::SUCCESS) return fail("\"at\": expected seconds, a number");
      if (at < 0) return fail("\"at\": expected seconds that are not negative");
      fields.at = at;
    } else if (key == "metric") {
      if (fields.metricId) return fail("\"metric\": given twice");
      std::int64_t number = 0;
      if (isText(token)) {
        fields.metricId = parseHexNumber(betweenQuotes(token));
      } else if (value.get_int64().get(number) == simdjson::SUCCESS) {
        fields.metricId = number;
      }
      if (!fields.metricId) return fail("\"metric\": expected an integer or \"0x…\" text, at most 64 bits");
    } else if (key == "payload") {
      if (fields.hasPayload) return fail("\"payload\": given twice");
      if (!isText(token)) return fail("\"payload\": expected hex text");
      if (!decodePayload(betweenQuotes(token))) return false;
      fields.hasPayload = true;
    }
  }
  const bool isAtEnd = document.current_location().error() == simdjson::OUT_OF_BOUNDS;
  return isAtEnd || fail("more than one object");
}

bool RecordedEventParser::decodePayload(std::string_view digits) {
  payloadSize_ = digits.size() / 2;
  if (payload_.size() < payloadSize_) payload_.resize(std::max(kUsualLine, digits.size()));
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

}  // namespace corvik
