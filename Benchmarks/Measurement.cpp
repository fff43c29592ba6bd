#include "Measurement.h"

#include <time.h>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <map>

namespace nidus {
namespace {

constexpr double kShortestBatch = 200'000;
constexpr double kNanosecondsPerSecond = 1e9;
constexpr int kFewestRounds = 5;

std::chrono::milliseconds rowTime(300);

/// What the floor took at each size, in seconds; of the kind of rows that is being measured.
std::map<std::int64_t, double> floorTimes;

double floorTimeAt(benchmark::IterationCount size) { return floorTimes.at(size); }

double processorTime() {
  timespec time{};
  clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
  return static_cast<double>(time.tv_sec) * kNanosecondsPerSecond +
         static_cast<double>(time.tv_nsec);
}

double timeOf(const Work& work, std::int64_t runs) {
  const double begin = processorTime();
  for (std::int64_t run = 0; run < runs; ++run) work();
  return (processorTime() - begin) / static_cast<double>(runs);
}

/// A piece of work, how often it is run between two looks at the clock, and its least time.
struct Piece {
  explicit Piece(const Work& itsWork) : work(itsWork), least(timeOf(work, 1)) {
    runs = std::max<std::int64_t>(1, static_cast<std::int64_t>(kShortestBatch / least));
  }
  void runBatch() { least = std::min(least, timeOf(work, runs)); }

  const Work& work;
  double least;
  std::int64_t runs = 1;
};

}  // namespace

void setTimePerRow(std::chrono::milliseconds time) { rowTime = time; }
std::chrono::milliseconds timePerRow() { return rowTime; }

std::vector<double> leastNanoseconds(const std::vector<Work>& pieces) {
  const double begin = processorTime();
  const double end = begin + static_cast<double>(std::chrono::nanoseconds(rowTime).count());
  std::vector<Piece> measured(pieces.begin(), pieces.end());
  for (int round = 0; round < kFewestRounds || processorTime() < end; ++round) {
    for (Piece& piece : measured) piece.runBatch();
  }
  std::vector<double> least;
  least.reserve(measured.size());
  for (const Piece& piece : measured) least.push_back(piece.least);
  return least;
}

void report(benchmark::State& state, const Row& row) {
  state.SetIterationTime(row.ours / kNanosecondsPerSecond);
  state.SetComplexityN(state.range(0));
  floorTimes[state.range(0)] = row.floor / kNanosecondsPerSecond;
  state.SetLabel(row.name);
  state.counters["ours"] = row.ours;
  state.counters["floor"] = row.floor;
  state.counters["goal"] = row.goal;
  state.counters["isLeast"] = row.isLeast ? 1 : 0;
  state.counters["unit"] = static_cast<double>(row.unit);
  if (row.floorPower) state.counters["floorPower"] = *row.floorPower;
}

void measureRow(benchmark::State& state, Row row, const Work& ours, const Work& floor,
                const Work& deducted) {
  for (auto _ : state) {
    std::vector<Work> pieces = {ours, floor};
    if (deducted) pieces.push_back(deducted);
    const auto times = leastNanoseconds(pieces);
    row.ours = times[0] - (deducted ? times[2] : 0);
    row.floor = times[1];
    report(state, row);
  }
}

void everySize(benchmark::internal::Benchmark* benchmark) {
  benchmark->RangeMultiplier(10)->Range(10, 100'000)->Iterations(1)->UseManualTime();
  benchmark->Complexity(floorTimeAt);
}

void everySizeTo10000(benchmark::internal::Benchmark* benchmark) {
  benchmark->RangeMultiplier(10)->Range(10, 10'000)->Iterations(1)->UseManualTime();
  benchmark->Complexity(floorTimeAt);
}

}  // namespace nidus
