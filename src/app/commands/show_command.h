#pragma once

#include <string>

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

struct ShowOptions {
  std::string area;
  std::string category;
  /// Without a recording the screen is as it is before any event.
  RecordingInput input;
  bool asJson = false;
};

/// Plays the recording through the whole program, opens the category's screen and prints what it shows: as text, or as
///   {"area":"LTE","category":"Tx Power","sections":[{"header":"TxPowerInfo 0","rows":[{"key":…,"value":…}]}]}
/// with null for what is absent. Labels that the menu does not have show what such a screen shows, and the user is told
/// which ones there are.
[[nodiscard]] Outcome runShow(const ShowOptions& options);

}  // namespace vesk
