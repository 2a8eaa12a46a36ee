#pragma once

#include <algorithm>
#include <bit>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <typeinfo>
#include <vector>

#include "messages/codec/field_cursor.h"
#include "messages/codec/proto_codable.h"
#include "messages/codec/repeated_scalar.h"
#include "values/recycled_memory.h"

/// What every generated message class is made of: the pieces that do not depend on its fields.
namespace vesk {

/// The elements of a repeated message field; absent until the first one is added or a list is set.
template <class Element>
using MessageList = std::optional<std::vector<std::shared_ptr<Element>, RecyclingAllocator<std::shared_ptr<Element>>>>;

/// An empty message, or a copy of another.
template <class Element, class... Original>
[[nodiscard]] std::shared_ptr<Element> makeMessage(const Original&... original) {
  return std::allocate_shared<Element>(RecyclingAllocator<Element>(), original...);
}

/// Base of the generated classes. A class has its own readFrom(), hasEqualFields() and kClassName; `Word` is
/// the smallest unsigned type with one bit for each of its optional scalar fields.
template <class Derived, class Word>
class Message : public ProtoCodable {
 public:
  using Self = Derived;

  /// The message encoded in `payload`, or null when it is no encoding of one. No bytes make an empty message.
  [[nodiscard]] static std::shared_ptr<Derived> initWithData(std::span<const std::uint8_t> payload) {
    auto message = makeMessage<Derived>();
    ProtoReader reader(payload);
    return message->readFrom(reader) ? message : nullptr;
  }

  [[nodiscard]] std::string_view className() const final { return Derived::kClassName; }

  [[nodiscard]] bool isEqual(const ProtoCodable& other) const final {
    return typeid(other) == typeid(Derived) &&
           static_cast<const Derived&>(*this).hasEqualFields(static_cast<const Derived&>(other));
  }

 protected:
  [[nodiscard]] bool has(unsigned field) const { return (presence_ >> field & 1) != 0; }
  void setPresence(unsigned field, bool present) {
    const auto bit = static_cast<Word>(Word{1} << field);
    presence_ = static_cast<Word>(present ? presence_ | bit : presence_ & ~bit);
  }
  [[nodiscard]] std::size_t presentScalars() const { return static_cast<std::size_t>(std::popcount(presence_)); }

  template <class Scalar>
  void assign(unsigned field, Scalar& member, Scalar value) {
    member = value;
    setPresence(field, true);
  }

  template <class Scalar>
  void copyScalar(Self& other, unsigned field, Scalar Self::*member) const {
    if (has(field)) other.assign(field, other.*member, static_cast<const Self&>(*this).*member);
  }

  /// Fields that are absent on both sides are equal, whatever values they once had.
  template <class Scalar>
  [[nodiscard]] bool isSameScalar(const Self& other, unsigned field, Scalar Self::*member) const {
    return has(field) == other.has(field) && (!has(field) || static_cast<const Self&>(*this).*member == other.*member);
  }

  /// Conversion to 64 bits extends the sign of a signed type.
  template <class Scalar>
  [[nodiscard]] std::uint64_t scalarHash(unsigned field, Scalar value) const {
    return has(field) ? static_cast<std::uint64_t>(value) * 0x9E3779B1 : 0;
  }

