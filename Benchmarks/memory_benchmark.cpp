#include "BenchmarkPlatform.h"
#include "CountedMemory.h"
#include "Floors.h"
#include "Measurement.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Requests.h"

namespace nidus {
namespace {

constexpr double kBytesPerService = 400;
constexpr int kFurtherCommands = 10;

std::size_t bytesOf(const FlatRecord& record) {
  std::size_t bytes = record.name.size() + record.identifier.size() + record.home.size() +
                      record.room.size() + record.serviceType.size() + record.group.size();
  for (const std::string& type : record.characteristicTypes) bytes += type.size();
  return bytes;
}

BrightnessRequest requestOf(std::size_t services, std::size_t nameLength) {
  return BrightnessRequest(VAHAActionTypeGETValue,
                           numberedName(kServiceWord, services - 1, nameLength));
}

/// The most memory that a command with one target holds, beside 400 bytes a service and the
/// service's texts.
void BM_Memory(benchmark::State& state, std::size_t nameLength, Row row) {
  const auto services = static_cast<std::size_t>(state.range(0));
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light, {services, nameLength});
  const BrightnessRequest request = requestOf(services, nameLength);
  NDDictionaryList list;
  for (const auto& record : platform.gather()->gatherNidusObjects()) {
    list.emplace_back(record.dictionary());
  }
  row.floor = kBytesPerService * static_cast<double>(services);
  for (const FlatRecord& record : flatRecords(list))
    row.floor += static_cast<double>(bytesOf(record));
  benchmark::DoNotOptimize(platform.perform(request));
  for (auto _ : state) {
    const CountedMemory counted;
    benchmark::DoNotOptimize(platform.perform(request));
    row.ours = static_cast<double>(CountedMemory::peak());
    report(state, row);
  }
}

/// What further commands leave behind.
void BM_MemoryGrowth(benchmark::State& state, Row row) {
  const auto services = static_cast<std::size_t>(state.range(0));
  const BenchmarkPlatform platform(BenchmarkPlatform::Kind::light, {services, 24});
  const BrightnessRequest request = requestOf(services, 24);
  benchmark::DoNotOptimize(platform.perform(request));
  for (auto _ : state) {
    const CountedMemory counted;
    for (int i = 0; i < kFurtherCommands; ++i) benchmark::DoNotOptimize(platform.perform(request));
    row.ours = static_cast<double>(CountedMemory::held());
    row.floor = 1;
    report(state, row);
  }
}

BENCHMARK_CAPTURE(BM_Memory, 12, 12,
                  Row{.name = "memory of a command, names of 12", .goal = 1, .unit = Unit::bytes})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_Memory, 24, 24,
                  Row{.name = "memory of a command, names of 24", .goal = 1, .unit = Unit::bytes})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_MemoryGrowth, ten_commands,
                  Row{.name = "memory left by ten commands", .goal = 1, .unit = Unit::bytes})
    ->Arg(1'000)
    ->Iterations(1)
    ->UseManualTime();

}  // namespace
}  // namespace nidus
