#pragma once

#include <memory>

#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {

class NDHome;

/// A named set of services. Implemented by the platform; owned by its home; immutable; may be
/// read from any thread. Equality is identity.
class ND_EXPORT NDServiceGroup {
 public:
  virtual ~NDServiceGroup();
  /// Unique within the home.
  [[nodiscard]] virtual const NDUUID& uuid() const = 0;
  /// Never null.
  [[nodiscard]] virtual const NDString& name() const = 0;
  /// The same objects as in the lists of the accessories.
  [[nodiscard]] virtual const NDArray<NDService>& services() const = 0;
  /// Null once the home is gone.
  [[nodiscard]] virtual std::shared_ptr<NDHome> home() const = 0;
};

}  // namespace nidus
