#pragma once

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

/// Plays the recording through the whole program and prints what the stores hold at
/// its end, as one JSON object on one line:
///   {"dictionaries":{"myLTERRCStateDict":{…},…},"LTE":{…},"UMTS":{…},"GSM":{…},"Common":{…}}
/// A record whose metric never came is null.
[[nodiscard]] Outcome runStores(const RecordingInput& input);

}  // namespace vesk
