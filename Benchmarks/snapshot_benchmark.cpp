#include "BenchmarkPlatform.h"
#include "Floors.h"
#include "Measurement.h"

namespace nidus {
namespace {

NDDictionaryList dictionariesOf(const HomeObjectRecords& records) {
  NDDictionaryList list;
  list.reserve(records.size());
  for (const HomeObjectRecord& record : records) list.emplace_back(record.dictionary());
  return list;
}

void BM_Snapshot(benchmark::State& state, BenchmarkPlatform::Kind kind, std::size_t nameLength,
                 const Row& row) {
  const BenchmarkPlatform platform(kind, {static_cast<std::size_t>(state.range(0)), nameLength});
  const auto gather = platform.gather();
  const FlatRecords texts = flatRecords(dictionariesOf(gather->gatherNidusObjects()));
  measureRow(
      state, row, [&gather] { benchmark::DoNotOptimize(gather->gatherNidusObjects().data()); },
      [&texts] { benchmark::DoNotOptimize(copiedTexts(texts).data()); });
}

constexpr auto kLight = BenchmarkPlatform::Kind::light;
constexpr auto kEmbedded = BenchmarkPlatform::Kind::embedded;

BENCHMARK_CAPTURE(BM_Snapshot, 12, kLight, 12, Row{.name = "snapshot, names of 12", .goal = 1.5})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_Snapshot, 24, kLight, 24, Row{.name = "snapshot, names of 24", .goal = 1.0})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_Snapshot, embedded_24, kEmbedded, 24,
                  Row{.name = "snapshot, names of 24, embedded platform"})
    ->Apply(everySize);

}  // namespace
}  // namespace nidus
