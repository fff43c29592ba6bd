#include "HomePlatform/Drivers/SimulatedDriver.h"

#include <utility>

#include "HomePlatform/Drivers/PlatformErrors.h"
#include "HomePlatform/Objects/AccessoryObject.h"
#include "HomePlatform/Objects/CharacteristicObject.h"
#include "HomePlatform/Objects/HomeEdition.h"
#include "HomePlatform/Objects/HomeObject.h"
#include "HomePlatform/Objects/ServiceObject.h"
#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDLookUp.h"

namespace nidus {

/// One batch while it runs.
struct SimulatedDriver::Batch {
  NDUUID homeID;
  std::shared_ptr<const HomeEdition> edition = nullptr;
  const HomeObject* home = nullptr;  ///< Null when there is no such home.
  std::size_t near = 0;              ///< Where in the home the last accessory was found.
  DriverAnswers answers = {};
  std::vector<ValueChange> changes = {};
  std::vector<std::pair<std::size_t, CharacteristicAddress>> kept = {};  ///< What needs `changes`.
};

/// A characteristic with the accessory that answers for it.
struct SimulatedDriver::Target {
  const AccessoryData& accessory;
  const ServiceObject& service;
  const CharacteristicData& characteristic;
  const CharacteristicObject& object;
};

namespace {

constexpr std::int64_t kSuccess = 0;

NDValueRef convert(const CharacteristicData& characteristic, const NDValueRef& value) {
  return convertToFormat(value,
                         characteristic.metadata ? characteristic.metadata->format : nullptr);
}

/// A limit that is not a number limits nothing, because it compares neither way.
bool isOutOfRange(const CharacteristicData& characteristic, const NDValue& value) {
  const auto& metadata = characteristic.metadata;
  return metadata && (value.compare(metadata->minimumValue) == std::partial_ordering::less ||
                      value.compare(metadata->maximumValue) == std::partial_ordering::greater);
}

}  // namespace

SimulatedDriver::SimulatedDriver(std::shared_ptr<HomeLibrary> library,
                                 std::shared_ptr<const MetadataMapper> mapper,
                                 std::shared_ptr<const DeviceLock> deviceLock,
                                 std::shared_ptr<NDQueue> queue,
                                 std::function<void(const Failure&)> reportFailure)
    : library_(std::move(library)),
      mapper_(std::move(mapper)),
      deviceLock_(std::move(deviceLock)),
      queue_(std::move(queue)),
      reportFailure_(std::move(reportFailure)),
      batches_("com.corvane.nidus.simulated-accessories", queue_) {}

void SimulatedDriver::read(const NDUUID& home, std::vector<CharacteristicAddress> targets,
                           DriverCompletion completion) {
  batches_.async([self = shared_from_this(), home, targets = std::move(targets),
                  completion = std::move(completion)] {
    self->queue_->async([completion, answers = self->readBatch(home, targets)]() mutable {
      completion(std::move(answers));
    });
  });
}

void SimulatedDriver::write(const NDUUID& home, std::vector<DriverWrite> writes,
                            DriverCompletion completion) {
  batches_.async([self = shared_from_this(), home, writes = std::move(writes),
                  completion = std::move(completion)] {
    self->queue_->async([completion, answers = self->writeBatch(home, writes)]() mutable {
      completion(std::move(answers));
    });
  });
}

/// Finds the home as the database has it now; false when the database fails.
bool SimulatedDriver::begin(Batch& batch) const {
  Result<std::shared_ptr<const HomeEdition>> edition = library_->current();
  if (!edition) {
    reportFailure_(edition.failure());
    return false;
  }
  batch.edition = std::move(*edition);
  batch.home = batch.edition->find(batch.homeID).get();
  batch.near = 0;
  return true;
}

DriverAnswers SimulatedDriver::readBatch(const NDUUID& home,
                                         const std::vector<CharacteristicAddress>& targets) const {
  for (;;) {
    Batch batch{home};
    if (!begin(batch)) return DriverAnswers(targets.size(), kErrorNotKept);
    batch.answers.reserve(targets.size());
    for (const auto& target : targets) batch.answers.push_back(readOne(batch, target));
    // A value that another process has written meanwhile must not stay covered by an older one.
    if (!keep(batch) || !isOutdated(batch)) return std::move(batch.answers);
  }
}

DriverAnswers SimulatedDriver::writeBatch(const NDUUID& home,
                                          const std::vector<DriverWrite>& writes) const {
  Batch batch{home};
  if (!begin(batch)) return DriverAnswers(writes.size(), kErrorNotKept);
  batch.answers.reserve(writes.size());
  for (const auto& write : writes) batch.answers.push_back(writeOne(batch, write));
  if (keep(batch) && isOutdated(batch)) answerGoneTargets(batch);
  return std::move(batch.answers);
}

FoundCharacteristic SimulatedDriver::find(Batch& batch, const CharacteristicAddress& address) {
  return batch.home ? batch.home->find(address, batch.near) : FoundCharacteristic();
}

/// What stands before a read and a write alike.
std::int64_t SimulatedDriver::refusal(const Target& target, std::int32_t FaultData::*fault) const {
  if (const std::int32_t code = target.characteristic.faults.*fault) return code;
  if (const std::int32_t code = target.accessory.faults.*fault) return code;
  if (!target.accessory.reachable) return kNDErrorUnreachable;
  if (target.accessory.requiresUnlock && deviceLock_->isLocked()) return kNDErrorMustUnlock;
  return kSuccess;
}

std::int64_t SimulatedDriver::readOne(Batch& batch, const CharacteristicAddress& address) const {
  const FoundCharacteristic found = find(batch, address);
  if (!found.characteristic) return kNDErrorUnreachable;
  const Target target{found.accessory->data(), *found.service, found.characteristic->data(),
                      *found.characteristic};
  if (const std::int64_t code = refusal(target, &FaultData::read)) return code;
  if (!target.object.isReadable()) return kNDErrorNotReadable;
  if (!target.object.isCurrent()) {
    batch.kept.emplace_back(batch.answers.size(), address);
    batch.changes.push_back(
        {batch.homeID, address, target.object.values().deviceValue, std::nullopt});
  }
  return kSuccess;
}

std::int64_t SimulatedDriver::writeOne(Batch& batch, const DriverWrite& write) const {
  const FoundCharacteristic found = find(batch, write.target);
  if (!found.characteristic) return kNDErrorUnreachable;
  const Target target{found.accessory->data(), *found.service, found.characteristic->data(),
                      *found.characteristic};
  if (const std::int64_t code = refusal(target, &FaultData::write)) return code;
  if (!target.object.isWritable()) return kNDErrorNotWritable;
  const NDValueRef value = convert(target.characteristic, write.value);
  if (!value) return kNDErrorWrongType;
  if (isOutOfRange(target.characteristic, *value)) return kNDErrorOutOfRange;
  batch.kept.emplace_back(batch.answers.size(), write.target);
  batch.changes.push_back({batch.homeID, write.target, value, value});
  follow(batch, target, value);
  return kSuccess;
}

/// Gives what was written to the characteristic that follows it, where it fits.
void SimulatedDriver::follow(Batch& batch, const Target& written, const NDValueRef& value) const {
  const NDString type = mapper_->followingType(written.characteristic.characteristicType);
  const auto follower = findInArrayByCharacteristicType(written.service.characteristics(), type);
  if (!follower) return;
  const auto& object = static_cast<const CharacteristicObject&>(*follower);
  const NDValueRef followed = convert(object.data(), value);
  if (followed) batch.changes.push_back({batch.homeID, object.address(), followed, followed});
}

/// Keeps what the batch has changed in one transaction; false when nothing was kept. Nothing is
/// answered as done that was not kept.
bool SimulatedDriver::keep(Batch& batch) const {
  if (batch.changes.empty()) return false;
  const Status failure = library_->keep(batch.changes);
  if (!failure) return true;
  reportFailure_(*failure);
  for (const auto& [index, address] : batch.kept) batch.answers[index] = kErrorNotKept;
  return false;
}

/// Says whether the database has been changed by others since the batch began. One that fails now
/// has taken the values all the same.
bool SimulatedDriver::isOutdated(const Batch& batch) const {
  const Result<std::shared_ptr<const HomeEdition>> edition = library_->current();
  return edition && *edition != batch.edition;
}

/// Values of what is no longer there were passed over.
void SimulatedDriver::answerGoneTargets(Batch& batch) const {
  if (!begin(batch)) return;
  for (const auto& [index, address] : batch.kept) {
    if (!find(batch, address).characteristic) batch.answers[index] = kNDErrorUnreachable;
  }
}

}  // namespace nidus
