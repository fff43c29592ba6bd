#include "Load/UnrulyHome.h"

#include <algorithm>
#include <array>
#include <utility>

#include "PlatformModel/Home/NDError.h"
#include "Support/HomeBuilder.h"

namespace nidus {
namespace {

constexpr std::int64_t kSomeOtherError = 1;

/// A completion that enters the answer into the ledger, and does what follows from it for the same
/// command.
NDBatchCompletion entered(Ledger::Kind kind, NDBatchCompletion completion) {
  auto ledger = Ledger::current();
  ledger->asked(kind);
  return [ledger = std::move(ledger), kind, completion = std::move(completion)](
             const std::optional<NDError>& error,
             const std::vector<NDCharacteristicResponse>& responses) {
    const Ledger::Scope scope(ledger);
    ledger->batchAnswered(kind, error, responses);
    completion(error, responses);
  };
}

CharacteristicSpec specOf(const CharacteristicData& data) {
  CharacteristicSpec spec(data.characteristicType.view());
  spec.value(data.value).properties(data.properties).instanceID(data.instanceID);
  spec.format(data.metadata->format).units(data.metadata->units);
  spec.limits(data.metadata->minimumValue, data.metadata->maximumValue);
  return spec;
}

void addLamp(HomeBuilder& builder, const AccessoryData& lamp) {
  const ServiceData& light = lamp.services.front();
  HomeBuilder::Characteristics specs;
  for (const auto& characteristic : light.characteristics) specs.push_back(specOf(characteristic));
  builder.uuid(lamp.uuid).light(light.name, specs).serviceID(light.instanceID);
}

void addRooms(HomeBuilder& builder, const HomeData& data) {
  for (const RoomData& room : data.rooms) {
    builder.uuid(room.uuid).room(room.name);
    for (const AccessoryData& lamp : data.accessories) {
      if (lamp.room == room.uuid) addLamp(builder, lamp);
    }
  }
  builder.inNoRoom();
  for (const AccessoryData& lamp : data.accessories) {
    if (!lamp.room) addLamp(builder, lamp);
  }
}

void addRest(HomeBuilder& builder, const HomeData& data) {
  for (const ServiceGroupData& group : data.serviceGroups) {
    HomeBuilder::Names lamps;
    for (const AccessoryData& lamp : data.accessories) {
      const ServiceAddress address{lamp.uuid, lamp.services.front().instanceID};
      const auto& members = group.services;
      if (std::find(members.begin(), members.end(), address) != members.end()) {
        lamps.push_back(lamp.name);
      }
    }
    builder.uuid(group.uuid).group(group.name, lamps);
  }
  for (const ActionSetData& scene : data.actionSets) builder.uuid(scene.uuid).scene(scene.name);
}

void failAlways(const TestHome& home, const AccessoryData& lamp, std::int64_t code) {
  for (const auto& data : lamp.services.front().characteristics) {
    const auto object = home.characteristic(lamp.name.view(), data.characteristicType.view());
    object->failReads(code);
    object->failWrites(code);
  }
}

void failAsAWhole(TestHome& home, Random& random) {
  constexpr std::array kCodes = {kNDErrorMustUnlock, kNDErrorUnreachable, kSomeOtherError};
  const std::int64_t code = kCodes.at(random.below(kCodes.size()));
  if (random.oneIn(16)) home.failReads(code);
  if (random.oneIn(16)) home.failWrites(code);
  if (random.oneIn(4)) home.failExecutions(code);
}

}  // namespace

std::shared_ptr<UnrulyHome> UnrulyHome::make(const HomeData& data, Random& random,
                                             std::shared_ptr<NDQueue> queue) {
  auto home = std::make_shared<UnrulyHome>(data.uuid, data.name, false);
  HomeBuilder builder(home);
  if (data.primary) builder.primary();
  addRooms(builder, data);
  addRest(builder, data);
  for (const AccessoryData& lamp : data.accessories) {
    if (lamp.requiresUnlock) failAlways(*home, lamp, kNDErrorMustUnlock);
    if (!lamp.reachable) failAlways(*home, lamp, kNDErrorUnreachable);
  }
  failAsAWhole(*home, random);
  home->answerOn(std::move(queue));
  return home;
}

void UnrulyHome::readCharacteristicValues_withCompletionHandler(
    NDArray<NDCharacteristic> characteristics, NDBatchCompletion completion) {
  TestHome::readCharacteristicValues_withCompletionHandler(
      std::move(characteristics), entered(&PlatformFacts::reads, std::move(completion)));
}

void UnrulyHome::writeCharacteristicValues_withCompletionHandler(Writes writes,
                                                                 NDBatchCompletion completion) {
  TestHome::writeCharacteristicValues_withCompletionHandler(
      std::move(writes), entered(&PlatformFacts::writes, std::move(completion)));
}

void UnrulyHome::executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                                    NDExecuteCompletion completion) {
  auto ledger = Ledger::current();
  ledger->asked(&PlatformFacts::executions);
  TestHome::executeActionSet_completionHandler(
      std::move(actionSet), [ledger = std::move(ledger), completion = std::move(completion)](
                                const std::optional<NDError>& error) {
        const Ledger::Scope scope(ledger);
        ledger->executionAnswered(error);
        completion(error);
      });
}

}  // namespace nidus
