// messagegen ROOT OUT FILE...: writes OUT/FILE.h and OUT/FILE.cpp for each FILE.proto below ROOT. A file
// whose content would not change is left alone, so that nothing is compiled again for it.

#include <exception>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <optional>
#include <string>

#include "emit.h"
#include "resolver.h"

namespace {

namespace fs = std::filesystem;

std::optional<std::string> readFile(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  if (!file) return std::nullopt;
  return std::string(std::istreambuf_iterator<char>(file), {});
}

void writeIfChanged(const fs::path& path, const std::string& content) {
  if (readFile(path) == content) return;
  fs::create_directories(path.parent_path());
  std::ofstream file(path, std::ios::binary);
  file << content;
  if (!file.flush()) throw std::runtime_error(path.string() + ": cannot be written");
}

void generate(const fs::path& root, const fs::path& out, const std::string& protoPath) {
  const auto readSource = [&](const std::string& path) { return readFile(root / path); };
  const messagegen::ProtoFile file = messagegen::loadProto(protoPath, readSource);
  writeIfChanged((out / protoPath).replace_extension(".h"), messagegen::emitHeader(file));
  writeIfChanged((out / protoPath).replace_extension(".cpp"), messagegen::emitSource(file));
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 4) {
    std::cerr << "usage: messagegen ROOT OUT FILE.proto...\n";
    return 2;
  }
  try {
    for (int index = 3; index < argc; ++index)
      generate(argv[1], argv[2], argv[index]);
  } catch (const messagegen::SchemaError& error) {
    std::cerr << error.text();
    return 1;
  } catch (const std::exception& error) {
    std::cerr << "messagegen: " << error.what() << '\n';
    return 1;
  }
  return 0;
}
