#pragma once

#include "app/vesk_interface.h"
#include "intake/metric_validator.h"
#include "screens/first_level_view_controller.h"
#include "screens/second_level_view_controller.h"
#include "screens/vesk_view_controller.h"
#include "toolkit/interface_layout.h"

namespace vesk {

/// Takes everything from the lists and records of the stores, one entry at a time.
inline void shrinkStores(MetricValidator& intake) {
  struct Shrink {
    // The visitor sees stores that never change; these do.
    void operator()(std::string_view, const RecordList& list) const {
      if (list.size() > 0) const_cast<RecordList&>(list).erase(list.size() - 1);
      if (list.size() > 0) operator()({}, list[0]);
    }
    void operator()(std::string_view, const Record& record) const {
      if (!record.empty()) const_cast<Record&>(record).erase((record.end() - 1)->key);
    }
    void operator()(std::string_view, const Value&) const {}
  };
  visitFields(intake.myLTE, Shrink{});
  visitFields(intake.myUMTS, Shrink{});
  visitFields(intake.myGSM, Shrink{});
  visitFields(intake.myCommon, Shrink{});
  for (const auto& [name, member] : kLatestRecords) {
    auto& record = intake.*member;
    if (record) Shrink{}({}, *record);
    if (record && record->empty()) record.reset();
  }
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
    if (isShrinking) shrinkStores(*MetricValidator::shared());
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
