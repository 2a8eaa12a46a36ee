// Generated from kinds.proto; do not edit.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>

#include "messages/codec/message.h"

namespace vesk::metrics {

/// Starts at 3.
enum class Mode : std::int32_t {
  MODE_FIRST = 3,
  MODE_BEHIND = -1,
};

/// The value's name, or "(unknown: 31)" with its number.
[[nodiscard]] Text nameOf(Mode value);

class Part final : public Message<Part, std::uint8_t> {
 public:
  static constexpr std::string_view kClassName = "Part";

  [[nodiscard]] std::uint32_t aNameSoLongThatStatementsTakeTwo() const { return aNameSoLongThatStatementsTakeTwo_; }
  void setANameSoLongThatStatementsTakeTwo(std::uint32_t value) {
    assign(kANameSoLongThatStatementsTakeTwo, aNameSoLongThatStatementsTakeTwo_, value);
  }
  [[nodiscard]] bool hasANameSoLongThatStatementsTakeTwo() const { return has(kANameSoLongThatStatementsTakeTwo); }
  void setHasANameSoLongThatStatementsTakeTwo(bool present) { setPresence(kANameSoLongThatStatementsTakeTwo, present); }

  [[nodiscard]] bool readFrom(ProtoReader& reader) override;
  void writeTo(ProtoWriter& writer) const override;
  [[nodiscard]] Dictionary dictionaryRepresentation() const override;
  void writeJson(JsonWriter& json) const override;

  /// Sets in `other` what is present here; objects are shared, not copied.
  void copyTo(Self& other) const;
  /// A message that shares nothing with this one.
  [[nodiscard]] std::shared_ptr<Part> copyWithZone() const;
  /// Takes over what is present in `other`: lists grow by its elements, single messages merge.
  void mergeFrom(const Self& other);

  [[nodiscard]] bool hasEqualFields(const Self& other) const;
  [[nodiscard]] std::uint64_t hash() const override;

 private:
  /// Gives the fields that are present to `fields`, with their names.
  template <class Fields>
  void giveTo(Fields& fields) const;

  /// Which bit of the presence word is whose.
  enum PresenceBit : unsigned {
    kANameSoLongThatStatementsTakeTwo,
  };

  std::uint32_t aNameSoLongThatStatementsTakeTwo_ = 0;
};

/// The kinds of field.
///
/// In two paragraphs.
class Kinds final : public Message<Kinds, std::uint8_t> {
 public:
  enum class Nested : std::int32_t {
    NONE = 0,
  };

  static constexpr std::string_view kClassName = "Kinds";

  /// In milliseconds.
  [[nodiscard]] std::uint64_t timestamp() const { return timestamp_; }
  void setTimestamp(std::uint64_t value) { assign(kTimestamp, timestamp_, value); }
  [[nodiscard]] bool hasTimestamp() const { return has(kTimestamp); }
  void setHasTimestamp(bool present) { setPresence(kTimestamp, present); }

  [[nodiscard]] std::uint32_t qRxlevMin() const { return qRxlevMin_; }
  void setQRxlevMin(std::uint32_t value) { assign(kQRxlevMin, qRxlevMin_, value); }
  [[nodiscard]] bool hasQRxlevMin() const { return has(kQRxlevMin); }
  void setHasQRxlevMin(bool present) { setPresence(kQRxlevMin, present); }

  [[nodiscard]] std::int32_t plain() const { return plain_; }
  void setPlain(std::int32_t value) { assign(kPlain, plain_, value); }
  [[nodiscard]] bool hasPlain() const { return has(kPlain); }
  void setHasPlain(bool present) { setPresence(kPlain, present); }

  [[nodiscard]] std::int32_t zigZag() const { return zigZag_; }
  void setZigZag(std::int32_t value) { assign(kZigZag, zigZag_, value); }
  [[nodiscard]] bool hasZigZag() const { return has(kZigZag); }
  void setHasZigZag(bool present) { setPresence(kZigZag, present); }

  [[nodiscard]] bool isSet() const { return isSet_; }
  void setIsSet(bool value) { assign(kIsSet, isSet_, value); }
  [[nodiscard]] bool hasIsSet() const { return has(kIsSet); }
  void setHasIsSet(bool present) { setPresence(kIsSet, present); }

  [[nodiscard]] Mode mode() const { return has(kMode) ? mode_ : Mode::MODE_FIRST; }
  void setMode(Mode value) { assign(kMode, mode_, value); }
  [[nodiscard]] bool hasMode() const { return has(kMode); }
  void setHasMode(bool present) { setPresence(kMode, present); }

  [[nodiscard]] Nested nested() const { return has(kNested) ? nested_ : Nested::NONE; }
  void setNested(Nested value) { assign(kNested, nested_, value); }
  [[nodiscard]] bool hasNested() const { return has(kNested); }
  void setHasNested(bool present) { setPresence(kNested, present); }

  [[nodiscard]] const std::optional<Text>& apn() const { return apn_; }
  void setApn(std::optional<Text> value) { apn_ = std::move(value); }
  [[nodiscard]] bool hasApn() const { return static_cast<bool>(apn_); }

