#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "messages/codec/proto_codable.h"
#include "messages/codec/proto_reader.h"
#include "values/value.h"

namespace vesk {

/// The dictionary form of the message in `payload`; absent when the payload is no encoding of one.
using DecodePayload = std::optional<Dictionary> (*)(std::span<const std::uint8_t> payload);

template <class MetricMessage>
std::optional<Dictionary> decodePayload(std::span<const std::uint8_t> payload) {
  MetricMessage message;
  ProtoReader reader(payload);
  if (!message.readFrom(reader)) return std::nullopt;
  return message.dictionaryRepresentation();
}

/// Appends the JSON form of the message in `payload`. False, with nothing appended, when the payload is no encoding of
/// one.
using AppendPayloadJson = bool (*)(std::string& out, std::span<const std::uint8_t> payload);

template <class MetricMessage>
bool appendPayloadJson(std::string& out, std::span<const std::uint8_t> payload) {
  MetricMessage message;
  ProtoReader reader(payload);
  if (!message.readFrom(reader)) return false;
  message.appendJson(out);
  return true;
}

/// The message in `payload`, or null when the payload is no encoding of one.
using DecodeMessage = std::shared_ptr<ProtoCodable> (*)(std::span<const std::uint8_t> payload);

template <class MetricMessage>
std::shared_ptr<ProtoCodable> decodeMessage(std::span<const std::uint8_t> payload) {
  return MetricMessage::initWithData(payload);
}

/// A kind of metric and the class that decodes it.
struct MetricClass {
  /// As an event carries it: 0x3C in the high byte, the registry's identifier in the low 16 bits.
  std::int64_t metricId;
  std::string_view name;
  DecodePayload decode;
  AppendPayloadJson appendJson;
  DecodeMessage decodeMessage;
};

/// The class of a metric, or null when no class decodes it.
[[nodiscard]] const MetricClass* findMetricClass(std::int64_t metricId);

}  // namespace vesk
