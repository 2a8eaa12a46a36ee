#include "filled_message.h"

#include <limits>

#include "messages/codec/proto_writer.h"
#include "messages/proto_schema.h"

namespace vesk {

namespace {

std::uint32_t numberOf(const FieldDescriptor& field) {
  return static_cast<std::uint32_t>(field.number());
}

class Filler {
 public:
  explicit Filler(Filling filling) : isExtreme_(filling == Filling::extreme) {}

  FilledMessage fill(const Descriptor& message) {
    FilledMessage filled;
    ProtoWriter writer;
    for (const auto& [number, field] : fieldsByNumber(message)) {
      const Value value = field->is_repeated() ? addList(*field, writer) : addOne(*field, writer);
      filled.dictionary.set(Text::copy(field->name()), value);
      filled.fieldEnds.push_back(writer.written().size());
      // The elements of a list are fields of their own.
      if (field->is_repeated() && !field->is_packable()) {
        filled.fieldEnds.insert(filled.fieldEnds.end() - 1, elementEnds_.begin(), elementEnds_.end() - 1);
      }
    }
    filled.payload.assign(writer.written().begin(), writer.written().end());
    return filled;
  }

 private:
  Value addList(const FieldDescriptor& field, ProtoWriter& writer) {
    Array array;
    if (!field.is_packable()) {
      std::vector<std::size_t> ends;
      for (int count = 0; count < 2; ++count) {
        array.append(addOne(field, writer));
        ends.push_back(writer.written().size());
      }
      elementEnds_ = std::move(ends);
    } else {
      WriterMark mark{};
      writer.beginSection(mark, numberOf(field));
      for (int count = 0; count < 3; ++count)
        array.append(addNumber(field, writer, ProtoWriter::kNoKey));
      writer.endSection(mark);
    }
    return array;
  }

  Value addOne(const FieldDescriptor& field, ProtoWriter& writer) {
    const std::string letters = "field " + field.name();
    switch (field.type()) {
      case FieldDescriptor::TYPE_STRING:
        writer.writeString(Text::copy(letters), numberOf(field));
        return Text::copy(letters);
      case FieldDescriptor::TYPE_BYTES: {
        const Data data = Data::copy(Bytes(letters.begin(), letters.end()));
        writer.writeBytes(data, numberOf(field));
        return data;
      }
      case FieldDescriptor::TYPE_MESSAGE: {
        FilledMessage part = Filler(*this).fill(*field.message_type());
        writer.writeBytes(Data::copy(part.payload), numberOf(field));
        return part.dictionary;
      }
      default:
        return addNumber(field, writer, numberOf(field));
    }
  }

  Value addNumber(const FieldDescriptor& field, ProtoWriter& writer, std::uint32_t number) {
    const std::uint32_t next = ++last_;
    constexpr auto kMin = std::numeric_limits<std::int32_t>::min();
    switch (field.type()) {
      case FieldDescriptor::TYPE_UINT64: {
        const std::uint64_t value = isExtreme_ ? ~std::uint64_t{next} : next;
        writer.writeUInt64(value, number);
        return value;
      }
      case FieldDescriptor::TYPE_SINT32:
      case FieldDescriptor::TYPE_INT32: {
        const auto value = static_cast<std::int32_t>(next) + (isExtreme_ ? kMin : 0);
        field.type() == FieldDescriptor::TYPE_INT32 ? writer.writeInt32(value, number)
                                                    : writer.writeSInt32(value, number);
        return value;
      }
      case FieldDescriptor::TYPE_BOOL:
        writer.writeBool(true, number);
        return true;
      case FieldDescriptor::TYPE_ENUM: {
        const auto* enumeration = field.enum_type();
        const auto* value = enumeration->value(isExtreme_ ? enumeration->value_count() - 1 : 1);
        writer.writeInt32(value->number(), number);
        return Text::copy(value->name());
      }
      default:
        writer.writeUInt32(isExtreme_ ? ~next : next, number);
        return isExtreme_ ? ~next : next;
    }
  }

  bool isExtreme_;
  std::uint32_t last_ = 0;
  std::vector<std::size_t> elementEnds_;
};

}  // namespace

FilledMessage filledMessage(std::string_view className, Filling filling) {
  return Filler(filling).fill(declaredMessage(className));
}

}  // namespace vesk
