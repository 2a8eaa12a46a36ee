#pragma once

#include <benchmark/benchmark.h>

#include "bench/kinds.h"
#include "messages/registry/metric_classes.h"

namespace vesk::bench {

template <class Message>
constexpr OurOperations ourOperations() {
  return {
      .read =
          [](Payload payload) {
            const auto message = Message::initWithData(payload);
            benchmark::DoNotOptimize(message.get());
            return message != nullptr;
          },
      .readIntoDictionary =
          [](Payload payload) {
            const std::optional<Dictionary> dictionary = decodePayload<Message>(payload);
            benchmark::DoNotOptimize(dictionary);
            return dictionary.has_value();
          },
      .readIntoJson = [](Payload payload, std::string& json) { return appendPayloadJson<Message>(json, payload); },
      .make = [](Payload payload) -> std::shared_ptr<ProtoCodable> { return Message::initWithData(payload); },
      .write =
          [](const ProtoCodable& message, ProtoWriter& writer) {
            writer.clear();
            static_cast<const Message&>(message).writeTo(writer);
            return Data::copy(writer.written());
          },
  };
}

}  // namespace vesk::bench
