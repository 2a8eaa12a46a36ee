// Runs a fuzz target over the inputs named, and over those in the directories named: what libFuzzer found once must
// pass under every compiler ever after.

#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "property.h"

namespace {

namespace fs = std::filesystem;

std::vector<fs::path> inputsOf(const fs::path& path) {
  if (!fs::is_directory(path)) return {path};
  std::vector<fs::path> inputs;
  for (const auto& entry : fs::directory_iterator(path))
    inputs.push_back(entry.path());
  return inputs;
}

void replay(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  const std::vector<char> content{std::istreambuf_iterator<char>(file), {}};
  if (!file) {
    std::fprintf(stderr, "%s: cannot be read\n", path.c_str());
    std::exit(1);
  }
  // Stays as the last line when the target ends the program.
  std::fprintf(stderr, "%s\n", path.c_str());
  LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(content.data()), content.size());
}

}  // namespace

int main(int argc, char** argv) {
  std::size_t count = 0;
  for (int index = 1; index < argc; ++index) {
    for (const fs::path& input : inputsOf(argv[index])) {
      replay(input);
      ++count;
    }
  }
  std::printf("%zu inputs\n", count);
  return count > 0 ? 0 : 1;
}
