// completion TEMPLATE OUTPUT: writes the completion for bash: the template, with the menu in place of @menu@, a line
// for each category: its area, a tab, and its label.

#include <cstdlib>
#include <fstream>
#include <iostream>
#include <iterator>
#include <string>

#include "screens/category_sources.h"

namespace {

std::string menuLines() {
  std::string lines;
  for (const vesk::CategorySource& source : vesk::categorySources()) {
    if (!lines.empty()) lines += '\n';
    lines += source.area;
    lines += '\t';
    lines += source.category;
  }
  return lines;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 3) {
    std::cerr << "usage: completion TEMPLATE OUTPUT\n";
    return 2;
  }
  std::ifstream input(argv[1]);
  std::string text{std::istreambuf_iterator<char>(input), {}};
  constexpr std::string_view kPlace = "@menu@";
  const std::size_t place = text.find(kPlace);
  if (place == std::string::npos) {
    std::cerr << "completion: " << argv[1] << " cannot be read, or has no " << kPlace << '\n';
    return EXIT_FAILURE;
  }
  text.replace(place, kPlace.size(), menuLines());
  std::ofstream output(argv[2]);
  output << text << std::flush;
  if (!output) {
    std::cerr << "completion: cannot write " << argv[2] << '\n';
    return EXIT_FAILURE;
  }
}
