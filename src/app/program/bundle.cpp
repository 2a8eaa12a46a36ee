#include "app/program/bundle.h"

#include <system_error>
#include <utility>

namespace vesk {

namespace fs = std::filesystem;

namespace {

Bundle& mainBundle() {
  static Bundle theBundle = [] {
    std::vector<fs::path> directories;
    std::error_code error;
    const fs::path executable = fs::read_symlink("/proc/self/exe", error);
    if (!error) directories.push_back(executable.parent_path().parent_path() / "share" / "vesk");
    directories.emplace_back(VESK_SOURCE_RESOURCES);
    return Bundle(std::move(directories));
  }();
  return theBundle;
}

}  // namespace

const Bundle& Bundle::main() {
  return mainBundle();
}

void Bundle::setMain(Bundle bundle) {
  mainBundle() = std::move(bundle);
}

std::optional<std::string> Bundle::pathForResource(std::string_view name, std::string_view type) const {
  std::string fileName(name);
  fileName += '.';
  fileName += type;
  for (const fs::path& directory : directories_) {
    fs::path path = directory / fileName;
    std::error_code error;
    if (fs::is_regular_file(path, error)) return std::move(path).string();
  }
  return std::nullopt;
}

}  // namespace vesk
