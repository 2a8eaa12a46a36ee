// The first byte names a message class, the others are a payload for it: what our writer makes of it, libprotobuf reads
// as the same fields and writes as the same bytes.

#include <algorithm>
#include <string>

#include "messages/message_classes.h"
#include "peer_messages.h"
#include "property.h"
#include "values/text_form.h"

namespace vesk {
namespace {

void checkPeer(const MessageClass& messageClass, std::span<const std::uint8_t> payload) {
  const auto ours = messageClass.decode(payload);
  if (ours == nullptr) return;
  ProtoWriter writer;
  ours->writeTo(writer);
  const std::span<const std::uint8_t> written = writer.written();
  const auto theirs = makePeerMessage(messageClass.name);
  require(theirs->ParseFromArray(written.data(), static_cast<int>(written.size())), "the peer reads what is written");

  const Dictionary fields = ours->dictionaryRepresentation();
  const std::string shown = textOf(fields);
  // To the peer, a value without a name is no field that it knows, and an empty list is none.
  if (shown.find("(unknown: ") != std::string::npos) return;
  const std::string again = theirs->SerializeAsString();
  require(std::equal(written.begin(), written.end(), again.begin(), again.end(),
                     [](std::uint8_t a, char b) { return a == static_cast<std::uint8_t>(b); }),
          "the peer writes the same bytes");
  require(shown.find("[]") != std::string::npos || dictionaryOf(*theirs) == fields, "the peer reads the same fields");
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const auto& classes = vesk::metrics::kEveryMessage;
  if (size > 0) vesk::checkPeer(classes[data[0] % classes.size()], {data + 1, size - 1});
  return 0;
}
