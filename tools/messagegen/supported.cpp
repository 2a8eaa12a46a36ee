#include "supported.h"

#include <algorithm>
#include <google/protobuf/descriptor.pb.h>
#include <map>
#include <sstream>

#include "emit.h"
#include "names.h"

namespace messagegen {

namespace {

using google::protobuf::FileDescriptorProto;
using Location = google::protobuf::SourceCodeInfo::Location;

/// Every construct that a file may have: what descriptor.proto calls it, behind what it calls that around it.
const std::set<std::string, std::less<>> kConstructs = wordsOf(R"(
  syntax package dependency enum_type message_type
  enum_type.name enum_type.value value.name value.number
  message_type.name message_type.enum_type message_type.field
  field.label field.type field.type_name field.name field.number field.options options.packed
)");

std::string constructAt(const Location& location) {
  std::string outer;
  std::string inner;
  const Descriptor* type = FileDescriptorProto::descriptor();
  for (int index = 0; type != nullptr && index < location.path_size(); ++index) {
    const FieldDescriptor* step = type->FindFieldByNumber(location.path(index));
    outer = inner.empty() ? "" : inner + ".";
    inner = step == nullptr ? "custom_option" : step->name();
    type = step == nullptr ? nullptr : step->message_type();
    // The next number says which one of many.
    if (step != nullptr && step->is_repeated()) ++index;
  }
  return outer + inner;
}

void checkConstructs(const FileDescriptor& file) {
  FileDescriptorProto proto;
  file.CopySourceCodeInfoTo(&proto);
  for (const Location& location : proto.source_code_info().location()) {
    const std::string construct = constructAt(location);
    if (construct.empty() || kConstructs.contains(construct)) continue;
    const std::vector<int> path(location.path().begin(), location.path().end());
    throw Refusal(file, locationOf(file, path), "'" + construct + "' is not supported; docs/fields.md shows what is");
  }
}

void checkFile(const FileDescriptor& file) {
  const auto refuse = [&](const std::vector<int>& path, const std::string& text) {
    throw Refusal(file, locationOf(file, path), text);
  };
  if (file.syntax() != FileDescriptor::SYNTAX_PROTO2) {
    refuse({FileDescriptorProto::kSyntaxFieldNumber}, "the syntax is not supported; write the file in proto2");
  }
  checkConstructs(file);
  if (!isFreeName(file.package())) {
    refuse({FileDescriptorProto::kPackageFieldNumber},
           "the package '" + file.package() + "' is no name for a namespace; give it one");
  }
  for (int index = 0; index < file.dependency_count(); ++index) {
    if (file.dependency(index)->package() == file.package()) continue;
    refuse({FileDescriptorProto::kDependencyFieldNumber, index}, "the import is of another package; make it the same");
  }
}

template <class Declaration>
[[noreturn]] void refuse(const Declaration& declaration, const std::string& text) {
  throw Refusal(*declaration.file(), locationOf(declaration), text);
}

/// The names of one scope of the generated code.
class Scope {
 public:
  template <class Declaration>
  void add(const std::string& name, const Declaration& declaration) {
    if (isFreeName(name) && names_.insert(name).second) return;
    refuse(declaration, "'" + declaration.name() + "' would be '" + name +
                            "' in C++, which is taken or cannot be a name; call it something else");
  }

