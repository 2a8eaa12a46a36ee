#pragma once

#include "insight/kpis.h"
#include "terminal/panels/canvas.h"

namespace vesk {

/// A bar `width` columns long, filled as far as the value reaches, in the colour of its grade.
void drawLevelBar(const Canvas& canvas, int column, int line, int width, insight::Kpi kpi, double value);

}  // namespace vesk
