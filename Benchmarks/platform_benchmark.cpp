#include <algorithm>
#include <array>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <limits>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "BenchmarkHome.h"
#include "Floors.h"
#include "HomePlatform/Drivers/SimulatedDriver.h"
#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Store/HomeChanges.h"
#include "HomePlatform/System/CallerQueue.h"
#include "HomePlatform/System/DataFolder.h"
#include "Measurement.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

constexpr std::size_t kNameLength = 24;
constexpr std::size_t kDiskRounds = 20;
/// The one batch that has a goal: a few reads cost what two hops between queues cost, and what a
/// great many cost depends on the caches.
constexpr std::size_t kSizeOfGoal = 1'000;

std::size_t servicesOf(const benchmark::State& state) {
  return static_cast<std::size_t>(state.range(0));
}

HomeData homeOf(const benchmark::State& state) {
  return benchmarkHome({.services = servicesOf(state), .nameLength = kNameLength});
}

/// The brightness of every light.
std::vector<CharacteristicAddress> brightnessIn(const HomeData& home) {
  std::vector<CharacteristicAddress> addresses;
  for (const AccessoryData& accessory : home.accessories) {
    const ServiceData& light = accessory.services.front();
    addresses.push_back({accessory.uuid, light.instanceID, light.characteristics.at(1).instanceID});
  }
  return addresses;
}

std::vector<DriverWrite> writesTo(const std::vector<CharacteristicAddress>& targets, int level) {
  std::vector<DriverWrite> writes;
  writes.reserve(targets.size());
  for (const auto& target : targets) writes.push_back({target, NDValue::integer(level)});
  return writes;
}

std::vector<ValueChange> changesOf(const HomeData& home, const std::vector<DriverWrite>& writes) {
  std::vector<ValueChange> changes;
  changes.reserve(writes.size());
  for (const auto& [target, value] : writes) changes.push_back({home.uuid, target, value, value});
  return changes;
}

/// The simulated accessories of one home, over a database in a file or, without one, in memory.
class Accessories {
 public:
  explicit Accessories(const HomeData& home, const std::optional<std::filesystem::path>& file = {})
      : home_(home.uuid) {
    std::shared_ptr<HomeStore> store = std::move(*HomeStore::open(file));
    if (store->replaceHomes({home})) std::abort();
    library_ = std::make_shared<HomeLibrary>(std::move(store));
    driver_ = std::make_shared<SimulatedDriver>(
        library_, std::make_shared<MetadataMapper>(builtInVocabulary()),
        std::make_shared<DeviceLock>(false), queue_, [](const Failure&) { std::abort(); });
  }

  [[nodiscard]] DriverAnswers read(const std::vector<CharacteristicAddress>& targets) const {
    DriverAnswers answers;
    driver_->read(home_, targets, [&answers](DriverAnswers all) { answers = std::move(all); });
    drain();
    return answers;
  }
  [[nodiscard]] DriverAnswers write(const std::vector<DriverWrite>& writes) const {
    DriverAnswers answers;
    driver_->write(home_, writes, [&answers](DriverAnswers all) { answers = std::move(all); });
    drain();
    return answers;
  }

 private:
  void drain() const {
    while (queue_->runOne()) {
    }
  }

  const NDUUID home_;
  const std::shared_ptr<CallerQueue> queue_ = std::make_shared<CallerQueue>();
  std::shared_ptr<HomeLibrary> library_;
  std::shared_ptr<SimulatedDriver> driver_;
};

/// The response of each device.
std::vector<DeviceResponse> readAll(const AnsweringDevices& devices) {
  std::vector<DeviceResponse> responses;
  responses.reserve(devices.size());
  for (const auto& device : devices) responses.push_back(device->read());
  return responses;
}

void BM_ReadBatch(benchmark::State& state) {
  const HomeData home = homeOf(state);
  const auto targets = brightnessIn(home);
  const Accessories accessories(home);
  if (accessories.read(targets) != DriverAnswers(targets.size(), 0)) {
    return state.SkipWithError("not all were read");
  }
  const AnsweringDevices devices = answeringDevices(targets.size());
  Row row{.name = "batch of reads, simulated driver", .goal = 5};
  if (targets.size() != kSizeOfGoal) row.goal = 0;
  measureRow(
      state, row, [&] { benchmark::DoNotOptimize(accessories.read(targets).data()); },
      [&devices] { benchmark::DoNotOptimize(readAll(devices).data()); });
}
BENCHMARK(BM_ReadBatch)->Apply(everySizeTo10000);

