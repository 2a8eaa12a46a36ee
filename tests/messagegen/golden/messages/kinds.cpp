// Generated from kinds.proto; do not edit.
#include "messages/kinds.h"

namespace vesk::metrics {

Text nameOf(Mode value) {
  switch (value) {
    case Mode::MODE_FIRST:
      return "MODE_FIRST"_text;
    case Mode::MODE_BEHIND:
      return "MODE_BEHIND"_text;
  }
  return unknownName(static_cast<std::int32_t>(value));
}

Text nameOf(Kinds::Nested value) {
  switch (value) {
    case Kinds::Nested::NONE:
      return "NONE"_text;
  }
  return unknownName(static_cast<std::int32_t>(value));
}

bool Part::readFrom(ProtoReader& reader) {
  FieldCursor cursor(reader);
  while (cursor.readKey()) {
    switch (cursor.fieldNumber()) {
      case 1:
        assign(kANameSoLongThatStatementsTakeTwo, aNameSoLongThatStatementsTakeTwo_, cursor.readUInt32());
        break;
      default:
        if (!readUndeclaredField(kClassName, cursor)) return false;
    }
  }
  return cursor.finish();
}

void Part::writeTo(ProtoWriter& writer) const {
  if (has(kANameSoLongThatStatementsTakeTwo)) writer.writeUInt32(aNameSoLongThatStatementsTakeTwo_, 1);
}

template <class Fields>
void Part::giveTo(Fields& fields) const {
  if (has(kANameSoLongThatStatementsTakeTwo)) {
    fields.append("a_name_so_long_that_statements_take_two"_text, aNameSoLongThatStatementsTakeTwo_);
  }
}

Dictionary Part::dictionaryRepresentation() const {
  DictionaryFields fields(presentScalars());
  giveTo(fields);
  return fields.take();
}

void Part::writeJson(JsonWriter& json) const {
  JsonFields fields(json);
  giveTo(fields);
  fields.end();
}

void Part::copyTo(Self& other) const {
  copyScalar(other, kANameSoLongThatStatementsTakeTwo, &Self::aNameSoLongThatStatementsTakeTwo_);
}

std::shared_ptr<Part> Part::copyWithZone() const {
  return makeMessage<Part>(*this);
}

void Part::mergeFrom(const Self& other) {
  other.copyScalar(*this, kANameSoLongThatStatementsTakeTwo, &Self::aNameSoLongThatStatementsTakeTwo_);
}

bool Part::hasEqualFields(const Self& other) const {
  if (!isSameScalar(other, kANameSoLongThatStatementsTakeTwo, &Self::aNameSoLongThatStatementsTakeTwo_)) return false;
  return true;
}

std::uint64_t Part::hash() const {
  std::uint64_t result = 0;
  result ^= scalarHash(kANameSoLongThatStatementsTakeTwo, aNameSoLongThatStatementsTakeTwo_);
  return result;
}

bool Kinds::readFrom(ProtoReader& reader) {
  FieldCursor cursor(reader);
  while (cursor.readKey()) {
    switch (cursor.fieldNumber()) {
      case 1:
        assign(kTimestamp, timestamp_, cursor.readUInt64());
        if (!cursor.readKeyIf<2, WireType::varint>()) break;
        [[fallthrough]];
      case 2:
        assign(kQRxlevMin, qRxlevMin_, cursor.readUInt32());
        if (!cursor.readKeyIf<3, WireType::varint>()) break;
        [[fallthrough]];
      case 3:
        assign(kPlain, plain_, cursor.readInt32());
        if (!cursor.readKeyIf<4, WireType::varint>()) break;
        [[fallthrough]];
      case 4:
        assign(kZigZag, zigZag_, cursor.readSInt32());
        if (!cursor.readKeyIf<5, WireType::varint>()) break;
        [[fallthrough]];
      case 5:
        assign(kIsSet, isSet_, cursor.readBool());
        if (!cursor.readKeyIf<6, WireType::varint>()) break;
        [[fallthrough]];
      case 6:
        assign(kNested, nested_, cursor.readEnumeration<Nested>());
        if (!cursor.readKeyIf<7, WireType::varint>()) break;
        [[fallthrough]];
      case 7:
        assign(kMode, mode_, cursor.readEnumeration<Mode>());
        if (!cursor.readKeyIf<9, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 9:
        content_ = cursor.readBytes();
        if (!cursor.readKeyIf<10, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 10:
        if (!readObject(part_, cursor)) return false;
        if (!cursor.readKeyIf<11, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 11:
        do {
          if (!readElement(partLists_, cursor)) return false;
        } while (cursor.readKeyIf<11, WireType::lengthDelimited>());
        if (!cursor.readKeyIf<12, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 12:
        do {
          if (!readElement(instValues_, cursor)) return false;
        } while (cursor.readKeyIf<12, WireType::lengthDelimited>());
        if (!cursor.readKeyIf<13, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 13:
        if (!readRepeated<&FieldCursor::readUInt32>(multiBandInfos_, cursor)) return false;
        if (!cursor.readKeyIf<14, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 14:
        if (!readRepeated<&FieldCursor::readSInt32>(csTxPwrs_, cursor)) return false;
        if (!cursor.readKeyIf<15, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 15:
        if (!readRepeated<&FieldCursor::readInt32>(codes_, cursor)) return false;
        if (!cursor.readKeyIf<65535, WireType::lengthDelimited>()) break;
        [[fallthrough]];
      case 65535:
        apn_ = cursor.readString();
        break;
      default:
        if (!readUndeclaredField(kClassName, cursor)) return false;
    }
  }
  return cursor.finish();
}

void Kinds::writeTo(ProtoWriter& writer) const {
  if (has(kTimestamp)) writer.writeUInt64(timestamp_, 1);
  if (has(kQRxlevMin)) writer.writeUInt32(qRxlevMin_, 2);
  if (has(kPlain)) writer.writeInt32(plain_, 3);
  if (has(kZigZag)) writer.writeSInt32(zigZag_, 4);
  if (has(kIsSet)) writer.writeBool(isSet_, 5);
  if (has(kNested)) writer.writeEnumeration(nested_, 6);
  if (has(kMode)) writer.writeEnumeration(mode_, 7);
  if (content_) writer.writeBytes(*content_, 9);
  if (part_) writer.writeMessage(*part_, 10);
  writeElements(partLists_, 11, writer);
  writeElements(instValues_, 12, writer);
  writePacked<&ProtoWriter::writeUInt32>(multiBandInfos_, 13, writer);
  writePacked<&ProtoWriter::writeSInt32>(csTxPwrs_, 14, writer);
  writePacked<&ProtoWriter::writeInt32>(codes_, 15, writer);
  if (apn_) writer.writeString(*apn_, 65535);
}

template <class Fields>
void Kinds::giveTo(Fields& fields) const {
  if (has(kTimestamp)) fields.append("timestamp"_text, timestamp_);
  if (has(kQRxlevMin)) fields.append("Q_rxlev_min"_text, qRxlevMin_);
  if (has(kPlain)) fields.append("plain"_text, plain_);
  if (has(kZigZag)) fields.append("zig_zag"_text, zigZag_);
  if (has(kIsSet)) fields.append("is_set"_text, isSet_);
  if (has(kNested)) fields.append("nested"_text, nameOf(nested_));
  if (has(kMode)) fields.append("mode"_text, nameOf(mode_));
  if (content_) fields.append("content"_text, *content_);
  if (part_) fields.append("part"_text, part_);
  if (countOf(partLists_) != 0) fields.append("part_list"_text, partLists_);
  if (countOf(instValues_) != 0) fields.append("inst_values"_text, instValues_);
  fields.append("multi_band_info"_text, multiBandInfos_);
  fields.append("cs_tx_pwr"_text, csTxPwrs_);
  fields.append("code"_text, codes_);
  if (apn_) fields.append("apn"_text, *apn_);
}

Dictionary Kinds::dictionaryRepresentation() const {
  DictionaryFields fields(presentScalars() + 8);
  giveTo(fields);
  return fields.take();
}

void Kinds::writeJson(JsonWriter& json) const {
  JsonFields fields(json);
  giveTo(fields);
  fields.end();
}

void Kinds::copyTo(Self& other) const {
  copyScalar(other, kTimestamp, &Self::timestamp_);
  copyScalar(other, kQRxlevMin, &Self::qRxlevMin_);
  copyScalar(other, kPlain, &Self::plain_);
  copyScalar(other, kZigZag, &Self::zigZag_);
  copyScalar(other, kIsSet, &Self::isSet_);
  copyScalar(other, kNested, &Self::nested_);
  copyScalar(other, kMode, &Self::mode_);
  if (content_) other.content_ = content_;
  if (part_) other.part_ = part_;
  copyElements(partLists_, other.partLists_);
  copyElements(instValues_, other.instValues_);
  copyValues(multiBandInfos_, other.multiBandInfos_);
  copyValues(csTxPwrs_, other.csTxPwrs_);
  copyValues(codes_, other.codes_);
  if (apn_) other.apn_ = apn_;
}

std::shared_ptr<Kinds> Kinds::copyWithZone() const {
  auto copy = makeMessage<Kinds>(*this);
  copy->part_ = deepCopy(part_);
  copy->partLists_ = deepCopy(partLists_);
  copy->instValues_ = deepCopy(instValues_);
  return copy;
}

void Kinds::mergeFrom(const Self& other) {
  other.copyScalar(*this, kTimestamp, &Self::timestamp_);
  other.copyScalar(*this, kQRxlevMin, &Self::qRxlevMin_);
  other.copyScalar(*this, kPlain, &Self::plain_);
  other.copyScalar(*this, kZigZag, &Self::zigZag_);
  other.copyScalar(*this, kIsSet, &Self::isSet_);
  other.copyScalar(*this, kNested, &Self::nested_);
  other.copyScalar(*this, kMode, &Self::mode_);
  if (other.content_) content_ = other.content_;
  mergeObject(other.part_, part_);
  mergeElements(other.partLists_, partLists_);
  mergeElements(other.instValues_, instValues_);
  multiBandInfos_.append(other.multiBandInfos_);
  csTxPwrs_.append(other.csTxPwrs_);
  codes_.append(other.codes_);
  if (other.apn_) apn_ = other.apn_;
}

bool Kinds::hasEqualFields(const Self& other) const {
  if (!isSameScalar(other, kTimestamp, &Self::timestamp_)) return false;
  if (!isSameScalar(other, kQRxlevMin, &Self::qRxlevMin_)) return false;
  if (!isSameScalar(other, kPlain, &Self::plain_)) return false;
  if (!isSameScalar(other, kZigZag, &Self::zigZag_)) return false;
  if (!isSameScalar(other, kIsSet, &Self::isSet_)) return false;
  if (!isSameScalar(other, kNested, &Self::nested_)) return false;
  if (!isSameScalar(other, kMode, &Self::mode_)) return false;
  if (!(content_ == other.content_)) return false;
  if (!isSameObject(part_, other.part_)) return false;
  if (!isSameList(partLists_, other.partLists_)) return false;
  if (!isSameList(instValues_, other.instValues_)) return false;
  if (!multiBandInfos_.isEqual(other.multiBandInfos_)) return false;
  if (!csTxPwrs_.isEqual(other.csTxPwrs_)) return false;
  if (!codes_.isEqual(other.codes_)) return false;
  if (!(apn_ == other.apn_)) return false;
  return true;
}

std::uint64_t Kinds::hash() const {
  std::uint64_t result = 0;
  result ^= scalarHash(kTimestamp, timestamp_);
  result ^= scalarHash(kQRxlevMin, qRxlevMin_);
  result ^= scalarHash(kPlain, plain_);
  result ^= scalarHash(kZigZag, zigZag_);
  result ^= scalarHash(kIsSet, isSet_);
  result ^= scalarHash(kNested, nested_);
  result ^= scalarHash(kMode, mode_);
  result ^= objectHash(content_);
  result ^= objectHash(part_);
  result ^= objectHash(partLists_);
  result ^= objectHash(instValues_);
  result ^= multiBandInfos_.hash();
  result ^= csTxPwrs_.hash();
  result ^= codes_.hash();
  result ^= objectHash(apn_);
  return result;
}

}  // namespace vesk::metrics
