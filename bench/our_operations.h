#pragma once

#include <benchmark/benchmark.h>

#include "app/json_form.h"
#include "bench/kinds.h"

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
            const auto message = Message::initWithData(payload);
            if (message == nullptr) return false;
            const Dictionary dictionary = message->dictionaryRepresentation();
            benchmark::DoNotOptimize(dictionary.begin());
            return true;
          },
      .readIntoJson =
          [](Payload payload, std::string& json) {
            const auto message = Message::initWithData(payload);
            if (message == nullptr) return false;
            appendJson(json, message->dictionaryRepresentation());
            return true;
          },
      .make = [](Payload payload) -> std::shared_ptr<ProtoCodable> { return Message::initWithData(payload); },
      .write =
          [](const ProtoCodable& message, ProtoWriter& writer) {
            writer.clear();
            static_cast<const Message&>(message).Message::writeTo(writer);
            return Data::copy(writer.written());
          },
  };
}

}  // namespace vesk::bench
