#include "app/source/event_source.h"

#include <gtest/gtest.h>

namespace vesk {
namespace {

TEST(EventSource, TellsWhereTheReplayIsAndWhatIsWrong) {
  using Phase = corvik::PlaybackState::Phase;
  corvik::PlaybackState state;
  const auto text = [&](bool isLive = false) { return stateOfReplay(state, isLive).text; };
  EXPECT_EQ(text(), "waiting");
  state.phase = Phase::playing;
  state.speed = 10;
  state.position = 192.9;
  state.duration = 3700;
  EXPECT_EQ(text(), "▶ ×10  3:12 of 1:01:40");
  state.isHeld = true;
  state.badLines = 1;
  EXPECT_EQ(text(), "▮▮ ×10  3:12 of 1:01:40, 1 bad line");
  state.isSeeking = true;
  state.badLines = 2;
  EXPECT_EQ(text(), "▶▶ ×10  3:12 of 1:01:40, 2 bad lines");
  EXPECT_EQ(text(true), "live, 2 bad lines");
  state.phase = Phase::ended;
  EXPECT_EQ(text(), "ended, 2 bad lines");
}

}  // namespace
}  // namespace vesk
