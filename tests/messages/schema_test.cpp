// What the wire and the screens rest on: every name, number and type of the .proto files, as the handset has them.

#include <cctype>
#include <fstream>
#include <gtest/gtest.h>
#include <set>
#include <string>

#include "messages/message_classes.h"
#include "messages/proto_schema.h"

namespace vesk {
namespace {

/// FNV-1a over the declarations of a file; neither comments nor blanks count.
std::uint64_t fingerprintOf(const std::string& path) {
  std::ifstream file(std::string(VESK_SCHEMA) + '/' + path);
  std::uint64_t fingerprint = 0xCBF29CE484222325;
  for (std::string line; std::getline(file, line);) {
    line.resize(std::min(line.find("//"), line.size()));
    for (const char c : line) {
      if (std::isspace(static_cast<unsigned char>(c)) == 0)
        fingerprint = (fingerprint ^ static_cast<std::uint8_t>(c)) * 0x100000001B3;
    }
  }
  return fingerprint;
}

TEST(Schema, IsTheOneThatTheHandsetWrites) {
  const std::pair<const char*, std::uint64_t> files[] = {
      {"gsm/gsm.proto", 0xC3899C3B66E4B692},     {"lte/lte.proto", 0x6ED4856F1F3490A4},
      {"nas/nas.proto", 0xF770BEEA6FC3C0D0},     {"shared/sys_band.proto", 0x07751BFD993934DD},
      {"wcdma/wcdma.proto", 0x435598875F234CBA},
  };
  for (const auto& [path, fingerprint] : files) {
    EXPECT_EQ(fingerprintOf(path), fingerprint) << path
                                                << " differs: what is there must keep its names, numbers and types; "
                                                   "when only new ones came, put the new number here";
  }
}

TEST(Schema, NamesTheMessagesThatTheTestsGoThrough) {
  std::set<std::string_view> listed;
  for (const MessageClass& each : metrics::kEveryMessage)
    listed.insert(each.name);
  std::set<std::string_view> declared;
  for (const Descriptor* message : declaredMessages())
    declared.insert(message->name());
  EXPECT_EQ(listed, declared);
}

}  // namespace
}  // namespace vesk
