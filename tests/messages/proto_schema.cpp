#include "messages/proto_schema.h"

#include <fstream>
#include <iterator>
#include <optional>

#include "resolver.h"

namespace vesk {

namespace {

struct Schema {
  std::map<std::string, messagegen::MessageType, std::less<>> messages;
  /// Those of the files, not those that a message contains.
  std::map<std::string, messagegen::Enumeration> enumerations;

  Schema() {
    const auto readSource = [](const std::string& path) {
      std::ifstream file(std::string(VESK_SCHEMA) + '/' + path);
      return std::optional(std::string(std::istreambuf_iterator<char>(file), {}));
    };
    for (const char* path :
         {"gsm/gsm.proto", "lte/lte.proto", "nas/nas.proto", "shared/sys_band.proto", "wcdma/wcdma.proto"}) {
      const messagegen::ProtoFile file = messagegen::loadProto(path, readSource);
      for (const auto& enumeration : file.enumerations)
        enumerations[enumeration.name] = enumeration;
      for (const auto& message : file.messages)
        messages[message.name] = message;
    }
  }
};

const Schema& theSchema() {
  static const Schema kSchema;
  return kSchema;
}

}  // namespace

const std::map<std::string, messagegen::MessageType, std::less<>>& schema() {
  return theSchema().messages;
}

const messagegen::Enumeration& enumerationOf(const messagegen::MessageType& message, const messagegen::Field& field) {
  for (const messagegen::Enumeration& each : message.enumerations) {
    if (each.name == field.typeName) return each;
  }
  return theSchema().enumerations.at(field.typeName);
}

}  // namespace vesk
