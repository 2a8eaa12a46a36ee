#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "terminal/panels/list_window.h"
#include "terminal/panels/panel.h"

namespace vesk {

/// What happened, the newest first.
class TimelinePanel : public Panel {
 public:
  using GoToEvent = std::function<void(const insight::TimelineEvent&)>;

  /// `goToEvent` goes to the moment of an event; it may be empty.
  TimelinePanel(const ShownDrive& drive, GoToEvent goToEvent) : drive_(drive), goToEvent_(std::move(goToEvent)) {}

  /// Selects the event that happened as the drive's `number`th, counted from 0; absent for whichever is the newest.
  void select(std::optional<std::uint64_t> number) { selected_ = number; }

  [[nodiscard]] std::string_view title() const override { return "Timeline"; }
  [[nodiscard]] std::span<const Action> hints() const override;
  void draw(const Canvas& canvas) override;
  bool perform(Action action) override;
  void click(int column, int line) override;
  void scroll(int lines) override;
  [[nodiscard]] const std::string* filter() const override { return &filter_; }
  void setFilter(std::string filter) override;

 private:
  void refresh();
  [[nodiscard]] const insight::TimelineEvent& eventOf(std::uint64_t number) const;
  [[nodiscard]] bool passesFilter(const insight::TimelineEvent& event) const;
  void keepSelected();
  void drawDetails(const Canvas& canvas) const;
  void open();

  const ShownDrive& drive_;
  GoToEvent goToEvent_;
  std::string filter_;
  /// The events that pass the filter, the newest first, by their numbers.
  std::vector<std::uint64_t> rows_;
  /// The number of the oldest event that is kept.
  std::uint64_t oldest_ = 0;
  std::optional<std::uint64_t> selected_;
  bool hasDetails_ = false;
  ListWindow window_;
  int height_ = 1;
};

}  // namespace vesk
