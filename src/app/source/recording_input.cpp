#include "app/source/recording_input.h"

#include "app/output/outcome.h"

namespace vesk {

void tellIsNoRecording(const std::string& path) {
  tellUser("vesk: " + (path == "-" ? std::string("standard input") : path) +
           " is no recording: no line of it is an event, as this one is:");
  tellUser(R"(  {"at": 12.5, "metric": "0x3C4E04", "payload": "1003"})");
}

}  // namespace vesk
