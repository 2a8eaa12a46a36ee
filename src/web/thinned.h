#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace vesk::web {

/// The points of a course over a drive's counted time, in a bounded number: when there would be too many, those beside
/// each other become one. A Point has a `position` in milliseconds, which never falls, and absorb(later).
template <class Point>
class Thinned {
 public:
  /// `most` is at least 1.
  explicit Thinned(std::size_t most) : most_(most) {}

  void add(const Point& point) {
    if (!joins(points_, point)) points_.push_back(point);
    while (points_.size() > most_)
      widen();
  }
  void clear() {
    points_.clear();
    width_ = 1;
  }

  [[nodiscard]] const std::vector<Point>& points() const { return points_; }

 private:
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
  /// Of the intervals in which there is one point at most: milliseconds.
  std::int64_t width_ = 1;
  std::vector<Point> points_;
};

}  // namespace vesk::web
