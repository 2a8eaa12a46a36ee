#pragma once

#include <string>

#include "app/outcome.h"

namespace vesk {

/// Plays the recording at `path` ("-" is standard input) through the whole program and prints what the stores hold at
/// its end, as one JSON object on one line:
///   {"dictionaries":{"myLTERRCStateDict":{…},…},"LTE":{…},"UMTS":{…},"GSM":{…},"Common":{…}}
/// A record whose metric never came is null.
[[nodiscard]] Outcome runStores(const std::string& path);

}  // namespace vesk
