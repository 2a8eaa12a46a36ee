// A plugin of protoc: writes visits.h and visits.cpp, which hold for every message of the files one straight-line
// protozero visit of its fields: the least that any decoder has to do.

#include <google/protobuf/compiler/code_generator.h>
#include <google/protobuf/compiler/plugin.h>

#include "generator.h"
#include "schema.h"
#include "snippet.h"

namespace {

using google::protobuf::compiler::GeneratorContext;
using messagegen::Descriptor;
using messagegen::expand;
using messagegen::FieldDescriptor;
using messagegen::FileDescriptor;

std::string emitLengthDelimited(const FieldDescriptor& field) {
  const Descriptor* message = field.message_type();
  const std::string summand =
      message != nullptr ? "visit" + message->name() + "(reader.get_view())" : "reader.get_view().size()";
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::length_delimited):
  sum += $summand$;
  break;
)code",
                {{"number", std::to_string(field.number())}, {"summand", summand}});
}

std::string emitScalar(const FieldDescriptor& field) {
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::varint):
  sum += summand(reader.get_$type$());
  break;
)code",
                {{"number", std::to_string(field.number())}, {"type", field.type_name()}});
}

std::string emitPacked(const FieldDescriptor& field) {
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::length_delimited):
  for (const auto value : reader.get_packed_$type$())
    sum += summand(value);
  break;
)code",
                {{"number", std::to_string(field.number())}, {"type", field.type_name()}});
}

std::string emitCases(const FieldDescriptor& field) {
  if (!FieldDescriptor::IsTypePackable(field.type())) return emitLengthDelimited(field);
  return emitScalar(field) + (field.is_repeated() ? emitPacked(field) : "");
}

std::string emitVisit(const Descriptor& message) {
  std::string cases;
  for (const FieldDescriptor* field : messagegen::fieldsOf(message))
    cases += emitCases(*field);
  return expand(R"code(
std::uint64_t visit$message$(protozero::data_view payload) {
  std::uint64_t sum = 0;
  protozero::pbf_reader reader(payload);
  while (reader.next()) {
    switch (reader.tag_and_type()) {
      $cases$
      default:
        reader.skip();
    }
  }
  return sum;
}

)code",
                {{"message", message.name()}, {"cases", cases}});
}

std::string emitHeader(const std::vector<const Descriptor*>& messages) {
  std::string declarations;
  for (const Descriptor* message : messages)
    declarations += "std::uint64_t visit" + message->name() + "(protozero::data_view payload);\n";
  return expand(R"code(
// Generated from the .proto files; do not edit.
#pragma once

#include <cstdint>
#include <protozero/data_view.hpp>

/// The sum of all numbers of a message and of the sizes of its texts and byte strings.
namespace visits {

$declarations$

}  // namespace visits
)code",
                {{"declarations", declarations}});
}

std::string emitSource(const std::vector<const Descriptor*>& messages) {
  std::string definitions;
  for (const Descriptor* message : messages)
    definitions += emitVisit(*message);
  return expand(R"code(
// Generated from the .proto files; do not edit.
#include "visits.h"

#include <protozero/pbf_reader.hpp>

namespace visits {

using protozero::pbf_wire_type;
using protozero::tag_and_type;

namespace {

template <class Number>
std::uint64_t summand(Number number) {
  return static_cast<std::uint64_t>(number);
}

}  // namespace

$definitions$

}  // namespace visits
)code",
                {{"definitions", definitions}});
}

class VisitGenerator : public google::protobuf::compiler::CodeGenerator {
 public:
  bool Generate(const FileDescriptor* file, const std::string& parameter, GeneratorContext* context,
                std::string* error) const override {
    return GenerateAll({file}, parameter, context, error);
  }

  bool GenerateAll(const std::vector<const FileDescriptor*>& files, const std::string& /*parameter*/,
                   GeneratorContext* context, std::string* /*error*/) const override {
    std::vector<const Descriptor*> messages;
    for (const FileDescriptor* file : files) {
      const std::vector<const Descriptor*> more = messagegen::messagesOf(*file);
      messages.insert(messages.end(), more.begin(), more.end());
    }
    messagegen::writeFile(*context, "visits.h", emitHeader(messages));
    messagegen::writeFile(*context, "visits.cpp", emitSource(messages));
    return true;
  }
};

}  // namespace

int main(int argc, char** argv) {
  const VisitGenerator generator;
  return google::protobuf::compiler::PluginMain(argc, argv, &generator);
}
