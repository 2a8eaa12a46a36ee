#include "names.h"

#include <algorithm>
#include <cctype>
#include <iterator>
#include <sstream>

namespace messagegen {

namespace {

const std::set<std::string, std::less<>> kKeywords = wordsOf(R"(
  alignas alignof and and_eq asm auto bitand bitor bool break case catch char char16_t char32_t char8_t class
  co_await co_return co_yield compl concept const const_cast consteval constexpr constinit continue decltype default
  delete do double dynamic_cast else enum explicit export extern false float for friend goto if inline int long
  mutable namespace new noexcept not not_eq nullptr operator or or_eq private protected public register
  reinterpret_cast requires return short signed sizeof static static_assert static_cast struct switch template this
  thread_local throw true try typedef typeid typename union unsigned using virtual void volatile wchar_t while xor
  xor_eq
)");

/// Members of every message, the functions that they call and the types that they name.
const std::set<std::string, std::less<>> kNamesOfTheCodec = wordsOf(R"(
  addElement appendJson assign className clearElements copyElements copyScalar copyTo copyValues copyWithZone
  countOf Data deepCopy description Dictionary DictionaryFields dictionaryRepresentation elementAt FieldCursor
  Fields giveTo has hasEqualFields hash initWithData isEqual isSameList isSameObject isSameScalar JsonFields
  JsonWriter kClassName makeMessage mergeElements mergeFrom mergeObject Message MessageList nameOf objectHash
  PresenceBit presentScalars ProtoCodable ProtoReader ProtoWriter readElement readFrom readObject readRepeated
  readUndeclaredField RepeatedInt32 RepeatedUInt32 scalarHash Self setPresence std Text unknownName WireType
  writeElements writeJson writePacked writeTo
)");

}  // namespace

std::set<std::string, std::less<>> wordsOf(std::string_view text) {
  std::istringstream words{std::string(text)};
  return {std::istream_iterator<std::string>(words), {}};
}

bool isKeyword(std::string_view name) {
  return kKeywords.contains(name);
}

bool isFreeName(std::string_view name) {
  const auto isPart = [](unsigned char c) { return std::isalnum(c) != 0 || c == '_'; };
  const bool isIdentifier = !name.empty() && std::isdigit(static_cast<unsigned char>(name.front())) == 0 &&
                            std::all_of(name.begin(), name.end(), isPart);
  return isIdentifier && !isKeyword(name) && !kNamesOfTheCodec.contains(name);
}

}  // namespace messagegen
