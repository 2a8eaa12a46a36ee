// Runs a fuzz target over the inputs named, over those in the directories named, and over so many damaged forms of
// each: what libFuzzer found once, and what lies around it, must pass under every compiler ever after.
//
//     fuzz_TARGET DAMAGED PATH…

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
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

using Input = std::vector<std::uint8_t>;

/// Damages inputs in the ways in which they are damaged on the wire, and in some in which they are not. The same in
/// every run.
class Damage {
 public:
  Input appliedTo(Input input) {
    for (std::size_t times = 1 + below(3); times > 0; --times) {
      const auto place = input.begin() + static_cast<std::ptrdiff_t>(below(input.size() + 1));
      const std::size_t way = place == input.end() ? 0 : below(3);
      if (way == 0) input.insert(place, 1 + below(11), byte());
      if (way == 1) *place = byte();
      if (way == 2) input.erase(place, std::min(place + 1 + static_cast<std::ptrdiff_t>(below(4)), input.end()));
    }
    return input;
  }

 private:
  std::size_t below(std::size_t end) { return random_() % end; }
  /// Now and then one that means something on the wire: the keys of groups, a long number, a wire type that there is
  /// not.
  std::uint8_t byte() {
    constexpr std::uint8_t kTelling[] = {0x00, 0x0B, 0x0C, 0x7F, 0x80, 0x9A, 0xFF, 0x0E};
    return static_cast<std::uint8_t>(below(2) == 0 ? kTelling[below(std::size(kTelling))] : below(256));
  }

  std::mt19937 random_{20261125};
};

void replay(const fs::path& path, int damaged) {
  std::ifstream file(path, std::ios::binary);
  const Input content{std::istreambuf_iterator<char>(file), {}};
  if (!file) {
    std::fprintf(stderr, "%s: cannot be read\n", path.c_str());
    std::exit(1);
  }
  // Stays as the last line when the target ends the program.
  std::fprintf(stderr, "%s\n", path.c_str());
  LLVMFuzzerTestOneInput(content.data(), content.size());
  for (Damage damage; damaged > 0; --damaged) {
    const Input input = damage.appliedTo(content);
    LLVMFuzzerTestOneInput(input.data(), input.size());
  }
}

}  // namespace

int main(int argc, char** argv) {
  std::size_t count = 0;
  for (int index = 2; index < argc; ++index) {
    for (const fs::path& input : inputsOf(argv[index])) {
      replay(input, std::atoi(argv[1]));
      ++count;
    }
  }
  std::printf("%zu inputs\n", count);
  return count > 0 ? 0 : 1;
}
