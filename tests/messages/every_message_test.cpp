#include "messages/every_message.h"

#include <algorithm>
#include <set>

#include "messages/filled_message.h"
#include "messages/proto_schema.h"
#include "support/decoded.h"

namespace vesk {
namespace {

class EveryMessage : public testing::TestWithParam<MessageClass> {
 protected:
  using Message = std::shared_ptr<ProtoCodable>;

  [[nodiscard]] static Message decode(const Bytes& payload) { return GetParam().decode(payload); }
  [[nodiscard]] Message whole() const { return decode(filled_.payload); }

  [[nodiscard]] Bytes slice(std::size_t from, std::size_t to) const {
    const auto start = filled_.payload.begin();
    return {start + static_cast<std::ptrdiff_t>(from), start + static_cast<std::ptrdiff_t>(to)};
  }

  const FilledMessage filled_ = filledMessage(GetParam().name, Filling::extreme);
};
INSTANTIATE_TEST_SUITE_P(Schema, EveryMessage, testing::ValuesIn(metrics::kEveryMessage), nameOfTest);

TEST(Schema, IsWhatTheListOfMessagesNames) {
  std::set<std::string_view> listed;
  for (const MessageClass& each : metrics::kEveryMessage)
    listed.insert(each.name);
  std::set<std::string_view> declared;
  for (const Descriptor* message : declaredMessages())
    declared.insert(message->name());
  EXPECT_EQ(listed, declared);
}

TEST_P(EveryMessage, ReadsShowsAndWritesEveryField) {
  for (const Filling filling : {Filling::small, Filling::extreme}) {
    const FilledMessage filled = filledMessage(GetParam().name, filling);
    const Message message = decode(filled.payload);
    ASSERT_NE(message, nullptr);
    EXPECT_EQ(message->className(), GetParam().name);
    EXPECT_EQ(message->dictionaryRepresentation(), filled.dictionary);
    EXPECT_EQ(shown(*message), textOf(filled.dictionary));
    std::string json;
    message->appendJson(json);
    std::string expectedJson;
    appendJson(expectedJson, filled.dictionary);
    EXPECT_EQ(json, expectedJson);
    EXPECT_EQ(writtenHex(*message), hexOf(filled.payload));
  }
}

TEST_P(EveryMessage, CopiesAndMergesEveryField) {
  const Message message = whole();
  const Message copied = decode({});
  const Message merged = decode({});
  GetParam().copyTo(*message, *copied);
  GetParam().merge(*message, *merged);
  for (const Message& other : {copied, merged, GetParam().deepCopy(*message)}) {
    EXPECT_EQ(shown(*other), shown(*message));
    EXPECT_TRUE(other->isEqual(*message));
    EXPECT_EQ(other->hash(), message->hash());
  }
}

TEST_P(EveryMessage, ComparesEveryField) {
  const Message message = whole();
  std::size_t start = 0;
  for (const std::size_t end : filled_.fieldEnds) {
    Bytes others = slice(0, start);
    const Bytes behind = slice(end, filled_.payload.size());
    others.insert(others.end(), behind.begin(), behind.end());
    const Message without = decode(others);
    ASSERT_NE(without, nullptr);
    EXPECT_FALSE(message->isEqual(*without)) << hexOf(slice(start, end));
    EXPECT_NE(message->hash(), without->hash()) << hexOf(slice(start, end));
    GetParam().copyTo(*message, *without);
    EXPECT_TRUE(message->isEqual(*without)) << hexOf(slice(start, end));
    start = end;
  }
}

TEST_P(EveryMessage, IsWholeWhereAFieldEndsAndNowhereElse) {
  const auto& ends = filled_.fieldEnds;
  for (std::size_t size = 0; size <= filled_.payload.size(); ++size) {
    const bool isWhole = size == 0 || std::find(ends.begin(), ends.end(), size) != ends.end();
    EXPECT_EQ(decode(slice(0, size)) != nullptr, isWhole) << size;
  }
}

TEST_P(EveryMessage, WritesWhatItMadeOfDamagedBytesSoThatItReadsTheSame) {
  for (std::size_t index = 0; index < filled_.payload.size(); ++index) {
    for (const std::uint8_t byte : bytesOf("00 03 04 7A 80 FF")) {
      Bytes damaged = filled_.payload;
      damaged[index] = byte;
      const Message message = decode(damaged);
      if (message == nullptr) continue;
      ProtoWriter writer;
      message->writeTo(writer);
      const Message again = GetParam().decode(writer.written());
      ASSERT_NE(again, nullptr);
      EXPECT_TRUE(again->isEqual(*message)) << shown(*again) << '\n' << shown(*message);
    }
  }
}

TEST_P(EveryMessage, AllocatesNeitherKeysNorNames) {
  const FilledMessage filled = filledMessage(GetParam().name, Filling::small);
  const Dictionary one = decode(filled.payload)->dictionaryRepresentation();
  const Dictionary other = decode(filled.payload)->dictionaryRepresentation();
  for (const auto& [number, field] : fieldsByNumber(declaredMessage(GetParam().name))) {
    const std::string& name = field->name();
    const auto isField = [&](const Dictionary::Entry& entry) { return entry.key == name; };
    const auto* a = std::find_if(one.begin(), one.end(), isField);
    const auto* b = std::find_if(other.begin(), other.end(), isField);
    EXPECT_EQ(a->key.view().data(), b->key.view().data()) << name;
    if (field->enum_type() == nullptr) continue;
    EXPECT_EQ(a->value.text()->view().data(), b->value.text()->view().data()) << name;
  }
}

}  // namespace
}  // namespace vesk
