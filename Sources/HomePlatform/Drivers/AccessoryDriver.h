#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {

/// A value on its way to an accessory.
struct DriverWrite {
  CharacteristicAddress target;
  NDValueRef value;  ///< As it was given: the driver converts and judges it; may be null.
};

/// One error code per characteristic of a batch, in the order asked; 0 is success.
using DriverAnswers = std::vector<std::int64_t>;
using DriverCompletion = std::function<void(DriverAnswers)>;

/// Speaks with accessories.
///
/// Batches may be asked for from any thread and may overlap. Their answers come when the
/// accessories give them: late, out of order, on any thread of the platform, never inside the call.
/// A completion runs exactly once, or, when the platform is shut down, is destroyed. That an
/// accessory could be reached once says nothing of the next time: whoever cannot be reached is
/// answered with `kNDErrorUnreachable`.
///
/// A driver hands what it learns to a `ValueKeeper`: the values of a batch before it answers, so
/// that what is answered as written has been kept, and at any other time what an accessory reports
/// by itself.
class AccessoryDriver {
 public:
  virtual ~AccessoryDriver() = default;

  /// Reads `targets`, which may be empty and may repeat, of the home `home`.
  virtual void read(const NDUUID& home, std::vector<CharacteristicAddress> targets,
                    DriverCompletion completion) = 0;
  /// Writes `writes`, in order, which may be empty and may repeat a target, in the home `home`.
  virtual void write(const NDUUID& home, std::vector<DriverWrite> writes,
                     DriverCompletion completion) = 0;
};

}  // namespace nidus
