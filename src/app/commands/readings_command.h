#pragma once

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

/// Plays the recording through the whole program and prints what the values on its screens mean at its end, and which
/// cells are heard then: as text, or as
///   {"screens":[{"area":"LTE","category":"RRC State","sections":[[{"key":"state","reading":{"text":…}},…]]},…],
///    "heard":[…]}
/// with null for a row without a reading, and no sections for a screen that has nothing to show yet.
[[nodiscard]] Outcome runReadings(const RecordingInput& input, bool asJson);

}  // namespace vesk
