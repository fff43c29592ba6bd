#include <sys/resource.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <optional>
#include <thread>
#include <vector>

#include "BenchmarkPlatform.h"
#include "Measurement.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Requests.h"

namespace nidus {
namespace {

constexpr std::chrono::milliseconds kSlice(2);

/// How often this thread had to make way for other work of the machine.
long interruptions() {
  rusage usage{};
  getrusage(RUSAGE_THREAD, &usage);
  return usage.ru_nivcsw;
}

/// What one thread did in a slice of time.
struct Slice {
  double commandsPerMillisecond = 0;
  bool isDisturbed = false;
};

Slice performForASlice(const BenchmarkPlatform& platform, const VAHACommand& request) {
  using Clock = std::chrono::steady_clock;
  const long interruptionsBefore = interruptions();
  const auto begin = Clock::now();
  std::size_t commands = 0;
  while (Clock::now() - begin < kSlice) {
    benchmark::DoNotOptimize(platform.perform(request));
    ++commands;
  }
  const std::chrono::duration<double, std::milli> time = Clock::now() - begin;
  return {static_cast<double>(commands) / time.count(), interruptions() != interruptionsBefore};
}

/// Lets `threads` threads perform commands of their own for the same slice of time and gives the
/// commands that one millisecond saw; 0 when other work of the machine came between.
double commandsPerMillisecond(std::size_t threads, const BenchmarkPlatform& platform,
                              const VAHACommand& request) {
  std::atomic<std::size_t> ready = 0;
  std::vector<Slice> slices(threads);
  const auto perform = [&](std::size_t thread) {
    ++ready;
    while (ready < threads) std::this_thread::yield();
    slices[thread] = performForASlice(platform, request);
  };
  std::vector<std::thread> others;
  for (std::size_t thread = 1; thread < threads; ++thread) others.emplace_back(perform, thread);
  perform(0);
  for (std::thread& other : others) other.join();
  double sum = 0;
  for (const Slice& slice : slices) {
    if (slice.isDisturbed) return 0;
    sum += slice.commandsPerMillisecond;
  }
  return sum;
}

/// Commands of two threads beside those of one: the most that an undisturbed slice of time saw of
/// each.
void BM_TwoThreads(benchmark::State& state, Row row) {
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light,
                                   {static_cast<std::size_t>(state.range(0)), 24});
  const BrightnessRequest request(VAHAActionTypeGETValue, numberedName(kServiceWord, 0, 24));
  for (auto _ : state) {
    const auto end = std::chrono::steady_clock::now() + 4 * timePerRow();
    while (std::chrono::steady_clock::now() < end) {
      row.floor = std::max(row.floor, commandsPerMillisecond(1, platform, request));
      row.ours = std::max(row.ours, commandsPerMillisecond(2, platform, request));
    }
    if (row.floor > 0 && row.ours > 0) {
      report(state, row);
    } else {
      state.SkipWithError("the machine is too busy: no slice of time was undisturbed");
    }
  }
}

BENCHMARK_CAPTURE(BM_TwoThreads, one_target,
                  Row{.name = "commands per ms of two threads",
                      .goal = 1.7,
                      .isLeast = true,
                      .unit = Unit::commands,
                      .floorPower = std::nullopt})
    ->RangeMultiplier(10)
    ->Range(10, 1'000)
    ->Iterations(1)
    ->UseManualTime();

}  // namespace
}  // namespace nidus
