#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "insight/insight.h"
#include "toolkit/interface_layout.h"
#include "web/drive_record.h"
#include "web/screen_json.h"

namespace vesk::web {

/// A drive for people: what is needed to write a page of it.
struct Report {
  /// What the page is called, such as the name of the recording.
  std::string title;
  const DriveRecord& record;
  const insight::Insight& insight;
  const InterfaceLayout& layout;
  RowReadings readings;
};

/// Writes one HTML page that holds all it shows and asks for nothing: `write` is called with one piece after the other.
void writeReport(const Report& report, const std::function<void(std::string_view piece)>& write);

}  // namespace vesk::web
