#pragma once

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

/// Writes one JSON line for each event of the recording to standard output:
///   {"at":12.5,"metric":"0x3C4E04","class":"KCellularLteRrcState","status":"decoded","fields":{…}}
/// An event is written before the next one is waited for. Lines that are no event are told to the user and passed over.
[[nodiscard]] Outcome runDecode(const RecordingInput& input);

}  // namespace vesk
