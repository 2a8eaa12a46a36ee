#include "terminal/view/table_browser.h"

#include <algorithm>
#include <utility>

#include "values/ascii.h"

namespace vesk {

namespace {

bool contains(const std::optional<Text>& text, std::string_view part) {
  return text && containsIgnoringCase(text->view(), part);
}

}  // namespace

void TableBrowser::setViewport(Size size) {
  if (size == size_) return;
  if (size.columns != size_.columns) top_.line = 0;
  size_ = size;
  showSelection();
}

void TableBrowser::follow() {
  if (isFrozen_ || !content_.follow()) return;
  rebuild();
  // Other rows may pass the filter now.
  if (!filter_.empty() && !isSelectionInView()) showSelection();
}

void TableBrowser::setFrozen(bool isFrozen) {
  isFrozen_ = isFrozen;
  if (isFrozen) {
    content_.fetchAll();
  } else {
    follow();
  }
}

void TableBrowser::setFilter(std::string filter) {
  filter_ = std::move(filter);
  rebuild();
  showSelection();
}

void TableBrowser::rebuild() {
  const std::optional<Entry> top = top_.entry < entries_.size() ? std::optional(entries_[top_.entry]) : std::nullopt;
  entries_.clear();
  for (std::size_t section = 0; section < content_.sectionCount(); ++section) {
    const std::size_t start = entries_.size();
    if (content_.header(section)) entries_.push_back({{section, 0}, false});
    const std::size_t firstRow = entries_.size();
    const bool isWanted = filter_.empty() || contains(content_.header(section), filter_);
    for (std::size_t row = 0; row < content_.rowCount(section); ++row) {
      if (isWanted || passesFilter({section, row})) entries_.push_back({{section, row}, true});
    }
    if (!filter_.empty() && entries_.size() == firstRow) entries_.resize(start);
  }
  if (top) {
    const auto place = std::lower_bound(entries_.begin(), entries_.end(), *top);
    if (place == entries_.end() || *place != *top) top_.line = 0;
    top_.entry = static_cast<std::size_t>(place - entries_.begin());
  }
  const std::size_t selected = selectedEntry();
  if (selected < entries_.size()) {
    select(selected);
  } else {
    selection_.reset();
  }
  top_ = moved(top_, 0);
  clampTop();
}

bool TableBrowser::passesFilter(IndexPath at) {
  const RowContent& row = content_.row(at);
  return contains(row.main, filter_) || contains(row.detail, filter_);
}

int TableBrowser::height(std::size_t entry) {
  const Entry& each = entries_[entry];
  return each.isRow ? content_.height(each.at, size_.columns) : 1;
}

/// `lines` further down, or up when negative; stops at the ends. The end of the list is the entry after the
/// last.
TableBrowser::Position TableBrowser::moved(Position from, int lines) {
  from.line += lines;
  while (from.line < 0 && from.entry > 0)
    from.line += height(--from.entry);
  // Every entry has a line, so that the height of one whose first line it is need not be known.
  while (from.entry < entries_.size() && from.line > 0 && from.line >= height(from.entry))
    from.line -= height(from.entry++);
  if (from.line < 0 || from.entry == entries_.size()) from.line = 0;
  return from;
}

/// The entry of the selected row, or of the nearest one; the number of entries when there is no row.
std::size_t TableBrowser::selectedEntry() const {
  const Entry wanted{selection_.value_or(IndexPath{}), true};
  const auto place = std::lower_bound(entries_.begin(), entries_.end(), wanted);
  const auto index = static_cast<std::size_t>(place - entries_.begin());
  if (index < entries_.size() && entries_[index].isRow) return index;
  if (const std::optional<std::size_t> after = nextRow(index, +1)) return *after;
  return nextRow(index, -1).value_or(entries_.size());
}

std::optional<std::size_t> TableBrowser::nextRow(std::size_t entry, int step) const {
  while (true) {
    if (step < 0 ? entry == 0 : entry + 1 >= entries_.size()) return std::nullopt;
    entry = step < 0 ? entry - 1 : entry + 1;
    if (entries_[entry].isRow) return entry;
  }
}

void TableBrowser::select(std::size_t entry) {
  selection_ = entries_[entry].at;
}

/// No empty lines at the end of a list that fills the viewport. Looks at rows beyond the end only when the
/// end shows.
void TableBrowser::clampTop() {
  if (moved(top_, size_.lines).entry < entries_.size()) return;
  top_ = std::min(top_, moved({entries_.size(), 0}, -size_.lines));
}

void TableBrowser::showSelection() {
  const std::size_t selected = selectedEntry();
  if (selected < entries_.size()) {
    Position start{selected, 0};
    const Position fit = moved({selected, height(selected)}, -size_.lines);
    if (selected > 0 && !entries_[selected - 1].isRow && size_.lines > 1) start.entry = selected - 1;
    if (start < top_) {
      top_ = start;
    } else if (top_ < fit) {
      top_ = std::min(fit, Position{selected, 0});
    }
  }
  clampTop();
}

/// Whether some of the selected row is.
bool TableBrowser::isSelectionInView() {
  const std::size_t selected = selectedEntry();
  return selected == entries_.size() ||
         (top_ < moved({selected, height(selected)}, 0) && Position{selected, 0} < moved(top_, size_.lines));
}

/// After scrolling: when nothing of the selected row shows, the row nearest to it of those that show.
void TableBrowser::keepSelectionInView() {
  const std::size_t selected = selectedEntry();
  if (selected == entries_.size()) return;
  const Position end = moved(top_, size_.lines);
  if (moved({selected, height(selected)}, 0) <= top_) {
    const std::optional<std::size_t> first = entries_[top_.entry].isRow ? top_.entry : nextRow(top_.entry, +1);
    if (first && Position{*first, 0} < end) select(*first);
  } else if (Position{selected, 0} >= end) {
    const std::optional<std::size_t> last = nextRow(end.line > 0 ? end.entry + 1 : end.entry, -1);
    if (last && *last >= top_.entry) select(*last);
  }
}

void TableBrowser::moveSelection(int step) {
  const std::size_t selected = selectedEntry();
  if (selected == entries_.size()) return;
  const bool showsStart = top_ <= Position{selected, 0};
  const bool showsEnd = moved({selected, height(selected)}, 0) <= moved(top_, size_.lines);
  if (step > 0 ? !showsEnd : !showsStart) {
    top_ = moved(top_, step);
    return clampTop();
  }
  if (const std::optional<std::size_t> next = nextRow(selected, step)) select(*next);
  showSelection();
}

void TableBrowser::selectFirst() {
  selection_ = IndexPath{};
  top_ = {};
  if (const std::size_t first = selectedEntry(); first < entries_.size()) {
    select(first);
  } else {
    selection_.reset();
  }
  showSelection();
}

void TableBrowser::selectLast() {
  if (const std::optional<std::size_t> last = nextRow(entries_.size(), -1)) select(*last);
  top_ = {entries_.size(), 0};
  clampTop();
}

void TableBrowser::selectNextSection() {
  const std::size_t section = selection_ ? selection_->section : 0;
  const auto next = std::find_if(entries_.begin(), entries_.end(),
                                 [&](const Entry& each) { return each.isRow && each.at.section > section; });
  if (next == entries_.end()) return selectFirst();
  select(static_cast<std::size_t>(next - entries_.begin()));
  showSelection();
}

void TableBrowser::scroll(int lines) {
  top_ = moved(top_, lines);
  clampTop();
  keepSelectionInView();
}

void TableBrowser::scrollTo(int line, int height) {
  const ScrollExtent extent = scrollExtent();
  const int hidden = extent.total - extent.shown;
  if (hidden <= 0) return;
  const int thumb = extent.thumb(height);
  const int travel = height - thumb;
  const int start = std::clamp(line - thumb / 2, 0, travel);
  // At the ends all of the list counts, since heights may be estimates.
  constexpr int kAll = 1 << 30;
  const int between = travel > 0 ? start * hidden / travel - extent.before : 0;
  scroll(start == 0 ? -kAll : (start == travel ? kAll : between));
}

void TableBrowser::page(int direction) {
  const Position before = top_;
  scroll(direction * std::max(size_.lines - 1, 1));
  if (top_ != before) return;
  if (direction > 0) {
    selectLast();
  } else {
    selectFirst();
  }
}

std::optional<Text> TableBrowser::selectedName() {
  return selection_ ? content_.row(*selection_).main : std::nullopt;
}

bool TableBrowser::selectLine(int line) {
  const Position hit = moved(top_, line);
  if (hit.entry >= entries_.size() || !entries_[hit.entry].isRow) return false;
  select(hit.entry);
  return true;
}

std::vector<ListLine> TableBrowser::lines(bool withReadings) {
  withReadings = withReadings && content_.hasReadings();
  std::optional<int> valueEnd;
  if (withReadings) {
    valueEnd = valueEndBesideReadings(size_.columns);
  } else if (size_.columns > kWidestPair) {
    valueEnd = rowTextEnd(kWidestPair, false);
  }
  std::vector<ListLine> lines;
  std::size_t entry = top_.entry;
  for (int skipped = top_.line; entry < entries_.size(); ++entry, skipped = 0) {
    const auto room = static_cast<std::size_t>(std::max(size_.lines, 0)) - lines.size();
    if (room == 0) break;
    const auto [at, isRow] = entries_[entry];
    if (!isRow) {
      lines.push_back({.isHeader = true, .text = {.name = content_.header(at.section)->view()}});
      continue;
    }
    const RowContent& row = content_.row(at);
    const std::vector<RowLine> rowLines = layOutRow(row, size_.columns, valueEnd);
    const std::size_t end = std::min(rowLines.size(), static_cast<std::size_t>(skipped) + room);
    for (auto index = static_cast<std::size_t>(skipped); index < end; ++index) {
      lines.push_back({.text = withReadings ? rowLines[index] : rowLines[index].withoutReading(),
                       .isFirstOfRow = index == 0,
                       .isSelected = selection_ == at,
                       .isChanged = row.isChanged,
                       .hasDisclosure = row.accessory == CellAccessory::Disclosure});
    }
  }
  if (entry > top_.entry) {
    const IndexPath first = entries_[top_.entry].at;
    const IndexPath last = entries_[entry - 1].at;
    screen_.tableView().keepInView(first, last);
    // What shows is of one moment.
    if (!isFrozen_ && !content_.keepInView(first, last)) return this->lines();
  }
  return lines;
}

ScrollExtent TableBrowser::scrollExtent() const {
  ScrollExtent extent{.before = top_.line, .shown = size_.lines};
  for (std::size_t entry = 0; entry < entries_.size(); ++entry) {
    const int height = entries_[entry].isRow ? content_.likelyHeight(entries_[entry].at) : 1;
    if (entry < top_.entry) extent.before += height;
    extent.total += height;
  }
  return extent;
}

}  // namespace vesk
