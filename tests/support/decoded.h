#pragma once

#include <gtest/gtest.h>
#include <memory>
#include <string>

#include "messages/codec/message.h"
#include "support/bytes.h"
#include "values/text_form.h"

namespace vesk {

/// The message of this class in `hex`, or null when it is no encoding of one.
template <class M>
std::shared_ptr<M> decoded(std::string_view hex) {
  return M::initWithData(bytesOf(hex));
}

inline std::string writtenHex(const ProtoCodable& message) {
  ProtoWriter writer;
  message.writeTo(writer);
  return hexOf(writer.written());
}

inline std::string shown(const ProtoCodable& message) {
  return textOf(message.dictionaryRepresentation());
}

/// One payload: what it shows, and the bytes in which it is written again.
struct DecodingCase {
  std::shared_ptr<ProtoCodable> message;
  std::string shown;
  std::string written;
};

template <class M>
DecodingCase decoding(std::string_view payload, std::string_view isShown, std::string_view isWritten) {
  return {decoded<M>(payload), std::string(isShown), std::string(isWritten)};
}
/// It is written as it was read.
template <class M>
DecodingCase decoding(std::string_view payload, std::string_view isShown) {
  return decoding<M>(payload, isShown, payload);
}

inline void expectDecoding(const DecodingCase& row) {
  ASSERT_NE(row.message, nullptr) << row.shown;
  EXPECT_EQ(shown(*row.message), row.shown);
  EXPECT_EQ(writtenHex(*row.message), row.written) << row.shown;
}

}  // namespace vesk
