#pragma once

#include <functional>
#include <optional>
#include <string_view>

#include "insight/reading.h"
#include "toolkit/interface_layout.h"
#include "toolkit/walk.h"
#include "values/json_form.h"

namespace vesk::web {

/// What the value in that row of a category's screen means; absent where nothing is to be said.
using RowReadings = std::function<std::optional<insight::Reading>(std::string_view area, std::string_view category,
                                                                  std::size_t section, std::size_t row)>;

/// A walk through the screens: a stack of its own. Main queue only.
class ScreenWalk {
 public:
  /// `layout` must outlive the walk.
  explicit ScreenWalk(const InterfaceLayout& layout);
  ScreenWalk(const ScreenWalk&) = delete;
  ScreenWalk& operator=(const ScreenWalk&) = delete;
  /// The screens' timers stop.
  ~ScreenWalk();

  /// Opens a category's screen from wherever the walk stands. False when the menu has no such labels.
  bool open(std::string_view area, std::string_view category);
  /// {"area":…,"category":…,"sections":[{"header":…,"rows":[{"key":…,"value":…,"reading":…|null},…]},…]}
  void writeJson(JsonWriter& json, const RowReadings& readings) const;

 private:
  NavigationController stack_;
};

/// Writes a JSON array of all screens that the menu leads to, in its order; each as ScreenWalk writes it.
void writeScreensJson(JsonWriter& json, const InterfaceLayout& layout, const RowReadings& readings);

/// Writes [{"area":…,"categories":[…]},…].
void writeMenuJson(JsonWriter& json, const InterfaceLayout& layout);

}  // namespace vesk::web
