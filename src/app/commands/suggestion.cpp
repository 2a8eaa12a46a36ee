#include "app/commands/suggestion.h"

#include <algorithm>
#include <numeric>

#include "values/ascii.h"

namespace vesk {

namespace {

/// How many characters must be put in, taken out or replaced to make one text of the other.
std::size_t distance(std::string_view a, std::string_view b) {
  std::vector<std::size_t> row(b.size() + 1);
  std::iota(row.begin(), row.end(), std::size_t{0});
  for (std::size_t i = 0; i < a.size(); ++i) {
    std::size_t diagonal = row[0];
    row[0] = i + 1;
    for (std::size_t j = 0; j < b.size(); ++j) {
      const std::size_t replaced = diagonal + (lowerAscii(a[i]) == lowerAscii(b[j]) ? 0 : 1);
      diagonal = row[j + 1];
      row[j + 1] = std::min({replaced, row[j] + 1, diagonal + 1});
    }
  }
  return row.back();
}

}  // namespace

std::string suggestionFor(std::string_view typed, const std::vector<std::string>& candidates, std::string_view quotes) {
  // What is long enough to be no name at all is not worth the comparison, and a letter or two are in every name.
  constexpr std::size_t kLongest = 100;
  constexpr std::size_t kShortestPart = 3;
  if (typed.size() > kLongest) return {};
  // Beyond a third of what was typed it is another word.
  std::size_t least = typed.size() / 3 + 1;
  const std::string* nearest = nullptr;
  const std::string* holding = nullptr;
  for (const std::string& candidate : candidates) {
    if (holding == nullptr && typed.size() >= kShortestPart && containsIgnoringCase(candidate, typed))
      holding = &candidate;
    const std::size_t apart = distance(typed, candidate);
    if (apart >= least) continue;
    least = apart;
    nearest = &candidate;
  }
  if (holding != nullptr && least > 1) nearest = holding;
  if (nearest == nullptr) return {};
  std::string out = "; did you mean ";
  return out.append(quotes).append(*nearest).append(quotes);
}

}  // namespace vesk
