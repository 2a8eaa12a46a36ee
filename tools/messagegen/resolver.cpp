#include "resolver.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>
#include <utility>

#include "names.h"
#include "parser.h"

namespace messagegen {

namespace {

const std::map<std::string_view, FieldType> kScalars{
    {"uint32", FieldType::uint32}, {"int32", FieldType::int32},  {"sint32", FieldType::sint32},
    {"uint64", FieldType::uint64}, {"bool", FieldType::boolean}, {"string", FieldType::string},
    {"bytes", FieldType::bytes},
};

/// What every message has from its base.
const std::set<std::string_view> kOperations{
    "assign",
    "className",
    "copyScalar",
    "copyTo",
    "copyWithZone",
    "description",
    "dictionaryRepresentation",
    "has",
    "hasEqualFields",
    "hash",
    "initWithData",
    "isEqual",
    "isSameScalar",
    "mergeFrom",
    "presentScalars",
    "readFields",
    "readFrom",
    "scalarHash",
    "setPresence",
    "writeTo",
};

/// The names of all accessors of a field.
std::vector<std::string> accessorsOf(const Field& field) {
  const std::string property = propertyOf(field);
  std::vector<std::string> names{property, "set" + capitalized(property)};
  if (field.repeated) {
    const std::string element = elementOf(field);
    names.insert(names.end(), {"clear" + capitalized(property), "add" + capitalized(element), property + "Count",
                               element + "AtIndex"});
  } else {
    names.push_back("has" + capitalized(property));
    if (field.isOptionalScalar()) names.push_back("setHas" + capitalized(property));
  }
  return names;
}

constexpr std::size_t kMostPresenceBits = 64;
/// The decoder's stack grows with the depth to which messages nest; those of one file, for each is held to it.
constexpr std::size_t kDeepestMessage = 32;

class Resolver {
 public:
  Resolver(const std::string& path, const ReadSource& readSource) : path_(path) {
    std::optional<std::string> source = readSource(path);
    if (!source) throw SchemaError(path, "", {}, "cannot be read");
    source_ = std::move(*source);
    file_ = parseProto(path, source_);
    addTypes(file_);
    for (const auto& [import, position] : file_.imports) {
      const std::optional<std::string> imported = readSource(import);
      if (!imported) fail(position, "import \"" + import + "\" cannot be read");
      addImport(parseProto(import, *imported), position);
    }
  }

  ProtoFile resolve() {
    for (MessageType& message : file_.messages) {
      for (Field& field : message.fields)
        resolveField(message, field);
      checkAccessors(message);
    }
    orderByUse();
    return std::move(file_);
  }

 private:
  [[noreturn]] void fail(Position position, const std::string& message) const {
    throw SchemaError(path_, source_, position, message);
  }

  void addTypes(const ProtoFile& file) {
    for (const MessageType& message : file.messages)
      messages_.insert(message.name);
    for (const Enumeration& enumeration : file.enumerations)
      enumerations_[enumeration.name] = enumeration;
  }

  /// The generated code names every type as it stands, in the one namespace of the package.
  void addImport(const ProtoFile& imported, Position position) {
    if (imported.package != file_.package) fail(position, "import \"" + imported.path + "\" is of another package");
    const auto checkIsNew = [&](const std::string& name) {
      if (!messages_.contains(name) && !enumerations_.contains(name)) return;
      fail(position, "import \"" + imported.path + "\" declares '" + name + "', which is declared already");
    };
    for (const MessageType& message : imported.messages)
      checkIsNew(message.name);
    for (const Enumeration& enumeration : imported.enumerations)
      checkIsNew(enumeration.name);
    addTypes(imported);
  }

  [[nodiscard]] const Enumeration* findEnumeration(const MessageType& message, const std::string& name) const {
    const auto nested = std::find_if(message.enumerations.begin(), message.enumerations.end(),
                                     [&](const Enumeration& each) { return each.name == name; });
    if (nested != message.enumerations.end()) return &*nested;
    const auto found = enumerations_.find(name);
    return found == enumerations_.end() ? nullptr : &found->second;
  }

  void resolveField(const MessageType& message, Field& field) const {
    if (const auto scalar = kScalars.find(field.typeName); scalar != kScalars.end()) {
      field.type = scalar->second;
    } else if (const Enumeration* enumeration = findEnumeration(message, field.typeName)) {
      field.type = FieldType::enumeration;
      field.defaultName = enumeration->values.front().name;
    } else if (messages_.contains(field.typeName)) {
      field.type = FieldType::message;
    } else {
      fail(field.typePosition, "unknown type '" + field.typeName + "'");
    }
    constexpr std::array kRepeatable{FieldType::uint32, FieldType::int32, FieldType::sint32, FieldType::message};
    if (field.repeated && std::find(kRepeatable.begin(), kRepeatable.end(), field.type) == kRepeatable.end()) {
      fail(field.typePosition, "a repeated field is of type uint32, int32, sint32 or a message");
    }
  }

  void checkAccessors(const MessageType& message) const {
    std::set<std::string> taken{message.name};
    for (const Enumeration& enumeration : message.enumerations)
      taken.insert(enumeration.name);
    std::size_t presenceBits = 0;
    for (const Field& field : message.fields) {
      for (const std::string& accessor : accessorsOf(field)) {
        if (!isIdentifier(accessor)) fail(field.position, "the accessor '" + accessor + "' is no name");
        if (isKeyword(accessor) || kOperations.contains(accessor) || !taken.insert(accessor).second) {
          fail(field.position, "the accessor '" + accessor + "' has its name from something else already");
        }
      }
      if (field.isOptionalScalar() && ++presenceBits > kMostPresenceBits) {
        fail(field.position, "more than 64 optional scalars in one message");
      }
    }
  }

  /// C++ wants a class declared before it is used; a .proto file does not. A message that contains itself is
  /// refused: the schema's depth is what bounds the decoder's stack.
  void orderByUse() {
    std::map<std::string, const MessageType*> declared;
    for (const MessageType& message : file_.messages)
      declared[message.name] = &message;
    std::vector<MessageType> ordered;
    std::map<std::string, std::size_t> depths;
    std::set<std::string> open;
    const std::function<std::size_t(const MessageType&)> place = [&](const MessageType& message) {
      if (const auto placed = depths.find(message.name); placed != depths.end()) return placed->second;
      std::size_t depth = 1;
      open.insert(message.name);
      for (const Field& field : message.fields) {
        if (!field.isMessage()) continue;
        if (open.contains(field.typeName)) fail(field.typePosition, "'" + field.typeName + "' contains itself");
        const auto used = declared.find(field.typeName);
        if (used == declared.end()) continue;
        const bool isDeepest = open.size() == kDeepestMessage;
        if (!isDeepest) depth = std::max(depth, 1 + place(*used->second));
        if (isDeepest || depth > kDeepestMessage) fail(field.typePosition, "messages nest more than 32 deep");
      }
      open.erase(message.name);
      ordered.push_back(message);
      return depths[message.name] = depth;
    };
    for (const MessageType& message : file_.messages)
      place(message);
    file_.messages = std::move(ordered);
  }

  std::string path_;
  std::string source_;
  ProtoFile file_;
  std::set<std::string> messages_;
  std::map<std::string, Enumeration> enumerations_;
};

}  // namespace

ProtoFile loadProto(const std::string& path, const ReadSource& readSource) {
  return Resolver(path, readSource).resolve();
}

}  // namespace messagegen
