#include "terminal/panels/level_bar.h"

#include <cmath>

#include "terminal/panels/kpi_look.h"

namespace vesk {

void drawLevelBar(const Canvas& canvas, int column, int line, int width, insight::Kpi kpi, double value) {
  const int filled = static_cast<int>(std::lround(levelShare(kpi, value) * width));
  const Role role = roleOf(kpi, value);
  for (int index = 0; index < width; ++index)
    canvas.write(column + index, line, index < filled ? "█" : "░", index < filled ? role : Role::Faint);
}

}  // namespace vesk
