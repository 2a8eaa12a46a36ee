#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <vector>

namespace vesk::web {

/// The points of a course over a drive's counted time, in a bounded number: when there would be too many, those beside
/// each other become one; the latest stay as they are. A Point has a `position` in milliseconds, which never falls, and
/// absorb(later).
template <class Point>
class Thinned {
 public:
  /// `most` is at least 1, of those before and of the latest, which are those of the last `whole` milliseconds.
  explicit Thinned(std::size_t most, std::int64_t whole = 0) : most_(most), whole_(whole) {}

  void add(const Point& point) {
    latest_.push_back(point);
    while (!latest_.empty() && (latest_.size() > most_ || point.position - latest_.front().position >= whole_)) {
      thin(latest_.front());
      latest_.pop_front();
    }
  }
  void clear() {
    points_.clear();
    latest_.clear();
    width_ = 1;
  }

  [[nodiscard]] std::vector<Point> points() const {
    std::vector<Point> all = points_;
    all.insert(all.end(), latest_.begin(), latest_.end());
    return all;
  }
  /// Of the intervals in which there is one point at most: milliseconds.
  [[nodiscard]] std::int64_t width() const { return width_; }

 private:
  void thin(const Point& point) {
    if (!joins(points_, point)) points_.push_back(point);
    while (points_.size() > most_)
      widen();
  }

  /// Whether the point lies so close behind the last one that it became a part of it.
  bool joins(std::vector<Point>& points, const Point& point) const {
    if (points.empty() || points.back().position / width_ != point.position / width_) return false;
    points.back().absorb(point);
    return true;
  }

  void widen() {
    width_ *= 2;
    std::vector<Point> fewer;
    for (const Point& point : points_)
      if (!joins(fewer, point)) fewer.push_back(point);
    points_ = std::move(fewer);
  }

  std::size_t most_;
  std::int64_t whole_;
  std::int64_t width_ = 1;
  std::vector<Point> points_;
  std::deque<Point> latest_;
};

}  // namespace vesk::web
