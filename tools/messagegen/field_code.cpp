#include "field.h"

namespace messagegen {

namespace {

constexpr FieldCode kScalar{
    .accessors = R"code(
[[nodiscard]] $value$ $property$() const { return $gotten$; }
void set$Property$($value$ value) { assign($bit$, $member$, value); }
[[nodiscard]] bool has$Property$() const { return has($bit$); }
void setHas$Property$(bool present) { setPresence($bit$, present); }
)code",
    .read = "assign($bit$, $member$, cursor.$read$());",
    .write = "if (has($bit$)) writer.$write$($member$, $number$);",
    .give = R"(if (has($bit$)) fields.append("$key$"_text, $shown$);)",
    .copy = "copyScalar(other, $bit$, &Self::$member$);",
    .deepCopy = "",
    .merge = "other.copyScalar(*this, $bit$, &Self::$member$);",
    .compare = "if (!isSameScalar(other, $bit$, &Self::$member$)) return false;",
    .hash = "result ^= scalarHash($bit$, $member$);",
};

constexpr FieldCode kString{
    .accessors = R"code(
[[nodiscard]] const $held$& $property$() const { return $member$; }
void set$Property$($held$ value) { $member$ = std::move(value); }
[[nodiscard]] bool has$Property$() const { return static_cast<bool>($member$); }
)code",
    .read = "$member$ = cursor.$read$();",
    .write = "if ($member$) writer.$write$(*$member$, $number$);",
    .give = R"(if ($member$) fields.append("$key$"_text, *$member$);)",
    .copy = "if ($member$) other.$member$ = $member$;",
    .deepCopy = "",
    .merge = "if (other.$member$) $member$ = other.$member$;",
    .compare = "if (!($member$ == other.$member$)) return false;",
    .hash = "result ^= objectHash($member$);",
};

constexpr FieldCode kMessage{
    .accessors = kString.accessors,
    .read = "if (!readObject($member$, cursor)) return false;",
    .write = "if ($member$) writer.$write$(*$member$, $number$);",
    .give = R"(if ($member$) fields.append("$key$"_text, $member$);)",
    .copy = "if ($member$) other.$member$ = $member$;",
    .deepCopy = "copy->$member$ = deepCopy($member$);",
    .merge = "mergeObject(other.$member$, $member$);",
    .compare = "if (!isSameObject($member$, other.$member$)) return false;",
    .hash = "result ^= objectHash($member$);",
};

constexpr FieldCode kRepeatedScalar{
    .accessors = R"code(
[[nodiscard]] const $value$* $property$() const { return $member$.values(); }
[[nodiscard]] std::size_t $property$Count() const { return $member$.count(); }
void clear$Property$() { $member$.clear(); }
void add$Element$($value$ value) { $member$.add(value); }
[[nodiscard]] $value$ $element$AtIndex(std::size_t index) const { return $member$.at(index); }
void set$Property$(const $value$* values, std::size_t count) { $member$.set(values, count); }
)code",
    .read = "if (!readRepeated<&FieldCursor::$read$>($member$, cursor)) return false;",
    .write = "writePacked<&ProtoWriter::$write$>($member$, $number$, writer);",
    .give = R"(fields.append("$key$"_text, $member$);)",
    .copy = "copyValues($member$, other.$member$);",
    .deepCopy = "",
    .merge = "$member$.append(other.$member$);",
    .compare = "if (!$member$.isEqual(other.$member$)) return false;",
    .hash = "result ^= $member$.hash();",
};

constexpr FieldCode kMessageList{
    .accessors = R"code(
[[nodiscard]] const $held$& $property$() const { return $member$; }
void set$Property$($held$ list) { $member$ = std::move(list); }
void clear$Property$() { clearElements($member$); }
void add$Element$($value$ element) { addElement($member$, std::move(element)); }
[[nodiscard]] std::size_t $property$Count() const { return countOf($member$); }
[[nodiscard]] const auto& $element$AtIndex(std::size_t index) const { return elementAt($member$, index); }
)code",
    .read = R"code(
do {
  if (!readElement($member$, cursor)) return false;
} while (cursor.readKeyIf<$number$, $wire$>());
)code",
    .write = "writeElements($member$, $number$, writer);",
    .give = R"(if (countOf($member$) != 0) fields.append("$key$"_text, $member$);)",
    .copy = "copyElements($member$, other.$member$);",
    .deepCopy = "copy->$member$ = deepCopy($member$);",
    .merge = "mergeElements(other.$member$, $member$);",
    .compare = "if (!isSameList($member$, other.$member$)) return false;",
    .hash = "result ^= objectHash($member$);",
};

}  // namespace

const FieldCode& codeOf(FieldKind kind) {
  switch (kind) {
    case FieldKind::scalar:
      return kScalar;
    case FieldKind::string:
      return kString;
    case FieldKind::message:
      return kMessage;
    case FieldKind::repeatedScalar:
      return kRepeatedScalar;
    case FieldKind::messageList:
      break;
  }
  return kMessageList;
}

}  // namespace messagegen
