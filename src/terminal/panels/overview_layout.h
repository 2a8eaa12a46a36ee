#pragma once

#include <vector>

#include "terminal/panels/canvas.h"

namespace vesk {

enum class PaneKind { serving, connection, trend, recent, cells, happenings };

struct Pane {
  PaneKind kind;
  /// With the frame around it, if there is one.
  Rectangle box;

  [[nodiscard]] Rectangle inside() const { return {box.column + 1, box.line + 1, box.columns - 2, box.lines - 2}; }
};

/// Which panes of the overview show in some space, and where. Boxes beside each other share the line between them.
struct OverviewLayout {
  std::vector<Pane> panes;
  /// Too small a space for frames holds the serving cell, and below it what happened.
  bool hasFrames = true;

  [[nodiscard]] static OverviewLayout of(Size size);
};

}  // namespace vesk
