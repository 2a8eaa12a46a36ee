#include "message_properties.h"

#include <algorithm>

#include "property.h"
#include "values/text_form.h"

namespace vesk {

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

void checkWriting(const MessageClass& messageClass, const ProtoCodable& message, std::size_t payloadSize) {
  ProtoWriter writer;
  message.writeTo(writer);
  const std::span<const std::uint8_t> written = writer.written();
  // A negative int32 may come in five bytes and goes in ten; nothing else grows.
  require(written.size() <= 2 * payloadSize, "a message is written in at most twice the bytes it came in");
  const auto again = messageClass.decode(written);
  require(again != nullptr, "what was written can be read");
  requireSame(*again, message);
  ProtoWriter second;
  again->writeTo(second);
  require(std::equal(written.begin(), written.end(), second.written().begin(), second.written().end()),
          "what was read from written bytes is written in the same bytes");
}

void checkCopies(const MessageClass& messageClass, const ProtoCodable& message) {
  requireSame(*messageClass.deepCopy(message), message);
  const auto copied = messageClass.decode({});
  messageClass.copyTo(message, *copied);
  requireSame(*copied, message);
  const auto merged = messageClass.decode({});
  messageClass.merge(message, *merged);
  requireSame(*merged, message);
}

void checkFields(const MessageClass& messageClass, std::span<const std::uint8_t> payload) {
  constexpr std::size_t kLongest = 300;
  auto before = messageClass.decode({});
  std::string shownBefore = textOf(before->dictionaryRepresentation());
  for (std::size_t end = 1; end <= std::min(payload.size(), kLongest); ++end) {
    const auto message = messageClass.decode(payload.first(end));
    if (message == nullptr) continue;
    std::string shown = textOf(message->dictionaryRepresentation());
    const bool showsTheSame = shown == shownBefore;
    require(showsTheSame || !message->isEqual(*before), "messages that show different fields are not equal");
    before = message;
    shownBefore = std::move(shown);
  }
}

}  // namespace vesk
