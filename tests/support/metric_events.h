#pragma once

#include <cstdint>
#include <span>

#include "messages/codec/proto_codable.h"
#include "values/value.h"

namespace vesk {

inline Data encoded(const ProtoCodable& message) {
  ProtoWriter writer;
  message.writeTo(writer);
  return Data::copy(writer.written());
}

/// The event as the link hands it on.
inline Dictionary metricEvent(std::int64_t metricId, Data payload) {
  return {{"kKeyMetricID"_text, metricId}, {"kKeyPayload"_text, std::move(payload)}};
}

inline Dictionary metricEvent(std::int64_t metricId, const ProtoCodable& message) {
  return metricEvent(metricId, encoded(message));
}

}  // namespace vesk
