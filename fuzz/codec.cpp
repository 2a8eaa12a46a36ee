// The first byte names a message class, the others are a payload for it.

#include "message_properties.h"
#include "property.h"
#include "support/allocations.h"
#include "wire_model.h"

namespace vesk {
namespace {

using Payload = std::span<const std::uint8_t>;
using Message = std::shared_ptr<ProtoCodable>;

Message decodeWithinBounds(const MessageClass& messageClass, Payload payload) {
  // The smallest element is two bytes of the wire, the largest object some hundred bytes of memory, and a list that
  // grows asks for its room several times over.
  constexpr std::size_t kMostForAByte = 512;
  constexpr std::size_t kMostForNone = 4096;
  const std::uint64_t before = allocatedBytes();
  Message message = messageClass.decode(payload);
  if (message != nullptr) (void)message->dictionaryRepresentation();
  require(allocatedBytes() - before <= kMostForNone + kMostForAByte * payload.size(),
          "the memory that reading takes is in proportion to the input");
  return message;
}

/// In a section keyed by a metric that no class declares.
void checkWrapping(const MessageClass& messageClass, Payload payload, const Message& message) {
  constexpr std::uint32_t kMetric = 20005;
  ProtoWriter writer;
  writer.writeBytes(Data::copy(payload), kMetric);
  const Message unwrapped = messageClass.decode(writer.written());
  require((unwrapped == nullptr) == (message == nullptr), "a wrapped payload is as readable as the bare one");
  if (message != nullptr) requireSame(*unwrapped, *message);
}

void checkCodec(const MessageClass& messageClass, Payload payload) {
  const Message message = decodeWithinBounds(messageClass, payload);
  const std::optional<Dictionary> modelled = modelledDictionary(messageClass.name, payload);
  require((message != nullptr) == modelled.has_value(), "the reader takes what the rules of the wire allow");
  checkWrapping(messageClass, payload, message);
  if (message == nullptr) return;
  require(isSame(message->dictionaryRepresentation(), *modelled), "the reader reads what the rules of the wire say");
  checkJson(*message);
  checkFields(messageClass, payload);
  checkWriting(messageClass, *message, payload.size());
  checkCopies(messageClass, *message);
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const auto& classes = vesk::metrics::kEveryMessage;
  if (size > 0) vesk::checkCodec(classes[data[0] % classes.size()], {data + 1, size - 1});
  return 0;
}
