#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace vesk {

/// The files that ship with the application.
class Bundle {
 public:
  /// The installed one, ../share/vesk from the executable, and behind it the source tree's, for a program
  /// that runs from its build folder. Another one once setMain was called.
  static const Bundle& main();
  static void setMain(Bundle bundle);

  /// Looks in `directories`, in their order.
  explicit Bundle(std::vector<std::filesystem::path> directories) : directories_(std::move(directories)) {}

  /// The path of the file NAME.TYPE, if there is one.
  [[nodiscard]] std::optional<std::string> pathForResource(std::string_view name, std::string_view type) const;

 private:
  std::vector<std::filesystem::path> directories_;
};

}  // namespace vesk
