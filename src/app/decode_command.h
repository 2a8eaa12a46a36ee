#pragma once

#include <string>

#include "app/outcome.h"

namespace vesk {

/// Writes one JSON line for each event of the recording at `path` ("-" is standard input) to standard output:
///   {"at":12.5,"metric":"0x3C4E04","class":"KCellularLteRrcState","status":"decoded","fields":{…}}
/// An event is written before the next one is waited for. Lines that are no event are told to the user and passed over.
[[nodiscard]] Outcome runDecode(const std::string& path);

}  // namespace vesk
