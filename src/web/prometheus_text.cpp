#include "web/prometheus_text.h"

#include <algorithm>
#include <array>
#include <utility>
#include <vector>

#include "insight/text_forms.h"

namespace vesk::web {

namespace {

using Labels = std::vector<std::pair<std::string_view, std::string>>;

/// Writes metrics one family after the other.
class PrometheusWriter {
 public:
  void family(std::string_view name, std::string_view type, std::string_view help) {
    name_ = name;
    out_.append("# HELP ").append(name).append(" ").append(help).append("\n");
    out_.append("# TYPE ").append(name).append(" ").append(type).append("\n");
  }
  void sample(const Labels& labels, double value) {
    out_ += name_;
    char separator = '{';
    for (const auto& [name, text] : labels) {
      out_.append(1, std::exchange(separator, ',')).append(name).append("=\"");
      appendEscaped(text);
      out_ += '"';
    }
    out_ += separator == '{' ? " " : "} ";
    insight::appendNumber(out_, value);
    out_ += '\n';
  }
  void sample(const Labels& labels, std::uint64_t value) { sample(labels, static_cast<double>(value)); }

  std::string take() { return std::move(out_); }

 private:
  void appendEscaped(std::string_view text) {
    for (const char c : text) {
      if (c == '\\' || c == '"') out_ += '\\';
      if (c == '\n') {
        out_ += "\\n";
      } else {
        out_ += c;
      }
    }
  }

  std::string out_;
  std::string_view name_;
};

/// "vesk_lte_rsrp_dbm".
std::string metricNameOf(const insight::KpiDescription& kpi) {
  std::string name = "vesk_" + std::string(kpi.name);
  std::replace(name.begin(), name.end(), '.', '_');
  if (kpi.quantity->unit == "dBm") name += "_dbm";
  if (kpi.quantity->unit == "dB") name += "_db";
  return name;
}

Labels cellLabels(const std::optional<insight::ServingCell>& cell) {
  if (!cell) return {};
  const auto part = [](const std::optional<std::int64_t>& number) { return number ? std::to_string(*number) : ""; };
  return {{"technology", std::string(nameOf(cell->technology))},
          {"channel", part(cell->identity.channel)},
          {"code", part(cell->identity.code)},
          {"cell_id", part(cell->identity.cellId)}};
}

void writeNow(PrometheusWriter& out, const insight::Insight& insight) {
  out.family("vesk_cells_heard", "gauge", "How many cells were heard in the last half minute.");
  out.sample({}, static_cast<std::uint64_t>(insight.cellsHeard().size()));
  out.family("vesk_no_service", "gauge", "1 while there is no service.");
  out.sample({}, insight.timeline().registrations().noServiceSince() ? 1.0 : 0.0);
  const auto& cell = insight.timeline().mobility().cell();
  for (const insight::KpiDescription& each : insight::kKpis) {
    const auto value = insight.value(each.kpi);
    if (!value) continue;
    const std::string name = metricNameOf(each);
    out.family(name, "gauge", "The last " + std::string(each.name) + ", while it is known.");
    out.sample(cellLabels(cell), *value);
  }
  out.family("vesk_serving_cell_info", "gauge", "1 for the cell that serves.");
  if (cell) out.sample(cellLabels(cell), 1.0);
}

void writeEventCounters(PrometheusWriter& out, const insight::Insight& insight) {
  const insight::EventCounts& counts = insight.counts();
  out.family("vesk_metric_events_total", "counter", "Metric events, by what became of them.");
  out.sample({{"fate", "stored"}}, counts.stored);
  out.sample({{"fate", "undecodable"}}, counts.undecodable);
  out.sample({{"fate", "ignored"}}, counts.ignored);
  out.family("vesk_timeline_events_total", "counter", "What happened, by its kind.");
  for (std::size_t kind = 0; kind < insight::kEventKindCount; ++kind) {
    const auto each = static_cast<insight::EventKind>(kind);
    out.sample({{"kind", std::string(nameOf(each))}}, insight.summary().count(each));
  }
  out.family("vesk_counted_seconds_total", "counter", "Time of the drive, without its gaps, by technology.");
  for (const insight::Technology each : insight::kTechnologies)
    out.sample({{"technology", std::string(nameOf(each))}}, static_cast<double>(insight.summary().time(each)) / 1000);
}

/// One counter of connections by technology, and one by cause too. The first is there from the start, so that its first
/// step is seen.
void writeCauses(PrometheusWriter& out, const insight::Insight& insight, const std::string& name, std::string_view help,
                 insight::CauseCounts insight::ConnectionCounts::*causes) {
  const insight::Connections& connections = insight.timeline().connections();
  const std::string total = name + "_total";
  out.family(total, "counter", help);
  for (const insight::Technology technology : insight::kTechnologies)
    out.sample({{"technology", std::string(nameOf(technology))}}, (connections.counts(technology).*causes).total());
  const std::string byCause = name + "_by_cause_total";
  out.family(byCause, "counter", help);
  for (const insight::Technology technology : insight::kTechnologies)
    for (const auto& [cause, count] : (connections.counts(technology).*causes).byCause())
      out.sample({{"technology", std::string(nameOf(technology))}, {"cause", cause}}, count);
}

void writeConnections(PrometheusWriter& out, const insight::Insight& insight) {
  using insight::ConnectionCounts;
  constexpr std::array<std::pair<std::string_view, std::uint64_t ConnectionCounts::*>, 3> kCounts{{
      {"vesk_connections_attempted_total", &ConnectionCounts::attempted},
      {"vesk_connections_established_total", &ConnectionCounts::established},
      {"vesk_reestablished_total", &ConnectionCounts::reestablished},
  }};
  for (const auto& [name, count] : kCounts) {
    out.family(name, "counter", "Connections, by technology.");
    for (const insight::Technology each : insight::kTechnologies)
      out.sample({{"technology", std::string(nameOf(each))}}, insight.timeline().connections().counts(each).*count);
  }
  writeCauses(out, insight, "vesk_connections_dropped", "Connections that were lost.", &ConnectionCounts::dropped);
  writeCauses(out, insight, "vesk_connections_failed", "Connections that did not come about.",
              &ConnectionCounts::failed);
  writeCauses(out, insight, "vesk_reestablishments", "Re-establishments attempted.",
              &ConnectionCounts::reestablishments);
}

}  // namespace

std::string prometheusText(const insight::Insight& insight, const std::optional<std::chrono::milliseconds>& quiet,
                           std::size_t visitors) {
  PrometheusWriter out;
  if (quiet) {
    out.family("vesk_quiet_seconds", "gauge", "How long ago the last metric event came.");
    out.sample({}, static_cast<double>(quiet->count()) / 1000);
    if (*quiet <= kLongestQuiet) writeNow(out, insight);
  }
  writeEventCounters(out, insight);
  writeConnections(out, insight);
  out.family("vesk_visitors", "gauge", "Who is connected to the page.");
  out.sample({}, static_cast<std::uint64_t>(visitors));
  return out.take();
}

}  // namespace vesk::web
