#include <atomic>

#include "BenchmarkPlatform.h"
#include "Logging/WLOLog.h"
#include "Measurement.h"

namespace nidus {
namespace {

constexpr int kSuppressedLevel = 6;

std::atomic<std::int32_t> floorLevel{4};

/// The least that a suppressed message can cost.
[[gnu::noinline]] bool passesFloor(int level) {
  return level <= floorLevel.load(std::memory_order_relaxed);
}

/// Asks `range(0)` times whether a message is to be logged that is not.
void BM_SuppressedMessage(benchmark::State& state, const Row& row) {
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light, {.services = 1});
  if (WLOShouldLogAtLevel(kSuppressedLevel)) return state.SkipWithError("it is logged");
  const auto asks = state.range(0);
  const auto ask = [asks](auto&& isLogged) {
    for (std::int64_t i = 0; i < asks; ++i) {
      int level = kSuppressedLevel;
      benchmark::DoNotOptimize(level);
      benchmark::DoNotOptimize(isLogged(level));
    }
  };
  measureRow(
      state, row, [&ask] { ask(WLOShouldLogAtLevel); }, [&ask] { ask(passesFloor); });
}

BENCHMARK_CAPTURE(BM_SuppressedMessage, guard, Row{.name = "suppressed messages", .goal = 2})
    ->Apply(everySize);

}  // namespace
}  // namespace nidus
