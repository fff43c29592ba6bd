#include "BenchmarkPlatform.h"
#include "Floors.h"
#include "Measurement.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Requests.h"

namespace nidus {
namespace {

using Kind = BenchmarkPlatform::Kind;

NDString lastName(std::size_t services, std::size_t nameLength) {
  return numberedName(kServiceWord, services - 1, nameLength);
}

/// A whole command with one target; its floor is the snapshot and the filter that it cannot do
/// without.
void BM_CommandOne(benchmark::State& state, Kind kind, std::size_t nameLength, Row row) {
  const auto services = static_cast<std::size_t>(state.range(0));
  const BenchmarkPlatform platform(kind, {services, nameLength});
  const BrightnessRequest request(VAHAActionTypeGETValue, lastName(services, nameLength));
  const auto& filter = static_cast<const VAHASearchCriteriaFilter&>(*request.filter());
  if (platform.perform(request) != 1) return state.SkipWithError("not one result");
  const auto gather = platform.gather();
  if (services < 1'000) row.goal = 0;
  measureRow(
      state, row, [&] { benchmark::DoNotOptimize(platform.perform(request)); },
      [&] {
        NDAssistantCommand command(request);
        command.setMetadata(NDNAPMetadata::getSharedInstance());
        command.setNidusObjects(gather->gatherNidusObjects());
        benchmark::DoNotOptimize(command.objectsWithSearchFilter_inHome(filter, nullptr));
      });
}

/// What each target adds to a command with one; its floor is a result made by hand for each.
void BM_CommandAll(benchmark::State& state, Kind kind, std::size_t nameLength,
                   std::string_view actionType, const Row& row) {
  const auto services = static_cast<std::size_t>(state.range(0));
  const BenchmarkPlatform platform(kind, {services, nameLength});
  const BrightnessRequest one(actionType, lastName(services, nameLength));
  const BrightnessRequest all(actionType, nullptr);
  if (platform.perform(all) != services) return state.SkipWithError("not a result for each");
  std::vector<AnswerTexts> texts;
  for (const HomeObjectRecord& record : platform.gather()->gatherNidusObjects()) {
    if (record.objectServiceType && texts.size() + 1 < services) {
      texts.push_back({record.objectName, record.objectType, NDString("LIGHT"), record.objectRoom,
                       record.objectHome});
    }
  }
  measureRow(
      state, row, [&] { benchmark::DoNotOptimize(platform.perform(all)); },
      [&texts] { benchmark::DoNotOptimize(resultsByHand(texts).data()); },
      [&] { benchmark::DoNotOptimize(platform.perform(one)); });
}

constexpr std::string_view kGet = VAHAActionTypeGETValue;
constexpr std::string_view kSet = VAHAActionTypeSETValue;
constexpr std::string_view kRaise = VAHAActionTypeINCREASEValue;

BENCHMARK_CAPTURE(BM_CommandOne, 12, Kind::light, 12,
                  Row{.name = "command, one target, names of 12", .goal = 1.3})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandOne, 24, Kind::light, 24,
                  Row{.name = "command, one target, names of 24", .goal = 1.3})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, read_12, Kind::light, 12, kGet,
                  Row{.name = "read all, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, read_24, Kind::light, 24, kGet,
                  Row{.name = "read all, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, write_12, Kind::light, 12, kSet,
                  Row{.name = "write all, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, write_24, Kind::light, 24, kSet,
                  Row{.name = "write all, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, raise_12, Kind::light, 12, kRaise,
                  Row{.name = "raise all, names of 12", .goal = 6})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, raise_24, Kind::light, 24, kRaise,
                  Row{.name = "raise all, names of 24", .goal = 6})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandOne, embedded_24, Kind::embedded, 24,
                  Row{.name = "command, one target, names of 24, embedded platform"})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, embedded_read_24, Kind::embedded, 24, kGet,
                  Row{.name = "read all, names of 24, embedded platform"})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, embedded_write_24, Kind::embedded, 24, kSet,
                  Row{.name = "write all, names of 24, embedded platform"})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_CommandAll, embedded_raise_24, Kind::embedded, 24, kRaise,
                  Row{.name = "raise all, names of 24, embedded platform"})
    ->Apply(everySize);

}  // namespace
}  // namespace nidus
