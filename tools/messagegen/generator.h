#pragma once

#include <google/protobuf/compiler/code_generator.h>

namespace messagegen {

void writeFile(google::protobuf::compiler::GeneratorContext& context, const std::string& path,
               const std::string& content);

/// Writes for each FILE.proto its classes as FILE.h and FILE.cpp.
class MessageGenerator : public google::protobuf::compiler::CodeGenerator {
 public:
  bool Generate(const google::protobuf::FileDescriptor* file, const std::string& parameter,
                google::protobuf::compiler::GeneratorContext* context, std::string* error) const override;

  /// Like that of the base, which would put the file's name before a refusal that has it already.
  bool GenerateAll(const std::vector<const google::protobuf::FileDescriptor*>& files, const std::string& parameter,
                   google::protobuf::compiler::GeneratorContext* context, std::string* error) const override;
};

}  // namespace messagegen
