#pragma once

#include "messages/message_classes.h"

namespace vesk {

/// Both are equal in every way in which messages can be.
void requireSame(const ProtoCodable& a, const ProtoCodable& b);

/// Equal, and in the same order.
[[nodiscard]] bool isSame(const Dictionary& a, const Dictionary& b);

/// The JSON of the message is that of its dictionary.
void checkJson(const ProtoCodable& message);

/// What is written can be read, and is written again in the same bytes.
void checkWriting(const MessageClass& messageClass, const ProtoCodable& message, std::size_t payloadSize);

/// A message is not equal to that of the same payload without its last field, nor are any two beginnings of the payload
/// that end with neighbouring fields.
void checkFields(const MessageClass& messageClass, std::span<const std::uint8_t> payload);

/// Every way to copy gives the same message.
void checkCopies(const MessageClass& messageClass, const ProtoCodable& message);

}  // namespace vesk
