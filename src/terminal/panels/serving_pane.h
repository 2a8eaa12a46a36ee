#pragma once

#include <optional>
#include <span>

#include "insight/present.h"
#include "terminal/panels/canvas.h"

namespace vesk {

/// The KPIs that tell how a serving cell is received, in the order in which they are shown.
[[nodiscard]] std::span<const insight::Kpi> servingKpis(insight::Technology technology);

/// The line of the first of them.
inline constexpr int kFirstKpiLine = 2;

/// The serving cell and how it is received; `selected` is the KPI that bears the mark of the selection.
void drawServing(const Canvas& canvas, const insight::Present& drive, std::optional<insight::Kpi> selected);

}  // namespace vesk
