// time_programs RECORDING... -- ROW PROGRAM ARGUMENT... [-- ROW PROGRAM ARGUMENT...]...: runs each program over each
// recording, given as its last argument, and over none, in turn. Writes what the least disturbed runs took, as the
// figures of ROW: the wall time of a start, the processor time of an event beyond that, and the most memory.

#include <algorithm>
#include <fstream>
#include <iostream>
#include <iterator>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include "bench/child_program.h"
#include "bench/fact.h"

namespace vesk::bench {
namespace {

/// Runs of a few milliseconds are disturbed easily.
constexpr int kStartRounds = 200;
constexpr int kTimedRounds = 20;
/// Of a longer recording only the memory is of interest, and of one that is shorter than the longest timed.
constexpr std::size_t kLongestTimed = 100'000;
constexpr int kMemoryRounds = 2;

struct Recording {
  std::string path;
  std::size_t events;
  int rounds;
};

/// A program over a recording, and the best of its runs.
struct Task {
  std::string row;
  std::vector<std::string> command;
  const Recording* recording;
  double processorSeconds = std::numeric_limits<double>::infinity();
  double wallSeconds = std::numeric_limits<double>::infinity();
  long peakKib = 0;

  void run() {
    const Usage usage = runToEnd(command);
    processorSeconds = std::min(processorSeconds, usage.processorSeconds);
    wallSeconds = std::min(wallSeconds, usage.wallSeconds);
    peakKib = std::max(peakKib, usage.peakKib);
  }
};

std::size_t lineCount(const std::string& path) {
  std::ifstream file(path);
  return static_cast<std::size_t>(
      std::count(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>(), '\n'));
}

/// The empty recording first.
std::vector<Recording> recordingsAt(const std::vector<std::string>& paths) {
  std::vector<Recording> recordings{{"/dev/null", 0, kStartRounds}};
  for (const std::string& path : paths)
    recordings.push_back({path, lineCount(path), kMemoryRounds});
  Recording* longest = nullptr;
  for (Recording& each : recordings) {
    if (each.events <= kLongestTimed && (longest == nullptr || each.events > longest->events)) longest = &each;
  }
  if (longest->events > 0) longest->rounds = kTimedRounds;
  return recordings;
}

/// Every round comes at a place of its own, so that no program always follows the same one.
void runInterleaved(std::vector<Task>& tasks) {
  std::vector<Task*> order;
  for (Task& task : tasks)
    order.insert(order.end(), static_cast<std::size_t>(task.recording->rounds), &task);
  std::shuffle(order.begin(), order.end(), std::mt19937(1));
  for (Task* task : order)
    task->run();
}

/// The tasks of a row follow one another, from the empty recording on.
void report(const std::vector<Task>& tasks) {
  double startSeconds = 0;
  for (const Task& task : tasks) {
    const auto& [path, events, rounds] = *task.recording;
    if (events == 0) {
      startSeconds = task.processorSeconds;
      writeFact(task.row, 0, "ms", task.wallSeconds * 1e3);
    } else {
      writeFact(task.row, events, "MiB", static_cast<double>(task.peakKib) / 1024);
    }
    if (events > 0 && rounds == kTimedRounds) {
      writeFact(task.row, events, "ns", (task.processorSeconds - startSeconds) * 1e9 / static_cast<double>(events));
    }
  }
}

/// What stands between the "--".
std::vector<std::vector<std::string>> groupsOf(const std::vector<std::string>& arguments) {
  std::vector<std::vector<std::string>> groups(1);
  for (const std::string& argument : arguments) {
    if (argument == "--") {
      groups.emplace_back();
    } else {
      groups.back().push_back(argument);
    }
  }
  return groups;
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  using namespace vesk::bench;
  const auto groups = groupsOf({argv + 1, argv + argc});
  const bool isComplete =
      std::all_of(groups.begin() + 1, groups.end(), [](const auto& group) { return group.size() >= 2; });
  if (groups.size() < 2 || !isComplete) {
    std::cerr << "usage: time_programs RECORDING... -- ROW PROGRAM ARGUMENT... [-- ROW PROGRAM ARGUMENT...]...\n";
    return 2;
  }
  const std::vector<Recording> recordings = recordingsAt(groups.front());
  std::vector<Task> tasks;
  for (auto group = groups.begin() + 1; group != groups.end(); ++group) {
    for (const Recording& recording : recordings) {
      Task& task = tasks.emplace_back(Task{group->front(), {group->begin() + 1, group->end()}, &recording});
      task.command.push_back(recording.path);
    }
  }
  runInterleaved(tasks);
  report(tasks);
}
