#pragma once

#include <cstdint>
#include <google/protobuf/arena.h>
#include <google/protobuf/message.h>
#include <memory>
#include <span>
#include <string>
#include <string_view>

#include "bench/peers/reflection_walk.h"
#include "messages/codec/proto_codable.h"
#include "values/data.h"

namespace vesk::bench {

using Payload = std::span<const std::uint8_t>;
using LibprotobufMessage = google::protobuf::Message;

/// What the project's class of a kind does. Every operation is one function of the class that is called directly, so
/// that the choice of the class costs each side one call through a pointer and no more.
struct OurOperations {
  /// Makes the object and frees it.
  bool (*read)(Payload payload);
  /// These two over a local object, as the program does it.
  bool (*readIntoDictionary)(Payload payload);
  bool (*readIntoJson)(Payload payload, std::string& json);
  std::shared_ptr<ProtoCodable> (*make)(Payload payload);
  Data (*write)(const ProtoCodable& message, ProtoWriter& writer);
};

/// The same of libprotobuf's class.
struct LibprotobufOperations {
  bool (*readOnHeap)(Payload payload);
  bool (*readInArena)(Payload payload, google::protobuf::Arena& arena);
  /// These two over a local object, as well.
  bool (*readIntoJsonByReflection)(Payload payload, ReflectionWalk& walk, std::string& json);
  bool (*readIntoJsonByUtility)(Payload payload, std::string& json);
  std::unique_ptr<LibprotobufMessage> (*make)(Payload payload);
  std::string (*write)(const LibprotobufMessage& message);
};

/// A kind of metric, in every hand.
struct Kind {
  std::int64_t metricId;
  std::string_view name;
  OurOperations ours;
  LibprotobufOperations libprotobuf;
  std::uint64_t (*visitByProtozero)(Payload payload);
};

/// Null for a metric that has no class.
[[nodiscard]] const Kind* findKind(std::int64_t metricId);

}  // namespace vesk::bench
