#pragma once

#include <benchmark/benchmark.h>
#include <google/protobuf/util/json_util.h>

#include "bench/kinds.h"

namespace vesk::bench {

template <class Message>
bool parse(Message& message, Payload payload) {
  return message.ParseFromArray(payload.data(), static_cast<int>(payload.size()));
}

template <class Message>
bool readIntoJsonByUtility(Payload payload, std::string& json) {
  Message message;
  if (!parse(message, payload)) return false;
  google::protobuf::util::JsonPrintOptions options;
  options.preserve_proto_field_names = true;
  return google::protobuf::util::MessageToJsonString(message, &json, options).ok();
}

template <class Message>
constexpr LibprotobufOperations libprotobufOperations() {
  return {
      .readOnHeap =
          [](Payload payload) {
            const auto message = std::make_unique<Message>();
            benchmark::DoNotOptimize(message.get());
            return parse(*message, payload);
          },
      .readInArena =
          [](Payload payload, google::protobuf::Arena& arena) {
            auto* message = google::protobuf::Arena::CreateMessage<Message>(&arena);
            benchmark::DoNotOptimize(message);
            return parse(*message, payload);
          },
      .readIntoJsonByReflection =
          [](Payload payload, ReflectionWalk& walk, std::string& json) {
            Message message;
            if (!parse(message, payload)) return false;
            walk.appendJson(json, message);
            return true;
          },
      .readIntoJsonByUtility = readIntoJsonByUtility<Message>,
      .make = [](Payload payload) -> std::unique_ptr<LibprotobufMessage> {
        auto message = std::make_unique<Message>();
        return parse(*message, payload) ? std::move(message) : nullptr;
      },
      .write =
          [](const LibprotobufMessage& message) {
            std::string bytes;
            static_cast<const Message&>(message).SerializeToString(&bytes);
            return bytes;
          },
  };
}

}  // namespace vesk::bench
