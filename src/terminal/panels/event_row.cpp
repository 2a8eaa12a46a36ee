#include "terminal/panels/event_row.h"

#include <string>

#include "terminal/panels/cell_words.h"
#include "terminal/panels/event_marks.h"

namespace vesk {

void drawEventRow(const Canvas& canvas, int line, const insight::TimelineEvent& event, bool isSelected) {
  constexpr int kRoomy = 60;
  constexpr int kLongestKind = 13;
  const bool isRoomy = canvas.columns() >= kRoomy;
  const auto roleFor = [&](Role role) { return isSelected ? Role::Selected : role; };
  if (isSelected) canvas.fill(line, Role::Selected);
  const std::string time = insight::timeOfDay(event.moment.time);
  const Role role = roleOf(event);
  int column = canvas.write(1, line, isRoomy ? time : time.substr(0, 8), roleFor(Role::Faint)) + 2;
  const int kindEnd = canvas.write(column, line, nameOf(event.kind), roleFor(role));
  column = isRoomy ? column + kLongestKind + 2 : kindEnd + 1;
  std::string text = textOf(event);
  if (event.kind == insight::EventKind::gap) text += ", " + dateText(event.moment.time);
  canvas.write(column, line, text, roleFor(role == Role::Alarm || role == Role::Faint ? role : Role::Plain));
}

}  // namespace vesk
