#pragma once

#include <benchmark/benchmark.h>

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace nidus {

using Work = std::function<void()>;

/// How long the pieces of work of one row are repeated, and each of them five times at least: the
/// first time may be spent on fetching memory from the system.
void setTimePerRow(std::chrono::milliseconds time);
[[nodiscard]] std::chrono::milliseconds timePerRow();

/// Runs the pieces of work in turn, again and again, and gives the least processor time that one
/// run of each took on this thread, in nanoseconds. What disturbs the machine for a while disturbs
/// all of them alike, and the least of many runs is the one that was disturbed least. Work that is
/// short is run many times between two looks at the clock.
[[nodiscard]] std::vector<double> leastNanoseconds(const std::vector<Work>& pieces);

enum class Unit { nanoseconds, bytes, commands };

/// One line of the table.
struct Row {
  std::string name;
  double ours = 0;
  double floor = 0;
  double goal = 0;  ///< The greatest ratio, or with `isLeast` the least; 0 is none.
  bool isLeast = false;
  Unit unit = Unit::nanoseconds;
  /// The power of the size that the floor is known to grow as, which tells the growth of ours from
  /// the ratios: it is to be the same at most. None where the floor follows no power.
  std::optional<int> floorPower = 1;
};

/// Puts the row into the table, under the size `state.range(0)`.
void report(benchmark::State& state, const Row& row);

/// Measures `ours`, less what `deducted` takes unless that is empty, beside `floor`, and reports
/// them.
void measureRow(benchmark::State& state, Row row, const Work& ours, const Work& floor,
                const Work& deducted = nullptr);

/// Applies the sizes of all homes to a benchmark that measures by itself. The benchmark library
/// fits ours to what the floor took at the same sizes: it grows as the floor does where it fits
/// well.
void everySize(benchmark::internal::Benchmark* benchmark);
/// The same up to 10,000 services: for what writes all of them to a disk first, or walks objects
/// that no cache holds any more.
void everySizeTo10000(benchmark::internal::Benchmark* benchmark);

}  // namespace nidus
