#pragma once

#include <string>
#include <vector>

namespace vesk {

/// "one, two, three".
[[nodiscard]] inline std::string listOf(const std::vector<std::string>& words) {
  std::string list;
  for (const std::string& word : words)
    list.append(list.empty() ? "" : ", ").append(word);
  return list;
}

}  // namespace vesk
