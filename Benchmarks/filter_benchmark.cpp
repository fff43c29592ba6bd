#include <algorithm>
#include <functional>
#include <map>

#include "BenchmarkPlatform.h"
#include "Floors.h"
#include "Measurement.h"

namespace nidus {
namespace {

using Filter = VAHASearchCriteriaFilter;

/// What is filtered: a snapshot and, for the floors, the same texts in flat records.
class FilterInput {
 public:
  explicit FilterInput(const HomeShape& shape)
      : platform_(BenchmarkPlatform::Kind::light, shape),
        command_(platform_.commandWithSnapshot()) {
    NDDictionaryList list;
    for (const auto& record : command_->nidusObjects()) list.emplace_back(record.dictionary());
    records_ = flatRecords(list);
    // A service's zone is that of its room, so that the floor has eight keys to compare.
    std::map<std::string, std::string> zones;
    for (const FlatRecord& record : records_) {
      if (record.entityType == "ROOM") zones[record.name] = record.zone;
    }
    for (FlatRecord& record : records_) {
      if (record.entityType == "SERVICE") record.zone = zones[record.room];
    }
  }

  [[nodiscard]] std::size_t found(const Filter& filter) const {
    return command_->objectsWithSearchFilter_inHome(filter, filter.homeName())->size();
  }
  [[nodiscard]] const FlatRecords& records() const { return records_; }
  /// The last service that is in a group: whoever looks for it passes all before it.
  [[nodiscard]] const FlatRecord& lastOfAGroup() const {
    const auto last = std::find_if(records_.rbegin(), records_.rend(),
                                   [](const FlatRecord& record) { return !record.group.empty(); });
    return last == records_.rend() ? records_.front() : *last;
  }

 private:
  const BenchmarkPlatform platform_;
  const std::shared_ptr<NDAssistantCommand> command_;
  FlatRecords records_;
};

/// Measures `filter` beside its floor, both of which must find something.
void measure(benchmark::State& state, const FilterInput& input, const Filter& filter,
             const std::function<std::size_t()>& floor, const Row& row) {
  if (input.found(filter) == 0 || floor() == 0) {
    state.SkipWithError("the filter finds nothing");
    return;
  }
  measureRow(
      state, row, [&] { benchmark::DoNotOptimize(input.found(filter)); },
      [&floor] { benchmark::DoNotOptimize(floor()); });
}

HomeShape shapeOf(const benchmark::State& state, std::size_t nameLength) {
  return {static_cast<std::size_t>(state.range(0)), nameLength};
}

/// All fields, a scene's name included, which is that of the service: nothing is left out, and
/// nothing gets lost before the last field.
void BM_FilterByAll(benchmark::State& state, std::size_t nameLength, const Row& row) {
  const FilterInput input(shapeOf(state, nameLength));
  const FlatRecord& wanted = input.lastOfAGroup();
  Filter filter;
  filter.setHomeName(wanted.home);
  filter.setEntityType(wanted.entityType);
  filter.setServiceType("LIGHT");
  filter.setRoomName(wanted.room);
  filter.setZoneName(wanted.zone);
  filter.setGroupName(wanted.group);
  filter.setServiceName(wanted.name);
  filter.setSceneName(wanted.name);
  filter.setAttribute("BRIGHTNESS");
  measure(
      state, input, filter, [&] { return equalInEightKeys(input.records(), wanted).size(); }, row);
}

/// One field of the filter, and the key that the floor compares for it.
struct Field {
  std::string FlatRecord::*key;
  void (Filter::*set)(NDString);
};

void measureField(benchmark::State& state, const HomeShape& shape, const Field& field,
                  const Row& row) {
  const FilterInput input(shape);
  const std::string& wanted = input.lastOfAGroup().*field.key;
  Filter filter;
  (filter.*field.set)(wanted);
  measure(
      state, input, filter, [&] { return equalInKey(input.records(), field.key, wanted).size(); },
      row);
}

void BM_FilterBy(benchmark::State& state, std::size_t nameLength, const Field& field,
                 const Row& row) {
  measureField(state, shapeOf(state, nameLength), field, row);
}

/// Looks for names with accents by names without.
void BM_FilterByAccent(benchmark::State& state, std::size_t nameLength, const Row& row) {
  HomeShape shape = shapeOf(state, nameLength);
  shape.hasAccents = true;
  const FilterInput input(shape);
  const std::string& wanted = input.lastOfAGroup().name;
  Filter filter;
  const std::string accented = kAccentedServiceWord;
  filter.setServiceName(kServiceWord + wanted.substr(accented.size()));
  measure(
      state, input, filter,
      [&] { return equalInKey(input.records(), &FlatRecord::name, wanted).size(); }, row);
}

constexpr Field kRoom = {&FlatRecord::room, &Filter::setRoomName};
constexpr Field kZone = {&FlatRecord::zone, &Filter::setZoneName};
constexpr Field kGroup = {&FlatRecord::group, &Filter::setGroupName};
constexpr Field kName = {&FlatRecord::name, &Filter::setServiceName};

BENCHMARK_CAPTURE(BM_FilterByAll, 12, 12, Row{.name = "filter by all, names of 12", .goal = 3})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterByAll, 24, 24, Row{.name = "filter by all, names of 24", .goal = 3})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, room_12, 12, kRoom,
                  Row{.name = "filter by room, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, room_24, 24, kRoom,
                  Row{.name = "filter by room, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, zone_12, 12, kZone,
                  Row{.name = "filter by zone, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, zone_24, 24, kZone,
                  Row{.name = "filter by zone, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, group_12, 12, kGroup,
                  Row{.name = "filter by group, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, group_24, 24, kGroup,
                  Row{.name = "filter by group, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, name_12, 12, kName,
                  Row{.name = "filter by name, names of 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterBy, name_24, 24, kName,
                  Row{.name = "filter by name, names of 24", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterByAccent, 12, 12, Row{.name = "filter by name, accents, 12", .goal = 4})
    ->Apply(everySize);
BENCHMARK_CAPTURE(BM_FilterByAccent, 24, 24, Row{.name = "filter by name, accents, 24", .goal = 4})
    ->Apply(everySize);

}  // namespace
}  // namespace nidus
