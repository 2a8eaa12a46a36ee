#include "insight/connections.h"

#include <utility>

#include "insight/mobility.h"

namespace vesk::insight {

/// A change of state on its way, with what it happened amid.
struct Connections::Change {
  const RrcReport& report;
  OptionalNumber<std::int64_t> duration;
  /// What was under way before; absent when its begin was not seen.
  std::optional<Attempt> attempt;
  std::optional<CellIdentity> cell;
  OptionalNumber<double> level;

  [[nodiscard]] Technology technology() const { return report.technology; }
  [[nodiscard]] AttemptKind kind() const { return attemptKindOf(report.cause).value_or(AttemptKind::setUp); }
};

bool Connections::isReestablishing() const {
  const auto& attempt = of(Technology::lte).attempt;
  return attempt && attempt->kind == AttemptKind::reestablishment;
}

bool Connections::take(const RrcReport& report, const std::optional<ServingCell>& serving, const KnownKpis& kpis,
                       Step& step) {
  Connection& connection = connections_[indexOf(report.technology)];
  if (report.isMention) {
    if (!connection.state) connection = {.state = report.state, .since = step.now(), .cause = {}, .attempt = {}};
    return false;
  }
  const auto meaning = rrcClassOf(report.technology, report.state);
  const AttemptKind kind = attemptKindOf(report.cause).value_or(AttemptKind::setUp);
  const AttemptKind known = connection.attempt ? connection.attempt->kind : AttemptKind::setUp;
  const bool isOtherAttempt = meaning == RrcClass::attempt && kind != known;
  if (connection.state == report.state && !isOtherAttempt) return false;

  const std::optional<Text> from = connection.state ? connection.state : report.previous;
  OptionalNumber<std::int64_t> duration = report.previousDuration;
  if (!duration && connection.state) duration = step.now() - connection.since;
  const bool isServed = serving && serving->technology == report.technology;
  const Change change{report, duration, std::exchange(connection.attempt, std::nullopt),
                      isServed ? std::optional(serving->identity) : std::nullopt,
                      kpis.at(levelOf(report.technology), step.now())};
  connection.state = report.state;
  connection.since = step.now();
  connection.cause = report.cause;
  step.add(EventKind::rrc, RrcChange{report.technology, from, report.state, report.cause, duration});

  const auto old = from ? rrcClassOf(report.technology, *from) : std::nullopt;
  ConnectionCounts& counts = counts_[indexOf(report.technology)];
  if (meaning == RrcClass::attempt) {
    begin(change, step);
  } else if (old == RrcClass::attempt && meaning == RrcClass::connected) {
    succeed(change, step);
  } else if (old == RrcClass::attempt && meaning == RrcClass::idle) {
    fail(change, step);
  } else if (old == RrcClass::idle && meaning == RrcClass::connected) {
    ++counts.attempted;
    ++counts.established;
  } else if (old == RrcClass::connected && meaning == RrcClass::idle) {
    end(change, step);
  }
  return meaning == RrcClass::idle;
}

void Connections::begin(const Change& change, Step& step) {
  ConnectionCounts& counts = counts_[indexOf(change.technology())];
  if (change.attempt && change.attempt->kind == AttemptKind::reestablishment) drop(change, change.attempt->cause, step);
  Attempt attempt{change.kind(), change.report.cause};
  if (attempt.kind == AttemptKind::reestablishment) {
    counts.reestablishments.add(attempt.cause);
    attempt.cell = change.cell;
    attempt.level = change.level;
  } else {
    ++counts.attempted;
  }
  connections_[indexOf(change.technology())].attempt = std::move(attempt);
}

Connections::Attempt Connections::beginUnseen(const Change& change) {
  ConnectionCounts& counts = counts_[indexOf(change.technology())];
  if (change.kind() == AttemptKind::reestablishment) {
    counts.reestablishments.add(change.report.cause);
  } else {
    ++counts.attempted;
  }
  return {change.kind(), change.report.cause};
}

void Connections::succeed(const Change& change, Step& step) {
  ConnectionCounts& counts = counts_[indexOf(change.technology())];
  Attempt attempt = change.attempt ? *change.attempt : beginUnseen(change);
  const auto kind = change.technology() == Technology::lte ? attemptKindOf(change.report.cause) : std::nullopt;
  if (kind && *kind != attempt.kind) {
    if (attempt.kind == AttemptKind::reestablishment) drop(change, attempt.cause, step);
    attempt = beginUnseen(change);
  }
  if (attempt.kind == AttemptKind::setUp) {
    ++counts.established;
    return;
  }
  ++counts.reestablished;
  step.add(EventKind::reestablished, Reestablishment{change.technology(), attempt.cause, change.duration, attempt.cell,
                                                     change.cell, attempt.level});
}

void Connections::fail(const Change& change, Step& step) {
  const Attempt attempt = change.attempt ? *change.attempt : beginUnseen(change);
  if (attempt.kind == AttemptKind::reestablishment) {
    drop(change, attempt.cause, step);
    return;
  }
  counts_[indexOf(change.technology())].failed.add(change.report.cause);
  step.add(EventKind::connectionFailed,
           ConnectionLoss{change.technology(), change.report.cause, change.cell, change.level});
}

void Connections::end(const Change& change, Step& step) {
  if (isDrop(change.technology(), change.report.state, change.report.cause)) {
    drop(change, change.report.cause, step);
  } else {
    counts_[indexOf(change.technology())].released.add(change.report.cause);
  }
}

void Connections::drop(const Change& change, const std::optional<Text>& cause, Step& step) {
  counts_[indexOf(change.technology())].dropped.add(cause);
  step.add(EventKind::drop, ConnectionLoss{change.technology(), cause, change.cell, change.level});
}

}  // namespace vesk::insight
