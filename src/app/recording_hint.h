#pragma once

#include <string>

namespace vesk {

/// Tells the user, once the end is reached, that the file at `path` ("-" is standard input) is no recording: it had
/// lines, and none was an event.
void tellIsNoRecording(const std::string& path);

}  // namespace vesk
