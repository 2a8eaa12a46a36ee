#pragma once

#include <string>

#include "insight/insight.h"
#include "web/drive_record.h"

namespace vesk::web {

/// Appends what the page knows of a drive as one JSON object:
///   {"kpis":[{"name","unit","steps":[excellent,good,fair]|null,"high":dBm|null},…],
///    "stretches":[position,time,…],"time_error":ms,"series":{name:[position,value,…],…},"cells":[text,…],"serving":[position,cell,…],
///    "marks":{"change":[position,…],"reestablished":[…],"drop":[…],"technology":[…]},
///    "events":[[position,time,kind,text],…],"now":{…}}
/// Positions are milliseconds of counted time; a serving cell is a place in "cells", or -1 for none. The time of a
/// position, as the stretches tell it, may be off by "time_error". "now" is what
/// `insight` knows at its last event.
void appendDriveJson(std::string& out, const DriveRecord& record, const insight::Insight& insight);

/// Appends the same of what came since the record was cleared last, to be added to the drive as it was told until then:
/// without "kpis", and of "cells" the new ones alone, whose places follow those of the known.
void appendNewsJson(std::string& out, const DriveRecord& record, const insight::Insight& insight);

}  // namespace vesk::web
