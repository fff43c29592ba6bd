#pragma once

#include <memory>

#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

class NDHomeManager;

/// Hears from a home manager. Called on a thread of the platform.
class ND_EXPORT NDHomeManagerDelegate {
 public:
  virtual ~NDHomeManagerDelegate();
  /// The homes of `manager` (never null) have been loaded or replaced.
  virtual void homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) = 0;
  /// The platform is being shut down and will never report homes again: whoever waits for them
  /// lets go of what it keeps for that, without calling it. `manager` is never null.
  virtual void homeManagerWillNotUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) = 0;
};

/// Loads the homes and keeps them. Implemented by the platform.
///
/// Creating one starts the load. The delegate then hears of the homes on a thread of the platform,
/// but never before the innermost `NDDeliveryHold` under which the manager was created is released.
class ND_EXPORT NDHomeManager {
 public:
  virtual ~NDHomeManager();
  /// The homes as they stand now, in a stable order; empty before the first update. May be called
  /// from any thread.
  [[nodiscard]] virtual NDArray<NDHome> homes() const = 0;
  /// Sets who hears of updates; it is not kept alive. To be called once, by the thread that created
  /// the manager, before its delivery hold ends.
  virtual void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) = 0;

  /// Creates a manager of the registered platform; null when none is registered.
  [[nodiscard]] static std::shared_ptr<NDHomeManager> create();
};

/// The path of the container that holds the home configuration; null when no platform is
/// registered. May be called from any thread.
[[nodiscard]] ND_EXPORT NDString getHomeConfigurationPath();

}  // namespace nidus
