#include "terminal/view/text_search.h"

#include <algorithm>

namespace vesk {

bool containsIgnoringCase(std::string_view whole, std::string_view part) {
  const auto lowered = [](char letter) {
    return 'A' <= letter && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
  };
  return std::search(whole.begin(), whole.end(), part.begin(), part.end(),
                     [&](char one, char other) { return lowered(one) == lowered(other); }) != whole.end();
}

}  // namespace vesk
