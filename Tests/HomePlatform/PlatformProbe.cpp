#include "HomePlatform/PlatformProbe.h"

#include <utility>

#include "PlatformModel/Home/NDLookUp.h"

namespace nidus {
namespace {

NDBatchCompletion recordInto(const std::shared_ptr<BatchAnswer>& answer) {
  return [answer](const std::optional<NDError>& error,
                  const std::vector<NDCharacteristicResponse>& responses) {
    ++answer->calls;
    answer->error = error ? error->code : 0;
    for (const auto& response : responses) {
      answer->codes.push_back(response.error ? response.error->code : 0);
    }
  };
}

}  // namespace

OpenPlatform::OpenPlatform(HomePlatformOptions options) {
  auto opened = HomePlatform::open(std::move(options));
  if (opened) {
    platform_ = *opened;
  } else {
    ADD_FAILURE() << opened.failure().message;
  }
}

OpenPlatform::~OpenPlatform() {
  if (platform_) platform_->shutDown();
}

NDArray<NDHome> OpenPlatform::homes() const {
  const auto delegate = std::make_shared<DelegateProbe>();
  const auto manager = platform_->createHomeManager();
  manager->setDelegate(delegate);
  platform_->drain();
  return manager->homes();
}

std::shared_ptr<NDCharacteristic> characteristicAt(const std::shared_ptr<NDHome>& home,
                                                   const CharacteristicAddress& address) {
  const auto accessory = findInArrayByUUID(home->accessories(), address.accessory);
  if (!accessory) return nullptr;
  const auto service = findInArrayByInstanceID(accessory->services(), address.service);
  if (!service) return nullptr;
  return findInArrayByInstanceID(service->characteristics(), address.characteristic);
}

BatchAnswer read(HomePlatform& platform, const std::shared_ptr<NDHome>& home,
                 const std::vector<CharacteristicAddress>& targets) {
  std::vector<std::shared_ptr<NDCharacteristic>> asked;
  for (const auto& target : targets) asked.push_back(characteristicAt(home, target));
  const auto answer = std::make_shared<BatchAnswer>();
  home->readCharacteristicValues_withCompletionHandler(NDArray<NDCharacteristic>(std::move(asked)),
                                                       recordInto(answer));
  platform.drain();
  return *answer;
}

BatchAnswer write(HomePlatform& platform, const std::shared_ptr<NDHome>& home,
                  const std::vector<Write>& writes) {
  std::vector<NDCharacteristicWriteRequestTuple> tuples;
  for (const auto& [target, value] : writes) {
    tuples.push_back({characteristicAt(home, target), value});
  }
  const auto answer = std::make_shared<BatchAnswer>();
  home->writeCharacteristicValues_withCompletionHandler(std::move(tuples), recordInto(answer));
  platform.drain();
  return *answer;
}

std::int64_t execute(HomePlatform& platform, const std::shared_ptr<NDHome>& home) {
  const auto code = std::make_shared<std::int64_t>(-1);
  home->executeActionSet_completionHandler(
      home->actionSets()[0],
      [code](const std::optional<NDError>& error) { *code = error ? error->code : 0; });
  platform.drain();
  return *code;
}

std::string storedValues(HomePlatform& platform, const CharacteristicAddress& address) {
  const auto homes = platform.exportHomes();
  if (!homes) return homes.failure().message;
  for (const auto& accessory : homes->front().accessories) {
    if (accessory.uuid != address.accessory) continue;
    for (const auto& characteristic : accessory.services.front().characteristics) {
      if (characteristic.instanceID != address.characteristic) continue;
      return description(characteristic.value) + '/' + description(characteristic.deviceValue);
    }
  }
  return "gone";
}

}  // namespace nidus
