#pragma once

#include <memory>
#include <vector>

#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/Home/NDActionSet.h"
#include "PlatformModel/Home/NDCharacteristicBatch.h"
#include "PlatformModel/Home/NDRoom.h"
#include "PlatformModel/Home/NDServiceGroup.h"
#include "PlatformModel/Home/NDTrigger.h"
#include "PlatformModel/Home/NDZone.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {

/// A home with all that is in it. Implemented by the platform; immutable but for the cached values;
/// may be read, and asked to read, write and run, from any thread. It stays alive as long as the
/// list of the manager that reported it.
class ND_EXPORT NDHome {
 public:
  virtual ~NDHome();
  /// Unique among all homes.
  [[nodiscard]] virtual const NDUUID& uuid() const = 0;
  /// Never null; may be the name of another home or of a room too.
  [[nodiscard]] virtual const NDString& name() const = 0;
  [[nodiscard]] virtual bool isPrimary() const = 0;
  [[nodiscard]] virtual const NDArray<NDAccessory>& accessories() const = 0;
  [[nodiscard]] virtual const NDArray<NDServiceGroup>& serviceGroups() const = 0;
  [[nodiscard]] virtual const NDArray<NDRoom>& rooms() const = 0;
  [[nodiscard]] virtual const NDArray<NDZone>& zones() const = 0;
  [[nodiscard]] virtual const NDArray<NDActionSet>& actionSets() const = 0;
  [[nodiscard]] virtual const NDArray<NDTrigger>& triggers() const = 0;

  /// Reads the values of `characteristics`, all of this home, from their accessories; the cached
  /// values of those that succeed follow. Returns at once; `completion` runs later, on a thread of
  /// the platform, never inside the call.
  virtual void readCharacteristicValues_withCompletionHandler(
      NDArray<NDCharacteristic> characteristics, NDBatchCompletion completion) = 0;

  /// Writes `writes`, all of this home. What is answered as written has been kept. Otherwise as
  /// above.
  virtual void writeCharacteristicValues_withCompletionHandler(
      std::vector<NDCharacteristicWriteRequestTuple> writes, NDBatchCompletion completion) = 0;

  /// Runs a scene of this home; never null. Otherwise as above.
  virtual void executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                                  NDExecuteCompletion completion) = 0;
};

}  // namespace nidus
