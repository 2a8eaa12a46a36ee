#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "insight/kpis.h"
#include "terminal/device/grid.h"

/// How the values of KPIs look.
namespace vesk {

/// "RSRP", "Ec/N0".
[[nodiscard]] std::string_view labelOf(insight::Kpi kpi);

/// "-96 dBm".
[[nodiscard]] std::string valueText(insight::Kpi kpi, double value);

/// The grade's, or Role::Value for what has no grade.
[[nodiscard]] Role roleOf(insight::Kpi kpi, double value);

/// "fair", "high", "at or below, poor"; empty where nothing is to be said.
[[nodiscard]] std::string gradeText(insight::Kpi kpi, double value);

/// How far along a level bar a value reaches: 0 to 1.
[[nodiscard]] double levelShare(insight::Kpi kpi, double value);

/// The KPI in a row of a table screen; absent for any other row.
[[nodiscard]] std::optional<insight::Kpi> kpiOfRow(std::string_view area, std::string_view category,
                                                   std::string_view key);

}  // namespace vesk