 private:
  Word presence_ = 0;
};

/// Passes over a field that the message does not declare. One that is numbered like a metric is the key of a
/// section around the message itself: only its length is read, and the section's content follows as fields of
/// the message.
[[nodiscard]] bool readUndeclaredField(FieldKey key, std::string_view messageClass, ProtoReader& reader);

[[nodiscard, gnu::always_inline]] inline bool readUndeclaredField(std::string_view messageClass, FieldCursor& cursor) {
  return cursor.withReader([key = cursor.key(), messageClass](ProtoReader& reader) {
    return readUndeclaredField(key, messageClass, reader);
  });
}

/// Reads into a fresh object, which takes the place of the one held.
template <class Element>
[[nodiscard, gnu::always_inline]] inline bool readObject(std::shared_ptr<Element>& object, FieldCursor& cursor) {
  object = makeMessage<Element>();
  return cursor.readSection([&](ProtoReader& section) { return object->readFrom(section); });
}

/// Room for so many elements is made at once.
inline constexpr std::size_t kLeastElements = 4;

template <class Element>
void addElement(MessageList<Element>& list, std::shared_ptr<Element> element) {
  if (!list) list.emplace().reserve(kLeastElements);
  list->push_back(std::move(element));
}

template <class Element>
void clearElements(MessageList<Element>& list) {
  if (list) list->clear();
}

template <class Element>
[[nodiscard, gnu::always_inline]] inline bool readElement(MessageList<Element>& list, FieldCursor& cursor) {
  addElement(list, makeMessage<Element>());
  return cursor.readSection([&](ProtoReader& section) { return list->back()->readFrom(section); });
}

/// Adds the values of one key: a section of them, or a single one. `read` is the cursor's operation for one
/// value.
template <auto read, class Number>
[[nodiscard, gnu::always_inline]] inline bool readRepeated(RepeatedScalar<Number>& values, FieldCursor& cursor) {
  if (cursor.key().wireType != WireType::lengthDelimited) {
    values.add((cursor.*read)());
    return true;
  }
  return cursor.readSection([&](ProtoReader& section) {
    FieldCursor numbers(section);
    while (numbers.hasMore())
      values.add((numbers.*read)());
    return true;
  });
}

template <class Element>
void writeElement(const Element& element, std::uint32_t fieldNumber, ProtoWriter& writer) {
  WriterMark mark{};
  writer.beginSection(mark, fieldNumber);
  element.writeTo(writer);
  writer.endSection(mark);
}

template <class Element>
void writeElements(const MessageList<Element>& list, std::uint32_t fieldNumber, ProtoWriter& writer) {
  if (!list) return;
  for (const auto& element : *list)
    writeElement(*element, fieldNumber, writer);
}

/// Writes all values in one section, and nothing when there are none. `write` is the writer's operation for
/// one.
template <auto write, class Number>
void writePacked(const RepeatedScalar<Number>& values, std::uint32_t fieldNumber, ProtoWriter& writer) {
  if (values.count() == 0) return;
  WriterMark mark{};
  writer.beginSection(mark, fieldNumber);
  for (std::size_t index = 0; index < values.count(); ++index) {
    (writer.*write)(values.values()[index], ProtoWriter::kNoKey);
  }
  writer.endSection(mark);
}

template <class Element>
[[nodiscard]] std::size_t countOf(const MessageList<Element>& list) {
  return list ? list->size() : 0;
}

/// Throws std::out_of_range for an index that is not below the count.
template <class Element>
[[nodiscard]] const std::shared_ptr<Element>& elementAt(const MessageList<Element>& list, std::size_t index) {
  static const MessageList<Element> kNone(std::in_place);
  return (list ? list : kNone)->at(index);
}

/// Takes the fields of a message as the entries of a dictionary.
class DictionaryFields {
 public:
  /// For `count` fields at most.
  explicit DictionaryFields(std::size_t count) { dictionary_.reserve(count); }

  template <class Held>
  void append(Text&& key, const Held& value) {
    dictionary_.append(std::move(key), formOf(value));
  }
  [[nodiscard]] Dictionary take() { return std::move(dictionary_); }

 private:
  template <class Scalar>
  static const Scalar& formOf(const Scalar& value) {
    return value;
  }
  template <class Number>
  static Array formOf(const RepeatedScalar<Number>& values) {
    return values.toArray();
  }
  template <class Element>
  static Dictionary formOf(const std::shared_ptr<Element>& object) {
    return object->dictionaryRepresentation();
  }
  template <class Element>
  static Array formOf(const MessageList<Element>& list) {
    Array array;
    array.reserve(list->size());
    for (const auto& element : *list)
      array.append(element->dictionaryRepresentation());
    return array;
  }

