#include "insight/quantities.h"

namespace vesk::insight {

std::string_view nameOf(Grade grade) {
  switch (grade) {
    case Grade::poor:
      return "poor";
    case Grade::fair:
      return "fair";
    case Grade::good:
      return "good";
    case Grade::excellent:
      return "excellent";
  }
  return {};
}

std::optional<Grade> gradeOf(const Quantity& quantity, double value) {
  if (!quantity.steps) return std::nullopt;
  if (value >= quantity.steps->excellent) return Grade::excellent;
  if (value >= quantity.steps->good) return Grade::good;
  return value >= quantity.steps->fair ? Grade::fair : Grade::poor;
}

}  // namespace vesk::insight