  [[nodiscard]] const std::optional<Data>& content() const { return content_; }
  void setContent(std::optional<Data> value) { content_ = std::move(value); }
  [[nodiscard]] bool hasContent() const { return static_cast<bool>(content_); }

  [[nodiscard]] const std::shared_ptr<Part>& part() const { return part_; }
  void setPart(std::shared_ptr<Part> value) { part_ = std::move(value); }
  [[nodiscard]] bool hasPart() const { return static_cast<bool>(part_); }

  [[nodiscard]] const MessageList<Part>& partLists() const { return partLists_; }
  void setPartLists(MessageList<Part> list) { partLists_ = std::move(list); }
  void clearPartLists() { clearElements(partLists_); }
  void addPartList(std::shared_ptr<Part> element) { addElement(partLists_, std::move(element)); }
  [[nodiscard]] std::size_t partListsCount() const { return countOf(partLists_); }
  [[nodiscard]] const auto& partListAtIndex(std::size_t index) const { return elementAt(partLists_, index); }

  [[nodiscard]] const MessageList<Part>& instValues() const { return instValues_; }
  void setInstValues(MessageList<Part> list) { instValues_ = std::move(list); }
  void clearInstValues() { clearElements(instValues_); }
  void addInstValues(std::shared_ptr<Part> element) { addElement(instValues_, std::move(element)); }
  [[nodiscard]] std::size_t instValuesCount() const { return countOf(instValues_); }
  [[nodiscard]] const auto& instValuesAtIndex(std::size_t index) const { return elementAt(instValues_, index); }

  [[nodiscard]] const std::uint32_t* multiBandInfos() const { return multiBandInfos_.values(); }
  [[nodiscard]] std::size_t multiBandInfosCount() const { return multiBandInfos_.count(); }
  void clearMultiBandInfos() { multiBandInfos_.clear(); }
  void addMultiBandInfo(std::uint32_t value) { multiBandInfos_.add(value); }
  [[nodiscard]] std::uint32_t multiBandInfoAtIndex(std::size_t index) const { return multiBandInfos_.at(index); }
  void setMultiBandInfos(const std::uint32_t* values, std::size_t count) { multiBandInfos_.set(values, count); }

  [[nodiscard]] const std::int32_t* csTxPwrs() const { return csTxPwrs_.values(); }
  [[nodiscard]] std::size_t csTxPwrsCount() const { return csTxPwrs_.count(); }
  void clearCsTxPwrs() { csTxPwrs_.clear(); }
  void addCsTxPwr(std::int32_t value) { csTxPwrs_.add(value); }
  [[nodiscard]] std::int32_t csTxPwrAtIndex(std::size_t index) const { return csTxPwrs_.at(index); }
  void setCsTxPwrs(const std::int32_t* values, std::size_t count) { csTxPwrs_.set(values, count); }

  [[nodiscard]] const std::int32_t* codes() const { return codes_.values(); }
  [[nodiscard]] std::size_t codesCount() const { return codes_.count(); }
  void clearCodes() { codes_.clear(); }
  void addCode(std::int32_t value) { codes_.add(value); }
  [[nodiscard]] std::int32_t codeAtIndex(std::size_t index) const { return codes_.at(index); }
  void setCodes(const std::int32_t* values, std::size_t count) { codes_.set(values, count); }

  [[nodiscard]] bool readFrom(ProtoReader& reader) override;
  void writeTo(ProtoWriter& writer) const override;
  [[nodiscard]] Dictionary dictionaryRepresentation() const override;
  void writeJson(JsonWriter& json) const override;

  /// Sets in `other` what is present here; objects are shared, not copied.
  void copyTo(Self& other) const;
  /// A message that shares nothing with this one.
  [[nodiscard]] std::shared_ptr<Kinds> copyWithZone() const;
  /// Takes over what is present in `other`: lists grow by its elements, single messages merge.
  void mergeFrom(const Self& other);

  [[nodiscard]] bool hasEqualFields(const Self& other) const;
  [[nodiscard]] std::uint64_t hash() const override;

 private:
  /// Gives the fields that are present to `fields`, with their names.
  template <class Fields>
  void giveTo(Fields& fields) const;

  /// Which bit of the presence word is whose.
  enum PresenceBit : unsigned {
    kTimestamp,
    kQRxlevMin,
    kPlain,
    kZigZag,
    kIsSet,
    kNested,
    kMode,
  };

  std::uint64_t timestamp_ = 0;
  std::uint32_t qRxlevMin_ = 0;
  std::int32_t plain_ = 0;
  std::int32_t zigZag_ = 0;
  bool isSet_ = false;
  Mode mode_{};
  Nested nested_{};
  std::optional<Text> apn_;
  std::optional<Data> content_;
  std::shared_ptr<Part> part_;
  MessageList<Part> partLists_;
  MessageList<Part> instValues_;
  RepeatedUInt32 multiBandInfos_;
  RepeatedInt32 csTxPwrs_;
  RepeatedInt32 codes_;
};

/// The value's name, or "(unknown: 31)" with its number.
[[nodiscard]] Text nameOf(Kinds::Nested value);

}  // namespace vesk::metrics
