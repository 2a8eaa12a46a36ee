#include "app/program/shown_moment.h"

#include <algorithm>
#include <ctime>
#include <utility>

#include "app/program/headlines.h"
#include "screens/category_sources.h"
#include "screens/shown_stores.h"

namespace vesk {

namespace {

/// Whether another technology has a category of the same metric.
bool isCommon(const CategorySource& source) {
  const auto sources = categorySources();
  return std::any_of(sources.begin(), sources.end(), [&](const CategorySource& other) {
    return other.metric == source.metric && other.area != source.area;
  });
}

}  // namespace

void ShownMoment::noteArrival(std::int64_t metricId, const Stores& stores) {
  const Clock::Instant now = clock_.now();
  time_.take(drive_.now(), now);
  if (const Record* record = latestRecordOf(stores, metricId))
    arrivals_.note(metricId, *record, time_.at(now, pace_()).time);
}

void ShownMoment::startAnew() {
  arrivals_ = {};
  time_ = {};
}

void ShownMoment::setSinceLastEvent(std::chrono::milliseconds passed) {
  if (const auto& last = drive_.clock().now()) time_.take(*last + passed.count(), clock_.now());
}

void ShownMoment::keepTime() {
  time_.keep(clock_.now(), pace_());
}

ShownMoment::Held ShownMoment::now() const {
  const DriveMoment time = time_.at(clock_.now(), pace_());
  return {arrivals_, {time.time, 0}, drive_.now().has_value(), drive_.timeline().mobility().technology()};
}

void ShownMoment::hold() {
  held_ = now();
  holdShownStores();
}

void ShownMoment::release() {
  held_.reset();
  releaseShownStores();
}

std::optional<Arrivals> ShownMoment::arrivals(std::string_view area, std::string_view category) const {
  return (held_ ? held_->arrivals : arrivals_).of(area, category);
}

DriveMoment ShownMoment::time() const {
  return held_ ? held_->time : time_.at(clock_.now(), pace_());
}

std::string ShownMoment::date() const {
  if (held_ ? !held_->isDated : !drive_.now()) return {};
  const auto seconds = static_cast<std::time_t>(time().time / std::chrono::seconds(1));
  std::tm fields{};
  char text[40];
  if (gmtime_r(&seconds, &fields) == nullptr) return {};
  const std::size_t size = std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S UTC", &fields);
  return {text, size};
}

std::string ShownMoment::technologyInstead(std::string_view area, std::string_view category) const {
  const auto technology = held_ ? held_->technology : drive_.timeline().mobility().technology();
  const auto& all = insight::kTechnologies;
  const bool isOfOne =
      std::any_of(all.begin(), all.end(), [&](insight::Technology each) { return nameOf(each) == area; });
  if (!technology || !isOfOne || nameOf(*technology) == area || isCommon(sourceOf(area, category))) return {};
  return std::string(nameOf(*technology));
}

void ShownMoment::addTo(Surroundings& surroundings) const {
  surroundings.arrivals = [this](std::string_view area, std::string_view category) { return arrivals(area, category); };
  surroundings.driveMoment = [this] { return time(); };
  surroundings.technologyInstead = [this](std::string_view area, std::string_view category) {
    return technologyInstead(area, category);
  };
  surroundings.headline = [](std::string_view area, std::string_view category) {
    return headlineOf(sourceOf(area, category), shownStores());
  };
  surroundings.reading = [](std::string_view area, std::string_view category, IndexPath at, std::string_view name) {
    return readingOfRow(sourceOf(area, category), shownStores(), at, name);
  };
}

}  // namespace vesk