 private:
  std::set<std::string> names_;
};

/// Comments become comments of the generated code, and must end there where they end here.
template <class Declaration>
void checkComment(const Declaration& declaration) {
  for (const std::string& line : commentLines(locationOf(declaration))) {
    if (line.ends_with('\\') || line.find_first_of("\r\f\v") != std::string::npos) {
      refuse(declaration, "its comment has a control character or a line that ends in a backslash; take that away");
    }
  }
}

/// Functions and variables begin with small letters, so that no type can hide one.
template <class Type>
void checkType(const Type& type, Scope& scope) {
  if (type.name().front() < 'A' || type.name().front() > 'Z') {
    refuse(type, "the type '" + type.name() + "' does not begin with a capital letter; let it do so");
  }
  scope.add(type.name(), type);
  checkComment(type);
}

void checkEnumeration(const EnumDescriptor& enumeration, Scope& scope) {
  checkType(enumeration, scope);
  for (const EnumValueDescriptor* value : valuesOf(enumeration)) {
    if (isKeyword(value->name())) refuse(*value, "'" + value->name() + "' is a keyword of C++; call it something else");
  }
}

/// The generated code calls each type by its bare name.
template <class Type>
void checkUse(const FieldDescriptor& field, const Type& type) {
  const Descriptor& user = *field.containing_type();
  const Descriptor* owner = type.containing_type();
  const bool isHidden = owner == nullptr && user.FindEnumTypeByName(type.name()) != nullptr;
  if (!isHidden && (owner == nullptr || owner == &user)) return;
  refuse(field,
         "'" + type.name() + "' means nothing or something else here; declare it by itself and under another name");
}

void checkField(const FieldDescriptor& field) {
  constexpr int kLargestNumber = 65535;  // The reader keeps 16 bits of it.
  const std::string typeName = field.is_map() ? "map" : field.type_name();
  if (field.is_map() || !isSupportedType(field.type())) {
    refuse(field, "the type " + typeName + " is not supported; docs/fields.md shows what is");
  }
  if (field.is_required()) refuse(field, "a required field is not supported; make it optional");
  if (field.is_repeated() && !canBeRepeated(field.type())) {
    refuse(field, "a repeated " + typeName + " is not supported; docs/fields.md shows what is");
  }
  if (field.options().has_packed() && !field.options().packed()) {
    refuse(field, "repeated numbers are always written packed; take the option away");
  }
  if (field.number() > kLargestNumber) refuse(field, "the field number is above 65535; take a smaller one");
  if (field.message_type() != nullptr) checkUse(field, *field.message_type());
  if (field.enum_type() != nullptr) checkUse(field, *field.enum_type());
  checkComment(field);
}

/// Each name stands before the first parenthesis of its accessor.
void addAccessors(const FieldDescriptor& field, Scope& members) {
  std::istringstream accessors(emitAccessors(field));
  for (std::string line; std::getline(accessors, line);) {
    const std::size_t end = line.find('(');
    if (line.starts_with(' ') || end == std::string::npos) continue;
    const std::size_t start = line.find_last_of(" *&", end) + 1;
    members.add(line.substr(start, end - start), field);
  }
  if (kindOf(field) == FieldKind::scalar) members.add(fieldVariables(field).at("bit"), field);
}

void checkMessage(const Descriptor& message, Scope& types) {
  constexpr int kMostPresenceBits = 64;
  checkType(message, types);
  if (message.field_count() == 0) refuse(message, "the message has no fields; give it one");
  Scope members;
  members.add(message.name(), message);
  for (const EnumDescriptor* enumeration : enumerationsOf(message))
    checkEnumeration(*enumeration, members);
  int presenceBits = 0;
  for (const FieldDescriptor* field : fieldsOf(message)) {
    checkField(*field);
    addAccessors(*field, members);
    presenceBits += kindOf(*field) == FieldKind::scalar ? 1 : 0;
    if (presenceBits > kMostPresenceBits) refuse(*field, "the message has more than 64 optional scalars; divide it");
  }
}

/// How deep a message nests, as far as that is known. The decoder's stack grows with it.
using Depths = std::map<const Descriptor*, int>;

int checkDepth(const Descriptor& message, Depths& depths) {
  constexpr int kDeepest = 32;
  constexpr int kStillOpen = 0;
  const auto [known, isNew] = depths.emplace(&message, kStillOpen);
  if (!isNew) return known->second;
  int depth = 1;
  for (const FieldDescriptor* field : fieldsOf(message)) {
    const Descriptor* part = field->message_type();
    if (part == nullptr) continue;
    const int inner = checkDepth(*part, depths);
    if (inner == kStillOpen) refuse(*field, "'" + part->name() + "' contains itself; take one of its fields away");
    if (inner == kDeepest) refuse(*field, "messages nest more than 32 deep; make them flatter");
    depth = std::max(depth, inner + 1);
  }
  return depths[&message] = depth;
}

}  // namespace

void checkSupported(const FileDescriptor& file) {
  checkFile(file);
  Scope types;
  Depths depths;
  for (const EnumDescriptor* enumeration : enumerationsOf(file))
    checkEnumeration(*enumeration, types);
  for (const Descriptor* message : messagesOf(file)) {
    checkMessage(*message, types);
    checkDepth(*message, depths);
  }
}

}  // namespace messagegen
