#pragma once

#include "app/program/vesk_interface.h"
#include "intake/metric_validator.h"
#include "screens/first_level_view_controller.h"
#include "screens/second_level_view_controller.h"
#include "screens/vesk_view_controller.h"
#include "toolkit/interface_layout.h"

namespace vesk {

inline void shrink(Record& record) {
  if (!record.empty()) record.erase((record.end() - 1)->key);
}
inline void shrink(RecordList& list) {
  if (list.size() > 0) list.erase(list.size() - 1);
  if (list.size() > 0) shrink(list.mutableItems()[0]);
}
inline void shrink(Value& /*value*/) {}

/// Takes everything from the lists and records of the stores, one entry at a time.
inline void shrinkStores(Stores& stores) {
  visitTechnologyFields(stores, [](std::string_view, auto& field) { shrink(field); });
  visitLatestRecords(stores, [](std::string_view, LatestRecord& record) {
    if (record) shrink(*record);
    if (record && record->empty()) record.reset();
  });
}

/// Finds less in the stores each time that its table asks it for something.
class ShrinkingScreen : public SecondLevelViewController {
 public:
  inline static bool isShrinking = false;

  std::size_t numberOfSections() override { return shrunk().SecondLevelViewController::numberOfSections(); }
  std::optional<Text> headerTitle(std::size_t section) override {
    return shrunk().SecondLevelViewController::headerTitle(section);
  }
  std::size_t numberOfRows(std::size_t section) override {
    return shrunk().SecondLevelViewController::numberOfRows(section);
  }
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override {
    return shrunk().SecondLevelViewController::cellForRow(at);
  }
  RowHeight rowHeight(IndexPath at) override { return shrunk().SecondLevelViewController::rowHeight(at); }

 private:
  ShrinkingScreen& shrunk() {
    if (isShrinking) shrinkStores(MetricValidator::shared()->stores);
    return *this;
  }
};

/// The program's screens, of which the last may shrink.
inline InterfaceLayout shrinkingInterface() {
  const auto cells = veskInterface().cells();
  return InterfaceLayout({
      .rootStack = makeStackOf<NavigationController>,
      .firstScreen = "Launch",
      .screens = {{"Launch", makeScreenOf<VeskViewController>, "Vesk"},
                  {"FirstLevel", makeScreenOf<FirstLevelViewController>, {}},
                  {"SecondLevel", makeScreenOf<ShrinkingScreen>, {}}},
      .cells = {cells.begin(), cells.end()},
      .transitions = {{"Launch", "showCategories", "FirstLevel"}, {"FirstLevel", "showValues", "SecondLevel"}},
  });
}

}  // namespace vesk
