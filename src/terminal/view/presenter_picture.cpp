// How the presenter puts together what shows.

#include <algorithm>
#include <iterator>
#include <utility>

#include "terminal/device/column_width.h"
#include "terminal/view/freshness.h"
#include "terminal/view/presenter.h"

namespace vesk {

std::vector<std::string> Presenter::titles() const {
  std::vector<std::string> titles;
  for (const Screen& screen : screens_) {
    const std::optional<Text>& title = screen.controller->title();
    titles.emplace_back(title ? title->view() : "–");
  }
  return titles;
}

PathBar Presenter::pathBar(int statusWidth) const {
  std::vector<std::string> names = titles();
  if (panels_) {
    for (const Panel* each : panels_->shown())
      names.emplace_back(each->title());
  }
  return layOutPath(names, statusColumn(size_.columns, statusWidth) - 1 - kBarMargin);
}

void Presenter::expectChange(std::optional<Clock::Instant> when) {
  if (when && (!nextChange_ || *when < *nextChange_)) nextChange_ = when;
}

Picture Presenter::picture(Clock::Instant now) {
  if (surroundings_.growOlder) surroundings_.growOlder();
  followStack();
  nextChange_.reset();
  Picture picture{.size = size_};
  if (surroundings_.sourceState) {
    SourceState state = surroundings_.sourceState();
    picture.status = std::move(state.text);
    if (!state.date.empty()) picture.status += dateBehind(picture.status, state.date);
    expectChange(state.nextChange);
  }
  statusWidth_ = textWidth(picture.status);
  if (noticeEnd_ && now < *noticeEnd_) {
    picture.notice = notice_;
    expectChange(noticeEnd_);
  }
  picture.path = pathBar(statusWidth_);

  picture.helpStart = helpStart_;
  picture.isFrozen = isHeld_;
  if (filter() != nullptr) picture.filter = *filter();
  picture.isTypingFilter = isTypingFilter_ && filter() != nullptr;
  if (panel() != nullptr) {
    picture.panel = panel();
  } else {
    fillTable(picture, now);
  }
  picture.hints = hints(picture);
  picture.paneHeight = paneHeight();
  if (picture.paneHeight != PaneHeight::None) picture.pane = pane_.shown(paneRoom());
  return picture;
}

std::vector<Action> Presenter::hints(const Picture& picture) {
  if (helpStart_) return {Action::Back, Action::Quit};
  std::vector<Action> hints =
      panel() != nullptr ? std::vector(panel()->hints().begin(), panel()->hints().end()) : hintsOnTable(picture);
  if (surroundings_.isSeekable) {
    constexpr Action kOfReplay[] = {Action::Backward, Action::Forward, Action::Faster, Action::Slower};
    hints.insert(hints.end(), std::begin(kOfReplay), std::end(kOfReplay));
  }
  return hints;
}

std::vector<Action> Presenter::hintsOnTable(const Picture& picture) {
  const auto opens = [](const ListLine& line) { return line.isSelected && line.hasDisclosure; };
  const std::pair<Action, bool> needs[] = {
      {Action::Open, std::any_of(picture.lines.begin(), picture.lines.end(), opens)},
      {Action::Back, screens_.size() > 1 || !picture.filter.empty()},
      {Action::Filter, browser() != nullptr},
      {Action::Diagnostics, surroundings_.diagnostics != nullptr},
      {Action::Overview, panels_.has_value()},
  };
  const auto isWithout = [&](Action action) {
    const auto* found =
        std::find_if(std::begin(needs), std::end(needs), [&](const auto& need) { return need.first == action; });
    return found != std::end(needs) && !found->second;
  };
  std::vector<Action> hints;
  std::remove_copy_if(tableHints().begin(), tableHints().end(), std::back_inserter(hints), isWithout);
  return hints;
}

void Presenter::fillTable(Picture& picture, Clock::Instant now) {
  const std::vector<std::string> titles = this->titles();
  if (!titles.empty()) picture.title = titles.back();
  if (titles.size() == kDepthOfMetrics && screens_.back().arrivals) {
    const Arrivals& shown = *screens_.back().arrivals;
    // The rows are taken over every few seconds only.
    const bool isToCome =
        !shown.last && !isHolding() && surroundings_.arrivals(titles[1], titles[2]).value_or(Arrivals{}).last;
    picture.freshness = isToCome ? "arrived, not shown yet" : timeBound(freshnessOf(shown, driveTime()), now);
    const std::string instead = technologyInstead(titles[1], titles[2]);
    if (!instead.empty()) picture.freshness += ", the handset is on " + instead;
  }
  if (TableBrowser* shown = browser()) {
    picture.lines = shown->lines(showsReadings_);
    picture.extent = shown->scrollExtent();
  }
  if (titles.size() == kDepthOfMetrics - 1) addHeadlines(picture, titles[1], now);
}

/// What the drive's date takes behind the status; nothing where the path would lose by it.
std::string Presenter::dateBehind(std::string_view status, std::string_view date) const {
  constexpr int kGap = 2;
  const std::string behind = std::string(kGap, ' ') + std::string(date);
  const int width = textWidth(status) + textWidth(behind);
  const bool fits = statusColumn(size_.columns, width) + width <= size_.columns - kBarMargin;
  return fits && pathBar(width).text == pathBar(0).text ? behind : std::string();
}

std::chrono::milliseconds Presenter::driveTime() const {
  return surroundings_.driveMoment ? surroundings_.driveMoment().time : std::chrono::milliseconds(0);
}

/// The text, which is to be written anew when it is another one.
std::string Presenter::timeBound(Freshness freshness, Clock::Instant now) {
  const double pace = surroundings_.driveMoment ? surroundings_.driveMoment().pace : 0;
  if (freshness.untilChange && pace > 0)
    expectChange(now + std::chrono::duration_cast<Clock::Duration>(*freshness.untilChange / pace));
  return std::move(freshness.text);
}

std::string Presenter::technologyInstead(std::string_view area, std::string_view category) const {
  return surroundings_.technologyInstead ? surroundings_.technologyInstead(area, category) : std::string();
}

/// Each category's most telling value and its age, or as much of it as fits.
void Presenter::addHeadlines(Picture& picture, std::string_view area, Clock::Instant now) {
  constexpr int kGap = 2;
  if (!surroundings_.headline || !surroundings_.arrivals) return;
  for (ListLine& line : picture.lines) {
    if (!line.isFirstOfRow) continue;
    const std::string_view category = line.text.name;
    const std::optional<Arrivals> arrivals = surroundings_.arrivals(area, category);
    if (!arrivals || !arrivals->last) continue;
    const std::string headline = surroundings_.headline(area, category);
    const std::string age = timeBound(ageOf(*arrivals, driveTime()), now);
    const std::string instead = technologyInstead(area, category);
    const int room = rowTextEnd(std::min(regions().listColumns, kWidestPair), line.hasDisclosure) - kRowGutter -
                     textWidth(category) - kGap;
    std::string both = headline;
    if (!both.empty()) both += "  ";
    both += age;
    std::string withTechnology = both;
    if (!instead.empty()) withTechnology.append(", now ").append(instead);
    for (const std::string& note : {withTechnology, both, age}) {
      if (textWidth(note) > room) continue;
      line.note = note;
      break;
    }
  }
}

}  // namespace vesk
