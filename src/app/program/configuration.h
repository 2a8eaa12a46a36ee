#pragma once

#include <optional>
#include <string>
#include <vector>

#include "insight/rules.h"
#include "terminal/device/appearance.h"
#include "terminal/input/key_bindings.h"

namespace vesk {

/// What shows first.
struct StartView {
  /// The key of a view over the tables; absent for none.
  std::optional<Action> action{};
  /// A screen of the menu: nothing for the first one, an area, or an area and a category.
  std::string area{};
  std::string category{};
};

/// What a user wants of the screens in every run.
struct Configuration {
  Appearance appearance;
  StartView start;
  std::vector<insight::Rule> rules;
};

/// config.toml in the folder vesk of XDG_CONFIG_HOME, or of ~/.config; empty where neither is known.
[[nodiscard]] std::string configurationPath();

/// Without the file all is as usual. Absent when something in it is none: the user is told of each mistake with its
/// place and what was expected.
[[nodiscard]] std::optional<Configuration> readConfiguration(const std::string& path);

}  // namespace vesk
