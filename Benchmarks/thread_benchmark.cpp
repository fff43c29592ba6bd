#include <algorithm>
#include <atomic>
#include <chrono>
#include <thread>
#include <vector>

#include "BenchmarkPlatform.h"
#include "Measurement.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Requests.h"

namespace nidus {
namespace {

constexpr std::chrono::milliseconds kSlice(3);

/// Lets `threads` threads perform commands of their own for a slice of time and gives the commands
/// that one millisecond saw.
double commandsPerMillisecond(std::size_t threads, const BenchmarkPlatform& platform,
                              const VAHACommand& request) {
  std::atomic<std::size_t> ready = 0;
  std::vector<double> rates(threads);
  const auto perform = [&](std::size_t thread) {
    using Clock = std::chrono::steady_clock;
    ++ready;
    while (ready < threads) std::this_thread::yield();
    const auto begin = Clock::now();
    std::size_t commands = 0;
    while (Clock::now() - begin < kSlice) {
      benchmark::DoNotOptimize(platform.perform(request));
      ++commands;
    }
    const std::chrono::duration<double, std::milli> time = Clock::now() - begin;
    rates[thread] = static_cast<double>(commands) / time.count();
  };
  std::vector<std::thread> others;
  for (std::size_t thread = 1; thread < threads; ++thread) others.emplace_back(perform, thread);
  perform(0);
  for (std::thread& other : others) other.join();
  double sum = 0;
  for (const double rate : rates) sum += rate;
  return sum;
}

/// Commands of two threads beside those of one: the most that a slice of time saw of each, because
/// other work of the machine only takes away.
void BM_TwoThreads(benchmark::State& state, Row row) {
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light,
                                   {static_cast<std::size_t>(state.range(0)), 24});
  const BrightnessRequest request(VAHAActionTypeGETValue, numberedName(kServiceWord, 0, 24));
  for (auto _ : state) {
    double one = 0;
    double two = 0;
    const auto end = std::chrono::steady_clock::now() + 4 * timePerRow();
    while (std::chrono::steady_clock::now() < end) {
      one = std::max(one, commandsPerMillisecond(1, platform, request));
      two = std::max(two, commandsPerMillisecond(2, platform, request));
    }
    row.ours = two;
    row.floor = one;
    report(state, row);
  }
}

BENCHMARK_CAPTURE(BM_TwoThreads, one_target,
                  Row{.name = "commands per ms of two threads", .goal = 1.7, .isLeast = true})
    ->RangeMultiplier(10)
    ->Range(10, 1'000)
    ->Iterations(1)
    ->UseManualTime();

}  // namespace
}  // namespace nidus
