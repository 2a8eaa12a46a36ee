// The first byte names a message class, the others are a payload for it.

#include <algorithm>

#include "messages/message_classes.h"
#include "messages/wire_model.h"
#include "property.h"
#include "support/allocations.h"
#include "values/text_form.h"

namespace vesk {

namespace {

using Payload = std::span<const std::uint8_t>;
using Message = std::shared_ptr<ProtoCodable>;

/// Equal, and in the same order.
bool isSame(const Dictionary& a, const Dictionary& b) {
  return a == b && textOf(a) == textOf(b);
}

void requireSame(const ProtoCodable& a, const ProtoCodable& b) {
  require(a.isEqual(b) && b.isEqual(a), "both are equal");
  require(a.hash() == b.hash(), "equal messages have equal hashes");
  require(isSame(a.dictionaryRepresentation(), b.dictionaryRepresentation()), "equal messages show the same");
}

void checkJson(const ProtoCodable& message) {
  std::string direct;
  message.appendJson(direct);
  std::string ofDictionary;
  appendJson(ofDictionary, message.dictionaryRepresentation());
  require(direct == ofDictionary, "the JSON of a message is that of its dictionary");
}

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

void checkWriting(const MessageClass& messageClass, const ProtoCodable& message, std::size_t payloadSize) {
  ProtoWriter writer;
  message.writeTo(writer);
  const Payload written = writer.written();
  // A negative int32 may come in five bytes and goes in ten; nothing else grows.
  require(written.size() <= 2 * payloadSize, "a message is written in at most twice the bytes it came in");
  const Message again = messageClass.decode(written);
  require(again != nullptr, "what was written can be read");
  requireSame(*again, message);
  ProtoWriter second;
  again->writeTo(second);
  require(std::equal(written.begin(), written.end(), second.written().begin(), second.written().end()),
          "what was read from written bytes is written in the same bytes");
}

void checkCopies(const MessageClass& messageClass, const ProtoCodable& message) {
  requireSame(*messageClass.deepCopy(message), message);
  const Message copied = messageClass.decode({});
  messageClass.copyTo(message, *copied);
  requireSame(*copied, message);
  const Message merged = messageClass.decode({});
  messageClass.merge(message, *merged);
  requireSame(*merged, message);
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
