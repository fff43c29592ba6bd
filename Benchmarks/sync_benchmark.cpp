#include <memory>
#include <utility>

#include "BenchmarkPlatform.h"
#include "BenchmarkSync.h"
#include "Floors.h"
#include "Measurement.h"

namespace nidus {
namespace {

HomeShape shapeOf(std::int64_t services, std::size_t nameLength) {
  return {static_cast<std::size_t>(services), nameLength};
}

/// A whole sync; its floor is the snapshot and an entity made by hand for each record.
void BM_Sync(benchmark::State& state, std::size_t nameLength, const Row& row) {
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light,
                                   shapeOf(state.range(0), nameLength));
  BenchmarkSync sync;
  const auto gather = platform.gather();
  const HomeObjectRecords records = gather->gatherNidusObjects();
  std::vector<AnswerTexts> texts;
  for (const HomeObjectRecord& record : records) {
    texts.push_back(
        {record.objectName, record.objectType, nullptr, record.objectRoom, record.objectHome});
  }
  sync.begin(platform);
  if (sync.pullAll() != records.size()) return state.SkipWithError("not an entity for each");
  sync.end();
  measureRow(
      state, row,
      [&] {
        sync.begin(platform);
        benchmark::DoNotOptimize(sync.pullAll());
        sync.end();
      },
      [&] {
        benchmark::DoNotOptimize(gather->gatherNidusObjects().data());
        benchmark::DoNotOptimize(entitiesByHand(texts).data());
      });
}

constexpr std::size_t kFewServices = 10;

/// A sync that has begun, and the anchor of its last entity but one. Its platform is gone.
class LatePull {
 public:
  explicit LatePull(std::int64_t services)
      : platform_(std::make_unique<BenchmarkPlatform>(BenchmarkPlatform::Kind::light,
                                                      shapeOf(services, 24))) {
    sync_.begin(*platform_);
    anchor_ = std::to_string(sync_.pullAll() - 2);
    platform_ = nullptr;
  }
  void operator()() { benchmark::DoNotOptimize(sync_.pullAfter(anchor_).get()); }

 private:
  std::unique_ptr<BenchmarkPlatform> platform_;
  BenchmarkSync sync_;
  NDString anchor_;
};

/// A late pull of a great sync beside one of a small sync.
void BM_Pull(benchmark::State& state, const Row& row) {
  LatePull small(kFewServices);
  LatePull great(state.range(0));
  measureRow(
      state, row, [&great] { great(); }, [&small] { small(); });
}

BENCHMARK_CAPTURE(BM_Sync, 12, 12, Row{.name = "sync, names of 12", .goal = 1.5})->Apply(everySize);
BENCHMARK_CAPTURE(BM_Sync, 24, 24, Row{.name = "sync, names of 24", .goal = 1.5})->Apply(everySize);
BENCHMARK_CAPTURE(BM_Pull, late,
                  Row{.name = "one pull beside one of 10", .goal = 1.5, .floorPower = 0})
    ->Apply(everySize);

}  // namespace
}  // namespace nidus
