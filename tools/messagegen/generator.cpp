#include "generator.h"

#include <algorithm>
#include <google/protobuf/io/coded_stream.h>
#include <google/protobuf/io/zero_copy_stream.h>
#include <memory>

#include "emit.h"
#include "supported.h"

namespace messagegen {

using google::protobuf::compiler::GeneratorContext;

void writeFile(GeneratorContext& context, const std::string& path, const std::string& content) {
  const std::unique_ptr<google::protobuf::io::ZeroCopyOutputStream> stream(context.Open(path));
  google::protobuf::io::CodedOutputStream(stream.get()).WriteString(content);
}

bool MessageGenerator::Generate(const FileDescriptor* file, const std::string& /*parameter*/, GeneratorContext* context,
                                std::string* error) const {
  try {
    checkSupported(*file);
  } catch (const Refusal& refusal) {
    *error = refusal.what();
    return false;
  }
  const std::string stem = file->name().substr(0, file->name().rfind('.'));
  writeFile(*context, stem + ".h", emitHeader(*file));
  writeFile(*context, stem + ".cpp", emitSource(*file));
  return true;
}

bool MessageGenerator::GenerateAll(const std::vector<const FileDescriptor*>& files, const std::string& parameter,
                                   GeneratorContext* context, std::string* error) const {
  return std::all_of(files.begin(), files.end(),
                     [&](const FileDescriptor* file) { return Generate(file, parameter, context, error); });
}

}  // namespace messagegen
