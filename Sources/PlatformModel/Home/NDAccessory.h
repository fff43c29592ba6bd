#pragma once

#include <memory>

#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {

class NDHome;
class NDRoom;

/// A device of a home. Implemented by the platform; owned by its home; immutable; may be read from
/// any thread.
class ND_EXPORT NDAccessory {
 public:
  virtual ~NDAccessory();
  /// Unique within the home.
  [[nodiscard]] virtual const NDUUID& uuid() const = 0;
  /// Never null.
  [[nodiscard]] virtual const NDString& name() const = 0;
  [[nodiscard]] virtual const NDArray<NDService>& services() const = 0;
  /// The room in which the device stands; a device in no room stands in the home's default room,
  /// which bears the home's name and is not among the home's rooms. Null once the home is gone.
  [[nodiscard]] virtual std::shared_ptr<NDRoom> room() const = 0;
  /// Null once the home is gone.
  [[nodiscard]] virtual std::shared_ptr<NDHome> home() const = 0;
};

}  // namespace nidus
