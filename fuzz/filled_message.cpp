#include "filled_message.h"

#include <limits>

#include "emit.h"
#include "messages/codec/proto_writer.h"
#include "messages/proto_schema.h"

namespace vesk {

namespace {

using messagegen::Field;
using messagegen::FieldType;

class Filler {
 public:
  explicit Filler(Filling filling) : isExtreme_(filling == Filling::extreme) {}

  FilledMessage fill(const messagegen::MessageType& message) {
    message_ = &message;
    FilledMessage filled;
    ProtoWriter writer;
    for (const Field& field : messagegen::fieldsByNumber(message)) {
      filled.dictionary.set(Text::copy(field.name), field.repeated ? addList(field, writer) : addOne(field, writer));
      filled.fieldEnds.push_back(writer.written().size());
      // The elements of a list are fields of their own.
      if (field.isMessageList()) {
        filled.fieldEnds.insert(filled.fieldEnds.end() - 1, elementEnds_.begin(), elementEnds_.end() - 1);
      }
    }
    filled.payload.assign(writer.written().begin(), writer.written().end());
    return filled;
  }

 private:
  Value addList(const Field& field, ProtoWriter& writer) {
    Array array;
    if (field.isMessage()) {
      std::vector<std::size_t> ends;
      for (int count = 0; count < 2; ++count) {
        array.append(addOne(field, writer));
        ends.push_back(writer.written().size());
      }
      elementEnds_ = std::move(ends);
    } else {
      WriterMark mark{};
      writer.beginSection(mark, field.number);
      for (int count = 0; count < 3; ++count)
        array.append(addNumber(field, writer, ProtoWriter::kNoKey));
      writer.endSection(mark);
    }
    return array;
  }

  Value addOne(const Field& field, ProtoWriter& writer) {
    const std::string letters = "field " + field.name;
    switch (field.type) {
      case FieldType::string:
        writer.writeString(Text::copy(letters), field.number);
        return Text::copy(letters);
      case FieldType::bytes: {
        const Data data = Data::copy(Bytes(letters.begin(), letters.end()));
        writer.writeBytes(data, field.number);
        return data;
      }
      case FieldType::message: {
        FilledMessage part = Filler(*this).fill(schema().at(field.typeName));
        writer.writeBytes(Data::copy(part.payload), field.number);
        return part.dictionary;
      }
      default:
        return addNumber(field, writer, field.number);
    }
  }

  Value addNumber(const Field& field, ProtoWriter& writer, std::uint32_t number) {
    const std::uint32_t next = ++last_;
    constexpr auto kMin = std::numeric_limits<std::int32_t>::min();
    switch (field.type) {
      case FieldType::uint64: {
        const std::uint64_t value = isExtreme_ ? ~std::uint64_t{next} : next;
        writer.writeUInt64(value, number);
        return value;
      }
      case FieldType::sint32:
      case FieldType::int32: {
        const auto value = static_cast<std::int32_t>(next) + (isExtreme_ ? kMin : 0);
        field.type == FieldType::int32 ? writer.writeInt32(value, number) : writer.writeSInt32(value, number);
        return value;
      }
      case FieldType::boolean:
        writer.writeBool(true, number);
        return true;
      case FieldType::enumeration: {
        const auto& values = enumerationOf(*message_, field).values;
        const auto& value = isExtreme_ ? values.back() : values[1];
        writer.writeInt32(value.number, number);
        return Text::copy(value.name);
      }
      default:
        writer.writeUInt32(isExtreme_ ? ~next : next, number);
        return isExtreme_ ? ~next : next;
    }
  }

  bool isExtreme_;
  const messagegen::MessageType* message_ = nullptr;
  std::uint32_t last_ = 0;
  std::vector<std::size_t> elementEnds_;
};

}  // namespace

FilledMessage filledMessage(std::string_view className, Filling filling) {
  return Filler(filling).fill(schema().find(className)->second);
}

}  // namespace vesk
