#include "HomePlatform/Objects/HomeCalls.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "HomePlatform/Drivers/PlatformErrors.h"
#include "HomePlatform/Objects/CharacteristicObject.h"
#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {

/// A home as the database has it now: null when it is gone, or when the database failed.
struct HomeCalls::CurrentHome {
  std::shared_ptr<const HomeObject> home;
  bool hasFailed = false;
};

namespace {

using Characteristics = std::vector<std::shared_ptr<NDCharacteristic>>;

/// A characteristic of another make is asked for its address; one whose home is gone has none.
CharacteristicAddress addressOf(const NDCharacteristic& characteristic) {
  const auto* own = dynamic_cast<const CharacteristicObject*>(&characteristic);
  if (own) return own->address();
  const auto service = characteristic.service();
  const auto accessory = property(service, &NDService::accessory);
  if (!accessory) return {};
  return {accessory->uuid(), service->instanceID(), characteristic.instanceID()};
}

NDCharacteristicResponse respond(std::shared_ptr<NDCharacteristic> characteristic,
                                 std::int64_t code) {
  if (code == 0) return {std::move(characteristic), std::nullopt};
  return {std::move(characteristic), errorOfCode(code)};
}

void respondAll(Characteristics characteristics, const DriverAnswers& answers,
                const NDBatchCompletion& completion) {
  std::vector<NDCharacteristicResponse> responses;
  responses.reserve(characteristics.size());
  for (std::size_t index = 0; index < characteristics.size(); ++index) {
    responses.push_back(respond(std::move(characteristics[index]), answers[index]));
  }
  completion(std::nullopt, responses);
}

void respondSame(Characteristics characteristics, std::int64_t code,
                 const NDBatchCompletion& completion) {
  const DriverAnswers answers(characteristics.size(), code);
  respondAll(std::move(characteristics), answers, completion);
}

/// Ends a batch that its home answers as a whole; false when the accessories have to.
bool answerAsHome(const HomeObject* home, std::int32_t FaultData::*fault,
                  const NDBatchCompletion& completion) {
  const std::int32_t code = home ? home->data().faults.*fault : 0;
  if (code == 0) return false;
  completion(errorOfCode(code), {});
  return true;
}

/// The values of a scene, in its order.
std::vector<DriverWrite> writesOf(const ActionSetData& actionSet) {
  std::vector<DriverWrite> writes;
  writes.reserve(actionSet.actions.size());
  for (const SceneActionData& action : actionSet.actions) {
    writes.push_back({action.target, action.value});
  }
  return writes;
}

void answerScene(std::int64_t code, const NDExecuteCompletion& completion) {
  completion(code == 0 ? std::nullopt : std::optional<NDError>(errorOfCode(code)));
}

std::int64_t firstError(const DriverAnswers& answers) {
  const auto found =
      std::find_if(answers.begin(), answers.end(), [](std::int64_t code) { return code != 0; });
  return found == answers.end() ? 0 : *found;
}

}  // namespace

void HomeCalls::read(const NDUUID& home, const NDArray<NDCharacteristic>& characteristics,
                     NDBatchCompletion completion) {
  Characteristics asked(characteristics.begin(), characteristics.end());
  std::vector<CharacteristicAddress> targets;
  targets.reserve(asked.size());
  for (const auto& characteristic : asked) targets.push_back(addressOf(*characteristic));
  observe({PlatformCall::Kind::read, home, targets, {}, std::nullopt});
  calls_.async([self = shared_from_this(), home, asked = std::move(asked),
                targets = std::move(targets), completion = std::move(completion)]() mutable {
    const CurrentHome current = self->findHome(home);
    if (current.hasFailed) return respondSame(std::move(asked), kErrorNotKept, completion);
    if (answerAsHome(current.home.get(), &FaultData::read, completion)) return;
    self->parts_.driver->read(home, std::move(targets),
                              [asked = std::move(asked), completion = std::move(completion)](
                                  const DriverAnswers& answers) mutable {
                                respondAll(std::move(asked), answers, completion);
                              });
  });
}

void HomeCalls::write(const NDUUID& home, std::vector<NDCharacteristicWriteRequestTuple> writes,
                      NDBatchCompletion completion) {
  Characteristics asked;
  std::vector<DriverWrite> values;
  PlatformCall call{PlatformCall::Kind::write, home, {}, {}, std::nullopt};
  for (auto& tuple : writes) {
    const CharacteristicAddress address = addressOf(*tuple.characteristic);
    call.characteristics.push_back(address);
    call.values.push_back(tuple.value);
    values.push_back({address, std::move(tuple.value)});
    asked.push_back(std::move(tuple.characteristic));
  }
  observe(call);
  calls_.async([self = shared_from_this(), home, asked = std::move(asked),
                values = std::move(values), completion = std::move(completion)]() mutable {
    const CurrentHome current = self->findHome(home);
    if (current.hasFailed) return respondSame(std::move(asked), kErrorNotKept, completion);
    if (answerAsHome(current.home.get(), &FaultData::write, completion)) return;
    self->parts_.driver->write(home, std::move(values),
                               [asked = std::move(asked), completion = std::move(completion)](
                                   const DriverAnswers& answers) mutable {
                                 respondAll(std::move(asked), answers, completion);
                               });
  });
}

void HomeCalls::execute(const NDUUID& home, const NDUUID& actionSet,
                        NDExecuteCompletion completion) {
  observe({PlatformCall::Kind::execute, home, {}, {}, actionSet});
  calls_.async(
      [self = shared_from_this(), home, actionSet, completion = std::move(completion)]() mutable {
        self->runScene(home, actionSet, std::move(completion));
      });
}

void HomeCalls::runScene(const NDUUID& home, const NDUUID& actionSet,
                         NDExecuteCompletion completion) const {
  const CurrentHome current = findHome(home);
  if (current.hasFailed) return answerScene(kErrorNotKept, completion);
  if (!current.home) return answerScene(kNDErrorUnreachable, completion);
  const auto& all = current.home->data().actionSets;
  const auto found = std::find_if(all.begin(), all.end(), [&actionSet](const ActionSetData& data) {
    return data.uuid == actionSet;
  });
  if (found == all.end()) return answerScene(kNDErrorUnreachable, completion);
  if (found->executeFault != 0) return answerScene(found->executeFault, completion);
  parts_.driver->write(home, writesOf(*found),
                       [completion = std::move(completion)](const DriverAnswers& answers) {
                         answerScene(firstError(answers), completion);
                       });
}

HomeCalls::CurrentHome HomeCalls::findHome(const NDUUID& home) const {
  const Result<std::shared_ptr<const HomeEdition>> edition = parts_.library->current();
  if (edition) return {(*edition)->find(home), false};
  parts_.reportFailure(edition.failure());
  return {nullptr, true};
}

void HomeCalls::observe(const PlatformCall& call) const {
  if (parts_.observer) parts_.observer(call);
}

}  // namespace nidus
