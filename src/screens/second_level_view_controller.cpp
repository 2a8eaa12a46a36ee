#include "screens/second_level_view_controller.h"

#include <chrono>
#include <string>

#include "screens/common_look.h"
#include "screens/detail_text.h"
#include "system/main_queue.h"
#include "system/output_lines.h"
#include "system/run_loop.h"

namespace vesk {

namespace {

constexpr std::chrono::seconds kRefreshInterval{5};

std::string_view viewOf(const std::optional<Text>& text) {
  return text ? text->view() : std::string_view{};
}

}  // namespace

const CategorySource& SecondLevelViewController::source() const {
  return sourceOf(viewOf(firstSelection), viewOf(seguedThroughRow));
}

std::optional<Record> SecondLevelViewController::recordOf(std::size_t section) const {
  const CategorySource& from = source();
  switch (from.kind) {
    case SourceKind::metricRecord:
      return from.latestRecord(myMetricValidator->stores);
    case SourceKind::storeRecord:
      return from.storeRecord(myMetricValidator->stores);
    case SourceKind::storeList:
    case SourceKind::firstElement: {
      const RecordList list = from.list(myMetricValidator->stores);
      if (section < list.size()) return list[section];
      break;
    }
    case SourceKind::placeholder:
      break;
  }
  return std::nullopt;
}

void SecondLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  refreshTimer_.emplace(RunLoop::main(), kRefreshInterval, RunLoopMode::defaultMode, [this] { update(); });
  applyCommonLook(*this);
}

void SecondLevelViewController::didLeaveNavigationStack() {
  refreshTimer_.reset();
}

void SecondLevelViewController::update() {
  MainQueue::shared().post([screen = weak_from_this()] {
    if (const auto alive = screen.lock()) alive->tableView().reloadData();
  });
}

std::size_t SecondLevelViewController::numberOfSections() {
  const CategorySource& from = source();
  return from.kind == SourceKind::storeList ? from.list(myMetricValidator->stores).size() : 1;
}

std::optional<Text> SecondLevelViewController::headerTitle(std::size_t section) {
  const CategorySource& from = source();
  if (from.kind != SourceKind::storeList) return std::nullopt;
  return Text::copy(std::string(from.headerPrefix) + std::to_string(section));
}

std::size_t SecondLevelViewController::numberOfRows(std::size_t section) {
  const CategorySource& from = source();
  if (from.kind == SourceKind::placeholder) return 1;
  if (const std::optional<Record> record = recordOf(section)) return record->size();
  if (from.kind != SourceKind::metricRecord) return 0;
  if (from.metric == K_LTE_SCELL_INFO) OutputLines::print({"You are screwed"});
  return 1;
}

std::unique_ptr<TableViewCell> SecondLevelViewController::cellForRow(IndexPath at) {
  auto cell = tableView().dequeueReusableCell("SecondClickView");
  if (source().kind == SourceKind::placeholder) {
    cell->setMainText("Come back later"_text);
    cell->setDetailText("Come back later"_text);
    return cell;
  }
  const std::optional<Record> record = recordOf(at.section);
  if (record && at.row < record->size()) {
    const auto& [key, value] = record->begin()[at.row];
    cell->setMainText(key);
    cell->setDetailText(detailTextOf(value));
  }
  return cell;
}

}  // namespace vesk