  Dictionary dictionary_;
};

/// Writes the fields of a message as those of a JSON object.
class JsonFields {
 public:
  explicit JsonFields(JsonWriter& json) : json_(json), object_(json) {}

  template <class Held>
  void append(const Text& key, const Held& value) {
    object_.plainKey(key.view());
    write(value);
  }
  void end() { object_.end(); }

 private:
  template <class Scalar>
  void write(const Scalar& value) {
    json_.write(value);
  }
  template <class Number>
  void write(const RepeatedScalar<Number>& values) {
    writeJsonArray(json_, std::span(values.values(), values.count()), [this](Number value) { json_.write(value); });
  }
  template <class Element>
  void write(const std::shared_ptr<Element>& object) {
    object->writeJson(json_);
  }
  template <class Element>
  void write(const MessageList<Element>& list) {
    writeJsonArray(json_, *list, [this](const auto& element) { element->writeJson(json_); });
  }

  JsonWriter& json_;
  JsonObject object_;
};

template <class Element>
void copyElements(const MessageList<Element>& from, MessageList<Element>& to) {
  if (countOf(from) != 0) to = from;
}

template <class Number>
void copyValues(const RepeatedScalar<Number>& from, RepeatedScalar<Number>& to) {
  if (from.count() != 0) to = from;
}

template <class Element>
[[nodiscard]] std::shared_ptr<Element> deepCopy(const std::shared_ptr<Element>& object) {
  return object == nullptr ? nullptr : object->copyWithZone();
}

template <class Element>
[[nodiscard]] MessageList<Element> deepCopy(const MessageList<Element>& list) {
  if (!list) return std::nullopt;
  MessageList<Element> copy(std::in_place);
  copy->reserve(list->size());
  for (const auto& element : *list)
    copy->push_back(element->copyWithZone());
  return copy;
}

template <class Element>
void mergeObject(const std::shared_ptr<Element>& from, std::shared_ptr<Element>& into) {
  if (from == nullptr) return;
  if (into == nullptr) {
    into = from;
  } else {
    into->mergeFrom(*from);
  }
}

template <class Element>
void mergeElements(const MessageList<Element>& from, MessageList<Element>& into) {
  const std::size_t added = countOf(from);
  for (std::size_t index = 0; index < added; ++index)
    addElement(into, (*from)[index]);
}

template <class Element>
[[nodiscard]] bool isSameObject(const std::shared_ptr<Element>& a, const std::shared_ptr<Element>& b) {
  return a == b || (a != nullptr && b != nullptr && a->isEqual(*b));
}

/// A list that was never made differs from an empty one.
template <class Element>
[[nodiscard]] bool isSameList(const MessageList<Element>& a, const MessageList<Element>& b) {
  if (!a || !b) return a.has_value() == b.has_value();
  return std::equal(a->begin(), a->end(), b->begin(), b->end(), isSameObject<Element>);
}

[[nodiscard]] std::uint64_t objectHash(const std::optional<Text>& text);
[[nodiscard]] std::uint64_t objectHash(const std::optional<Data>& data);

template <class Element>
[[nodiscard]] std::uint64_t objectHash(const std::shared_ptr<Element>& object) {
  return object == nullptr ? 0 : object->hash();
}

template <class Element>
[[nodiscard]] std::uint64_t objectHash(const MessageList<Element>& list) {
  std::uint64_t result = countOf(list);
  if (list) {
    for (const auto& element : *list)
      result = std::rotl(result, 7) ^ element->hash();
  }
  return result;
}

/// The name of a value that its enumeration does not have: "(unknown: 31)".
[[nodiscard]] Text unknownName(std::int32_t value);

}  // namespace vesk
