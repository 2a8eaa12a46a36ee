#include "messages/every_message.h"

#include <algorithm>
#include <set>

#include "messages/filled_message.h"
#include "support/decoded.h"

namespace vesk {
namespace {

template <class M>
class EveryMessage : public testing::Test {
 protected:
  const FilledMessage filled_ = filledMessage(M::kClassName, Filling::extreme);

  [[nodiscard]] std::shared_ptr<M> whole() const { return M::initWithData(filled_.payload); }

  [[nodiscard]] Bytes slice(std::size_t from, std::size_t to) const {
    const auto start = filled_.payload.begin();
    return {start + static_cast<std::ptrdiff_t>(from), start + static_cast<std::ptrdiff_t>(to)};
  }
};
TYPED_TEST_SUITE(EveryMessage, metrics::EveryMessage);

template <class... Messages>
std::set<std::string> namesOf(testing::Types<Messages...> /*list*/) {
  return {std::string(Messages::kClassName)...};
}

TEST(Schema, IsWhatTheListOfMessagesNames) {
  std::set<std::string> names;
  for (const auto& [name, message] : schema())
    names.insert(name);
  EXPECT_EQ(namesOf(metrics::EveryMessage()), names);
}

TYPED_TEST(EveryMessage, ReadsShowsAndWritesEveryField) {
  for (const Filling filling : {Filling::small, Filling::extreme}) {
    const FilledMessage filled = filledMessage(TypeParam::kClassName, filling);
    const auto message = TypeParam::initWithData(filled.payload);
    ASSERT_NE(message, nullptr);
    EXPECT_EQ(message->className(), TypeParam::kClassName);
    EXPECT_EQ(message->dictionaryRepresentation(), filled.dictionary);
    EXPECT_EQ(shown(*message), textOf(filled.dictionary));
    EXPECT_EQ(writtenHex(*message), hexOf(filled.payload));
  }
}

TYPED_TEST(EveryMessage, CopiesAndMergesEveryField) {
  const auto message = this->whole();
  TypeParam copied;
  TypeParam merged;
  message->copyTo(copied);
  merged.mergeFrom(*message);
  const auto deep = message->copyWithZone();
  for (const TypeParam* other : {const_cast<const TypeParam*>(&copied), const_cast<const TypeParam*>(&merged),
                                 const_cast<const TypeParam*>(deep.get())}) {
    EXPECT_EQ(shown(*other), shown(*message));
    EXPECT_TRUE(other->isEqual(*message));
    EXPECT_EQ(other->hash(), message->hash());
  }
}

TYPED_TEST(EveryMessage, ComparesEveryField) {
  const auto message = this->whole();
  std::size_t start = 0;
  for (const std::size_t end : this->filled_.fieldEnds) {
    Bytes others = this->slice(0, start);
    const Bytes behind = this->slice(end, this->filled_.payload.size());
    others.insert(others.end(), behind.begin(), behind.end());
    const auto without = TypeParam::initWithData(others);
    ASSERT_NE(without, nullptr);
    EXPECT_FALSE(message->isEqual(*without)) << hexOf(this->slice(start, end));
    EXPECT_NE(message->hash(), without->hash()) << hexOf(this->slice(start, end));
    message->copyTo(*without);
    EXPECT_TRUE(message->isEqual(*without)) << hexOf(this->slice(start, end));
    start = end;
  }
}

TYPED_TEST(EveryMessage, IsWholeWhereAFieldEndsAndNowhereElse) {
  const auto& ends = this->filled_.fieldEnds;
  for (std::size_t size = 0; size <= this->filled_.payload.size(); ++size) {
    const bool isWhole = size == 0 || std::find(ends.begin(), ends.end(), size) != ends.end();
    EXPECT_EQ(TypeParam::initWithData(this->slice(0, size)) != nullptr, isWhole) << size;
  }
}

TYPED_TEST(EveryMessage, WritesWhatItMadeOfDamagedBytesSoThatItReadsTheSame) {
  for (std::size_t index = 0; index < this->filled_.payload.size(); ++index) {
    for (const std::uint8_t byte : bytesOf("00 03 04 7A 80 FF")) {
      Bytes damaged = this->filled_.payload;
      damaged[index] = byte;
      const auto message = TypeParam::initWithData(damaged);
      if (message == nullptr) continue;
      ProtoWriter writer;
      message->writeTo(writer);
      const auto again = TypeParam::initWithData(writer.written());
      ASSERT_NE(again, nullptr);
      EXPECT_TRUE(again->isEqual(*message)) << shown(*again) << '\n' << shown(*message);
    }
  }
}

TYPED_TEST(EveryMessage, AllocatesNeitherKeysNorNames) {
  const FilledMessage filled = filledMessage(TypeParam::kClassName, Filling::small);
  const Dictionary one = TypeParam::initWithData(filled.payload)->dictionaryRepresentation();
  const Dictionary other = TypeParam::initWithData(filled.payload)->dictionaryRepresentation();
  const auto& fields = schema().find(TypeParam::kClassName)->second.fields;
  for (const auto& field : fields) {
    const auto isField = [&](const Dictionary::Entry& entry) { return entry.key == field.name; };
    const auto* a = std::find_if(one.begin(), one.end(), isField);
    const auto* b = std::find_if(other.begin(), other.end(), isField);
    EXPECT_EQ(a->key.view().data(), b->key.view().data()) << field.name;
    if (field.type != messagegen::FieldType::enumeration) continue;
    EXPECT_EQ(a->value.text()->view().data(), b->value.text()->view().data()) << field.name;
  }
}

}  // namespace
}  // namespace vesk
