// time_programs PROGRAMS RECORDING...: runs the programs in the folder PROGRAMS over each recording and over none, in
// turn, and writes what the least disturbed runs took.

#include <algorithm>
#include <fstream>
#include <iostream>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include "child_program.h"
#include "fact.h"

namespace vesk::bench {
namespace {

/// A run of a few milliseconds is disturbed more easily.
constexpr int kShortRounds = 100;
constexpr int kLongRounds = 20;
constexpr std::size_t kLongestShort = 10'000;
/// Of a longer recording than this only the memory is of interest.
constexpr std::size_t kLongestTimed = 100'000;
constexpr int kMemoryRounds = 2;

int roundsFor(std::size_t events) {
  if (events > kLongestTimed) return kMemoryRounds;
  return events > kLongestShort ? kLongRounds : kShortRounds;
}

/// A command over a recording, and the best of its runs.
struct Task {
  std::string row;
  std::size_t events;
  std::vector<std::string> command;
  int rounds;
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

std::vector<Task> tasksFor(const std::string& programs, const std::vector<std::string>& recordings) {
  const std::string vesk = programs + "/vesk";
  std::vector<Task> tasks{{"empty", 0, {programs + "/empty_program"}, kShortRounds}};
  const auto addEach = [&](const std::string& path) {
    const std::size_t events = lineCount(path);
    const int rounds = roundsFor(events);
    tasks.push_back({"decode/vesk", events, {vesk, "decode", path}, rounds});
    tasks.push_back({"decode/libprotobuf", events, {programs + "/decode_with_libprotobuf", path}, rounds});
    tasks.push_back({"stores/vesk", events, {vesk, "stores", path}, rounds});
  };
  addEach("/dev/null");
  for (const std::string& path : recordings)
    addEach(path);
  return tasks;
}

/// Every round runs in an order of its own, so that no program always follows the same one.
void runInterleaved(std::vector<Task>& tasks) {
  std::mt19937 random(1);
  std::vector<Task*> order;
  for (Task& task : tasks)
    order.insert(order.end(), static_cast<std::size_t>(task.rounds), &task);
  std::shuffle(order.begin(), order.end(), random);
  for (Task* task : order)
    task->run();
}

double processorSecondsOfStart(const std::vector<Task>& tasks, const std::string& row) {
  const auto start =
      std::find_if(tasks.begin(), tasks.end(), [&](const Task& task) { return task.row == row && task.events == 0; });
  return start->processorSeconds;
}

void report(const std::vector<Task>& tasks) {
  for (const Task& task : tasks) {
    if (task.events == 0) {
      writeFact(task.row, 0, "ms", task.wallSeconds * 1e3);
      continue;
    }
    writeFact(task.row, task.events, "MiB", static_cast<double>(task.peakKib) / 1024);
    if (task.events > kLongestTimed) continue;
    const double beyondStart = task.processorSeconds - processorSecondsOfStart(tasks, task.row);
    writeFact(task.row, task.events, "ns", beyondStart * 1e9 / static_cast<double>(task.events));
  }
}

}  // namespace
}  // namespace vesk::bench

int main(int argc, char** argv) {
  using namespace vesk::bench;
  if (argc < 3) {
    std::cerr << "usage: time_programs PROGRAMS RECORDING...\n";
    return 2;
  }
  std::vector<Task> tasks = tasksFor(argv[1], {argv + 2, argv + argc});
  runInterleaved(tasks);
  report(tasks);
}
