#include "schema.h"

#include <algorithm>
#include <sstream>

namespace messagegen {

namespace {

template <class Element, class Owner>
std::vector<const Element*> all(const Owner& owner, int count, const Element* (Owner::*at)(int) const) {
  std::vector<const Element*> elements;
  elements.reserve(static_cast<std::size_t>(count));
  for (int index = 0; index < count; ++index)
    elements.push_back((owner.*at)(index));
  return elements;
}

}  // namespace

std::vector<const Descriptor*> messagesOf(const FileDescriptor& file) {
  return all(file, file.message_type_count(), &FileDescriptor::message_type);
}

std::vector<const EnumDescriptor*> enumerationsOf(const FileDescriptor& file) {
  return all(file, file.enum_type_count(), &FileDescriptor::enum_type);
}

std::vector<const EnumDescriptor*> enumerationsOf(const Descriptor& message) {
  return all(message, message.enum_type_count(), &Descriptor::enum_type);
}

std::vector<const EnumValueDescriptor*> valuesOf(const EnumDescriptor& enumeration) {
  return all(enumeration, enumeration.value_count(), &EnumDescriptor::value);
}

std::vector<const FieldDescriptor*> fieldsOf(const Descriptor& message) {
  return all(message, message.field_count(), &Descriptor::field);
}

std::vector<const FieldDescriptor*> fieldsByNumber(const Descriptor& message) {
  std::vector<const FieldDescriptor*> fields = fieldsOf(message);
  std::sort(fields.begin(), fields.end(), [](const auto* a, const auto* b) { return a->number() < b->number(); });
  return fields;
}

std::vector<std::string> commentLines(const SourceLocation& location) {
  std::vector<std::string> lines;
  std::istringstream comment(location.leading_comments);
  for (std::string line; std::getline(comment, line);) {
    line.erase(line.find_last_not_of(" \t\r") + 1);
    lines.push_back(line.starts_with(' ') ? line.substr(1) : line);
  }
  return lines;
}

Refusal::Refusal(const FileDescriptor& file, const SourceLocation& location, const std::string& text)
    : std::runtime_error(file.name() + ":" + std::to_string(location.start_line + 1) + ":" +
                         std::to_string(location.start_column + 1) + ": " + text) {}

}  // namespace messagegen
