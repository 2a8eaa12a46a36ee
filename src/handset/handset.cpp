#include "handset/handset.h"

#include "handset/behaviour/sim_card.h"
#include "handset/behaviour/triggers.h"

namespace vesk::handset {

namespace {

constexpr std::int64_t kStepMs = 100;

}  // namespace

Handset::Handset(std::uint64_t seed, std::uint64_t startMs)
    : random_(seed),
      network_(makeNetwork(random_)),
      radio_(network_, drive_.place(), random_),
      registration_(random_),
      outbox_(startMs) {
  registration_.switchOn(outbox_);
  mode().enter({nowMs_, radio_, outbox_, registration_, random_}, false);
}

HandsetEvent Handset::next() {
  while (outbox_.isEmpty())
    step();
  return outbox_.take();
}

HandsetEvent Handset::simFiles() {
  auto files = readSimFiles(registration_.subscriber(), registration_.identity());
  return outbox_.answer(files);
}

void Handset::step() {
  nowMs_ += kStepMs;
  outbox_.setTime(nowMs_);
  constexpr double kSeconds = kStepMs / 1000.0;
  drive_.advance(kSeconds, random_);
  radio_.moveTo(drive_.place(), drive_.speed() * kSeconds, random_);

  const StepContext now{nowMs_, radio_, outbox_, registration_, random_};
  if (const auto departure = mode().step(now)) {
    technology_ = departure->to;
    outbox_.raiseTrigger(kTechnologyChangeTrigger);
    mode().enter(now, departure->isHandover);
  }
}

Mode& Handset::mode() {
  switch (technology_) {
    case Technology::umts:
      return umts_;
    case Technology::gsm:
      return gsm_;
    case Technology::lte:
      break;
  }
  return lte_;
}

}  // namespace vesk::handset
