#include "insight/series.h"

#include "insight/text_forms.h"

namespace vesk::insight {

namespace {

void appendPart(std::string& out, const std::optional<std::int64_t>& part) {
  out += ',';
  if (part) out += std::to_string(*part);
}

}  // namespace

std::string seriesHeader() {
  std::string out = "timestamp,technology,channel,code";
  for (const KpiDescription& each : kKpis)
    out.append(1, ',').append(each.name);
  return out;
}

void appendSeriesRow(std::string& out, const Insight& insight) {
  const Mobility& mobility = insight.timeline().mobility();
  out += std::to_string(insight.now().value_or(0));
  out += ',';
  if (mobility.technology()) out += nameOf(*mobility.technology());
  const CellIdentity cell = mobility.cell() ? mobility.cell()->identity : CellIdentity{};
  appendPart(out, cell.channel);
  appendPart(out, cell.code);
  for (const KpiDescription& each : kKpis) {
    out += ',';
    if (const auto value = insight.value(each.kpi)) appendNumber(out, *value);
  }
}

void appendSeriesLine(std::string& out, const Insight& insight) {
  const Mobility& mobility = insight.timeline().mobility();
  out += timeOfDay(insight.now().value_or(0));
  if (mobility.technology()) out.append("  ").append(nameOf(*mobility.technology()));
  if (mobility.cell()) out += " " + textOf(mobility.cell()->technology, mobility.cell()->identity);
  for (const KpiDescription& each : kKpis) {
    const auto value = insight.value(each.kpi);
    if (!value) continue;
    out.append("  ").append(each.name).append(1, ' ');
    appendNumber(out, *value);
  }
}

}  // namespace vesk::insight
