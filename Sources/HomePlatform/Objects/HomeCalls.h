#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "HomePlatform/Drivers/AccessoryDriver.h"
#include "HomePlatform/Objects/HomeLibrary.h"
#include "HomePlatform/PlatformCall.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDSerialQueue.h"

namespace nidus {

/// What homes are asked to do: answers what concerns a home as a whole, and hands the rest to the
/// driver of its accessories. May be used from any thread.
class HomeCalls : public std::enable_shared_from_this<HomeCalls> {
 public:
  /// What the calls stand on. `observer` may be empty; nothing else is null or empty.
  struct Parts {
    std::shared_ptr<HomeLibrary> library;
    std::shared_ptr<AccessoryDriver> driver;
    std::shared_ptr<NDQueue> queue;
    std::function<void(const PlatformCall&)> observer;
    std::function<void(const Failure&)> reportFailure;
  };
  explicit HomeCalls(Parts parts)
      : parts_(std::move(parts)), calls_("com.corvane.nidus.home-calls", parts_.queue) {}

  /// Each returns at once; calls reach the driver in the order in which they were made. The
  /// completion runs on the queue, exactly once, or is destroyed when the queue is shut down.
  void read(const NDUUID& home, const NDArray<NDCharacteristic>& characteristics,
            NDBatchCompletion completion);
  void write(const NDUUID& home, std::vector<NDCharacteristicWriteRequestTuple> writes,
             NDBatchCompletion completion);
  void execute(const NDUUID& home, const NDUUID& actionSet, NDExecuteCompletion completion);

 private:
  struct CurrentHome;

  [[nodiscard]] CurrentHome findHome(const NDUUID& home) const;
  void observe(const PlatformCall& call) const;
  void runScene(const NDUUID& home, const NDUUID& actionSet, NDExecuteCompletion completion) const;

  const Parts parts_;
  NDSerialQueue calls_;
};

}  // namespace nidus
