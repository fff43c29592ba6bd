#pragma once

#include <functional>
#include <memory>

#include "HomePlatform/Drivers/AccessoryDriver.h"
#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Objects/HomeLibrary.h"
#include "HomePlatform/System/DeviceLock.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDSerialQueue.h"

namespace nidus {

/// Accessories that are there in the home database alone: they answer what it says of them, faults
/// included. May be used from any thread.
///
/// Batches run one after another, so that each sees what the one before has kept; completions run
/// on the platform's queue, beside each other.
class SimulatedDriver final : public AccessoryDriver,
                              public std::enable_shared_from_this<SimulatedDriver> {
 public:
  /// None of the references is null. `reportFailure` hears of a database that fails; never empty.
  SimulatedDriver(std::shared_ptr<HomeLibrary> library,
                  std::shared_ptr<const MetadataMapper> mapper,
                  std::shared_ptr<const DeviceLock> deviceLock, std::shared_ptr<NDQueue> queue,
                  std::function<void(const Failure&)> reportFailure);

  void read(const NDUUID& home, std::vector<CharacteristicAddress> targets,
            DriverCompletion completion) override;
  void write(const NDUUID& home, std::vector<DriverWrite> writes,
             DriverCompletion completion) override;

 private:
  struct Batch;
  struct Target;

  [[nodiscard]] bool begin(Batch& batch) const;
  [[nodiscard]] DriverAnswers readBatch(const NDUUID& home,
                                        const std::vector<CharacteristicAddress>& targets) const;
  [[nodiscard]] DriverAnswers writeBatch(const NDUUID& home,
                                         const std::vector<DriverWrite>& writes) const;
  [[nodiscard]] static FoundCharacteristic find(Batch& batch, const CharacteristicAddress& address);
  [[nodiscard]] std::int64_t refusal(const Target& target, std::int32_t FaultData::*fault) const;
  [[nodiscard]] std::int64_t readOne(Batch& batch, const CharacteristicAddress& address) const;
  [[nodiscard]] std::int64_t writeOne(Batch& batch, const DriverWrite& write) const;
  void follow(Batch& batch, const Target& written, const NDValueRef& value) const;
  [[nodiscard]] bool keep(Batch& batch) const;
  [[nodiscard]] bool isOutdated(const Batch& batch) const;
  void answerGoneTargets(Batch& batch) const;

  const std::shared_ptr<HomeLibrary> library_;
  const std::shared_ptr<const MetadataMapper> mapper_;
  const std::shared_ptr<const DeviceLock> deviceLock_;
  const std::shared_ptr<NDQueue> queue_;
  const std::function<void(const Failure&)> reportFailure_;
  NDSerialQueue batches_;
};

}  // namespace nidus
