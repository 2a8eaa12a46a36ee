// visitgen ROOT OUT FILE.proto...: writes OUT/visits.h and OUT/visits.cpp, which hold for every message of the files
// one straight-line protozero visit of its fields: the least that any decoder has to do.

#include <exception>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

#include "resolver.h"
#include "snippet.h"

namespace {

namespace fs = std::filesystem;
using messagegen::expand;
using messagegen::Field;
using messagegen::FieldType;
using messagegen::MessageType;

/// Protozero's name of a scalar's type.
std::string scalarName(const Field& field) {
  switch (field.type) {
    case FieldType::boolean:
      return "bool";
    case FieldType::enumeration:
      return "enum";
    default:
      return field.typeName;
  }
}

std::string emitLengthDelimited(const Field& field) {
  const std::string summand =
      field.isMessage() ? "visit" + field.typeName + "(reader.get_view())" : "reader.get_view().size()";
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::length_delimited):
  sum += $summand$;
  break;
)code",
                {{"number", std::to_string(field.number)}, {"summand", summand}});
}

std::string emitScalar(const Field& field) {
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::varint):
  sum += summand(reader.get_$type$());
  break;
)code",
                {{"number", std::to_string(field.number)}, {"type", scalarName(field)}});
}

std::string emitPacked(const Field& field) {
  return expand(R"code(
case tag_and_type($number$, pbf_wire_type::length_delimited):
  for (const auto value : reader.get_packed_$type$())
    sum += summand(value);
  break;
)code",
                {{"number", std::to_string(field.number)}, {"type", scalarName(field)}});
}

std::string emitCases(const Field& field) {
  if (field.isObject()) return emitLengthDelimited(field);
  return emitScalar(field) + (field.isRepeatedScalar() ? emitPacked(field) : "");
}

std::string emitVisit(const MessageType& message) {
  std::string cases;
  for (const Field& field : message.fields)
    cases += emitCases(field);
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
                {{"message", message.name}, {"cases", cases}});
}

std::string emitHeader(const std::vector<MessageType>& messages) {
  std::string declarations;
  for (const MessageType& message : messages)
    declarations += "std::uint64_t visit" + message.name + "(protozero::data_view payload);\n";
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

std::string emitSource(const std::vector<MessageType>& messages) {
  std::string definitions;
  for (const MessageType& message : messages)
    definitions += emitVisit(message);
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

std::vector<MessageType> loadMessages(const fs::path& root, const std::vector<std::string>& paths) {
  const auto readSource = [&](const std::string& path) -> std::optional<std::string> {
    std::ifstream file(root / path, std::ios::binary);
    if (!file) return std::nullopt;
    return std::string(std::istreambuf_iterator<char>(file), {});
  };
  std::vector<MessageType> messages;
  for (const std::string& path : paths) {
    const messagegen::ProtoFile file = messagegen::loadProto(path, readSource);
    messages.insert(messages.end(), file.messages.begin(), file.messages.end());
  }
  return messages;
}

void write(const fs::path& path, const std::string& content) {
  std::ofstream file(path, std::ios::binary);
  file << content;
  if (!file.flush()) throw std::runtime_error(path.string() + ": cannot be written");
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 4) {
    std::cerr << "usage: visitgen ROOT OUT FILE.proto...\n";
    return 2;
  }
  try {
    const std::vector<MessageType> messages = loadMessages(argv[1], {argv + 3, argv + argc});
    const fs::path out = argv[2];
    write(out / "visits.h", emitHeader(messages));
    write(out / "visits.cpp", emitSource(messages));
  } catch (const messagegen::SchemaError& error) {
    std::cerr << error.text();
    return 1;
  } catch (const std::exception& error) {
    std::cerr << "visitgen: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
