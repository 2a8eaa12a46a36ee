#include "messages/proto_schema.h"

#include <cstdlib>
#include <filesystem>
#include <google/protobuf/compiler/importer.h>
#include <iostream>

namespace vesk {

namespace {

namespace fs = std::filesystem;
namespace pb = google::protobuf;

class Schema : private pb::compiler::MultiFileErrorCollector {
 public:
  Schema() {
    tree_.MapPath("", VESK_SCHEMA);
    for (const auto& entry : fs::recursive_directory_iterator(VESK_SCHEMA)) {
      if (entry.path().extension() != ".proto") continue;
      const pb::FileDescriptor* file = importer_.Import(fs::relative(entry.path(), VESK_SCHEMA));
      for (int index = 0; index < file->message_type_count(); ++index)
        messages_.push_back(file->message_type(index));
    }
  }

  [[nodiscard]] const std::vector<const Descriptor*>& messages() const { return messages_; }

 private:
  void AddError(const std::string& file, int line, int column, const std::string& message) override {
    std::cerr << file << ':' << line + 1 << ':' << column + 1 << ": " << message << '\n';
    std::abort();
  }

  pb::compiler::DiskSourceTree tree_;
  pb::compiler::Importer importer_{&tree_, this};
  std::vector<const Descriptor*> messages_;
};

}  // namespace

const std::vector<const Descriptor*>& declaredMessages() {
  static const Schema kSchema;
  return kSchema.messages();
}

const Descriptor& declaredMessage(std::string_view name) {
  for (const Descriptor* message : declaredMessages()) {
    if (message->name() == name) return *message;
  }
  std::abort();
}

std::map<int, const FieldDescriptor*> fieldsByNumber(const Descriptor& message) {
  std::map<int, const FieldDescriptor*> fields;
  for (int index = 0; index < message.field_count(); ++index)
    fields[message.field(index)->number()] = message.field(index);
  return fields;
}

}  // namespace vesk