/// The time that passes while `work` runs, in nanoseconds, the wait for the disk included.
double timePassed(const Work& work) {
  const auto begin = std::chrono::steady_clock::now();
  work();
  const auto passed = std::chrono::steady_clock::now() - begin;
  return static_cast<double>(std::chrono::nanoseconds(passed).count());
}

/// A batch of writes beside the commit of the same values alone, each in a database of its own. Two
/// values take turns: what is there already would not reach the disk.
void BM_WriteBatch(benchmark::State& state) {
  const TestFolder ours;
  const TestFolder floor;
  const HomeData home = homeOf(state);
  const auto targets = brightnessIn(home);
  const std::array writes = {writesTo(targets, 30), writesTo(targets, 70)};
  const std::array changes = {changesOf(home, writes[0]), changesOf(home, writes[1])};
  const Accessories accessories(home, ours.file(kDatabaseFile));
  if (accessories.write(writes[1]) != DriverAnswers(targets.size(), 0)) {
    return state.SkipWithError("not all were written");
  }
  { const Accessories written(home, floor.file(kDatabaseFile)); }
  Database database(floor.file(kDatabaseFile), std::chrono::seconds(1));
  ValueWriter writer(database);
  Row row{.name = "batch of writes / its commit to disk", .floorPower = std::nullopt};
  row.ours = row.floor = std::numeric_limits<double>::infinity();
  for (auto _ : state) {
    for (std::size_t round = 0; round < kDiskRounds; ++round) {
      row.ours = std::min(row.ours, timePassed([&] {
                            benchmark::DoNotOptimize(accessories.write(writes[round % 2]).data());
                          }));
      Transaction transaction(database, Transaction::Kind::writing);
      writer.write(changes[round % 2]);
      row.floor = std::min(row.floor, timePassed([&transaction] { transaction.commit(); }));
    }
    report(state, row);
  }
}
BENCHMARK(BM_WriteBatch)->Apply(everySizeTo10000);

/// Steps through all rows that a load needs, and looks at none.
std::int64_t rowsOf(const std::string& file) {
  constexpr std::array kQueries = {
      "SELECT * FROM home ORDER BY position",
      "SELECT * FROM room ORDER BY home, position",
      "SELECT * FROM zone ORDER BY home, position",
      "SELECT * FROM zone_room JOIN room ON room.id = room ORDER BY zone, zone_room.position",
      "SELECT * FROM accessory LEFT JOIN room ON room.id = room "
      "ORDER BY accessory.home, accessory.position",
      "SELECT * FROM service ORDER BY accessory, position",
      "SELECT * FROM characteristic ORDER BY service, position",
      "SELECT * FROM service_group ORDER BY home, position",
      "SELECT * FROM service_group_member AS member JOIN service ON service.id = member.service "
      "JOIN accessory ON accessory.id = accessory ORDER BY service_group, member.position"};
  Database database(file, std::chrono::seconds(1));
  std::int64_t rows = 0;
  for (const char* query : kQueries) {
    Statement statement(database, query);
    while (statement.step()) ++rows;
  }
  return rows;
}

/// Opens the platform of a data folder and gives the number of homes that it reports.
std::size_t homesReported(const TestFolder& folder) {
  HomePlatformOptions options{.dataFolder = folder.path(), .drainsOnCaller = true, .metric = true};
  options.logSink = [](const NDSystemLogMessage&) {};
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) return 0;
  const auto manager = (*platform)->createHomeManager();
  (*platform)->drain();
  const std::size_t homes = manager->homes().size();
  (*platform)->shutDown();
  return homes;
}

void BM_OpenAndReport(benchmark::State& state) {
  const TestFolder folder;
  { const Accessories written(homeOf(state), folder.file(kDatabaseFile)); }
  if (homesReported(folder) != 1) return state.SkipWithError("not one home");
  Row row{.name = "open a database, report its homes", .goal = 8};
  if (servicesOf(state) < 10'000) row.goal = 0;
  measureRow(
      state, row, [&folder] { benchmark::DoNotOptimize(homesReported(folder)); },
      [&folder] { benchmark::DoNotOptimize(rowsOf(folder.file(kDatabaseFile))); });
}
BENCHMARK(BM_OpenAndReport)->Apply(everySizeTo10000);

}  // namespace
}  // namespace nidus
