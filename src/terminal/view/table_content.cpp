#include "terminal/view/table_content.h"

#include <algorithm>
#include <utility>

namespace vesk {

bool TableContent::follow() {
  if (reloadCount_ == table_.reloadCount()) return false;
  std::vector<Section> sections(table_.numberOfSections());
  for (std::size_t section = 0; section < sections.size(); ++section) {
    sections[section].header = table_.headerTitle(section);
    std::vector<Row>& rows = sections[section].rows;
    const std::size_t count = table_.numberOfRows(section);
    rows.reserve(count);
    for (std::size_t row = 0; row < count; ++row)
      rows.push_back({std::nullopt, table_.estimatedRowHeight({section, row}).lines().value_or(1)});
  }
  std::swap(sections_, sections);
  if (reloadCount_ > 0) previous_ = std::move(sections);
  reloadCount_ = table_.reloadCount();
  return true;
}

void TableContent::fetchAll() {
  for (std::size_t section = 0; section < sections_.size(); ++section) {
    for (std::size_t row = 0; row < sections_[section].rows.size(); ++row)
      this->row({section, row});
  }
}

const RowContent& TableContent::row(IndexPath at) {
  Row& kept = rowAt(at);
  if (!kept.content || kept.isOutdated) {
    kept.content = fetch(at);
    kept.columnsOfHeight = 0;
    kept.askedAt = times_;
    kept.isOutdated = false;
  }
  return *kept.content;
}

bool TableContent::keepInView(IndexPath first, IndexPath last) {
  std::optional<std::uint64_t> askedAt;
  bool isOfOneTime = true;
  for (std::size_t section = 0; section < sections_.size(); ++section) {
    for (std::size_t row = 0; row < sections_[section].rows.size(); ++row) {
      const IndexPath at{section, row};
      Row& kept = rowAt(at);
      if (at < first || last < at) kept.isOutdated = true;
      if (kept.isOutdated || !kept.content) continue;
      if (askedAt && *askedAt != kept.askedAt) isOfOneTime = false;
      askedAt = kept.askedAt;
    }
  }
  ++times_;
  if (isOfOneTime) return true;
  for (Section& section : sections_) {
    for (Row& row : section.rows)
      row.isOutdated = true;
  }
  table_.letGoOfCells();
  return false;
}

int TableContent::height(IndexPath at, int columns) {
  Row& kept = rowAt(at);
  if (kept.columnsOfHeight != columns) {
    kept.height = static_cast<int>(layOutRow(row(at), columns).size());
    kept.columnsOfHeight = columns;
  }
  return kept.height;
}

RowContent TableContent::fetch(IndexPath at) {
  RowContent content;
  const TableViewCell* cell = table_.cellForRow(at);
  if (cell != nullptr) {
    content.main = cell->mainText();
    if (cell->style() == CellStyle::RightDetail) content.detail = cell->detailText();
    content.accessory = cell->accessory();
    content.height = table_.rowHeight(at);
  }
  if (readingOf_ && content.main) content.reading = readingOf_(at, content.main->view());
  content.isChanged = hasChanged(at, content);
  return content;
}

/// A row is known again by its name. One that was not there counts as changed, one that was there but never
/// looked at does not, and neither does a timestamp: it always changes.
bool TableContent::hasChanged(IndexPath at, const RowContent& content) const {
  if (!previous_ || content.main == std::optional("timestamp"_text)) return false;
  if (at.section >= previous_->size()) return true;
  const std::vector<Row>& rows = (*previous_)[at.section].rows;
  const auto hasItsName = [&](const Row& each) { return each.content && each.content->main == content.main; };
  if (at.row < rows.size() && hasItsName(rows[at.row])) return rows[at.row].content->detail != content.detail;
  if (const auto same = std::find_if(rows.begin(), rows.end(), hasItsName); same != rows.end()) {
    return same->content->detail != content.detail;
  }
  return std::all_of(rows.begin(), rows.end(), [](const Row& each) { return each.content.has_value(); });
}

}  // namespace vesk
