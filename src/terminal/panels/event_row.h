#pragma once

#include "insight/timeline_event.h"
#include "terminal/panels/canvas.h"

namespace vesk {

/// Draws an event over a line: time of day, kind and text.
void drawEventRow(const Canvas& canvas, int line, const insight::TimelineEvent& event, bool isSelected);

}  // namespace vesk
