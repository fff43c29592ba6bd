#pragma once

#include <memory>
#include <unordered_map>

#include "Assistant/HomeObjectRecord.h"
#include "Assistant/ListIndex.h"
#include "Assistant/NDAssistantGather.h"
#include "PlatformModel/Home/NDHome.h"

namespace nidus {

/// Finds the live services of many records, each as `serviceFromObject` finds it: among the homes
/// that the gatherer's manager has at that moment. What it costs grows with the homes and the
/// records, not with one times the other. Not synchronised.
///
///     ServiceLookUp lookUp(gather);
///     for (const HomeObjectRecord* object : objects) use(lookUp.service(*object));
class ServiceLookUp {
 public:
  /// `gather` may be null, and then nothing is found.
  explicit ServiceLookUp(std::shared_ptr<NDAssistantGather> gather);

  /// The service of `record`; null when it is not there or the record is of another kind.
  [[nodiscard]] std::shared_ptr<NDService> service(const HomeObjectRecord& record);

 private:
  const std::shared_ptr<NDAssistantGather> gather_;
  ListIndex<NDHome, &NDHome::uuid> homes_;
  std::unordered_map<const NDHome*, ListIndex<NDAccessory, &NDAccessory::uuid>> accessories_;
  // Of one accessory at a time: its services come one after the other.
  ListIndex<NDService, &NDService::instanceID> services_;
};

}  // namespace nidus
