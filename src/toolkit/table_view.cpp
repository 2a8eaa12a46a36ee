#include "toolkit/table_view.h"

#include <algorithm>
#include <utility>

namespace vesk {

void TableView::reloadData() {
  letGoOfCells();
  const std::size_t count = source_.numberOfSections();
  std::vector<Section> sections;
  sections.reserve(count);
  for (std::size_t section = 0; section < count; ++section) {
    std::optional<Text> header = source_.headerTitle(section);
    sections.push_back({std::move(header), source_.numberOfRows(section)});
  }
  sections_ = std::move(sections);
  ++reloadCount_;
  if (reloadObserver_) reloadObserver_();
}

void TableView::letGoOfCells() {
  for (auto& [at, cell] : std::exchange(inView_, {}))
    recycle(std::move(cell));
}

std::unique_ptr<TableViewCell> TableView::dequeueReusableCell(std::string_view identifier) {
  const auto waiting = std::find_if(pool_.rbegin(), pool_.rend(),
                                    [&](const auto& cell) { return cell->reuseIdentifier() == identifier; });
  if (waiting != pool_.rend()) {
    std::swap(*waiting, pool_.back());
    std::unique_ptr<TableViewCell> cell = std::move(pool_.back());
    pool_.pop_back();
    return cell;
  }
  const CellDeclaration look = declarationOf(identifier);
  return std::make_unique<TableViewCell>(Text::copy(identifier), look.style, look.accessory);
}

std::size_t TableView::numberOfRows(std::size_t section) const {
  return section < sections_.size() ? sections_[section].rows : 0;
}

std::optional<Text> TableView::headerTitle(std::size_t section) const {
  return section < sections_.size() ? sections_[section].header : std::nullopt;
}

TableViewCell* TableView::cellForRow(IndexPath at) {
  if (at.row >= numberOfRows(at.section)) return nullptr;
  if (const auto shown = inView_.find(at); shown != inView_.end()) return shown->second.get();
  std::unique_ptr<TableViewCell> cell = source_.cellForRow(at);
  return inView_.insert_or_assign(at, std::move(cell)).first->second.get();
}

void TableView::keepInView(IndexPath first, IndexPath last) {
  for (auto each = inView_.begin(); each != inView_.end();) {
    if (first <= each->first && each->first <= last) {
      ++each;
    } else {
      recycle(std::move(each->second));
      each = inView_.erase(each);
    }
  }
}

void TableView::recycle(std::unique_ptr<TableViewCell> cell) {
  if (cell == nullptr) return;
  cell->prepareForReuse();
  pool_.push_back(std::move(cell));
}

CellDeclaration TableView::declarationOf(std::string_view identifier) const {
  const auto declared = std::find_if(declarations_.begin(), declarations_.end(),
                                     [&](const CellDeclaration& each) { return each.identifier == identifier; });
  return declared != declarations_.end() ? *declared : CellDeclaration{.identifier = identifier};
}

}  // namespace vesk
