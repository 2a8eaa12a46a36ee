#include "app/source/recording_input.h"

namespace vesk {

std::string remarkOnNoRecording(const std::string& path) {
  return (path == "-" ? "standard input" : path) + " is no recording: no line of it is an event, as this one is: " +
         R"({"at": 12.5, "metric": "0x3C4E04", "payload": "1003"})";
}

}  // namespace vesk
