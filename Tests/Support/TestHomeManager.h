#pragma once

#include <memory>
#include <utility>

#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A home manager that reports its homes when it is told to. Used by one thread.
class TestHomeManager final : public NDHomeManager,
                              public std::enable_shared_from_this<TestHomeManager> {
 public:
  explicit TestHomeManager(NDArray<NDHome> homes) : homes_(std::move(homes)) {}

  /// From now on the homes are reported to each new delegate before anybody could ask for them.
  void reportEarly() { reportsEarly_ = true; }

  [[nodiscard]] NDArray<NDHome> homes() const override { return homes_; }
  void setHomes(NDArray<NDHome> homes) { homes_ = std::move(homes); }

  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) override {
    delegate_ = std::move(delegate);
    if (reportsEarly_) report();
  }
  [[nodiscard]] std::shared_ptr<NDHomeManagerDelegate> delegate() const { return delegate_.lock(); }

  /// Tells the delegate, if it is still there, on the calling thread.
  void report() {
    if (const auto heard = delegate()) heard->homeManagerDidUpdateHomes(shared_from_this());
  }
  /// Tells it on the calling thread as soon as the delivery may start.
  void reportPromptly() {
    NDDeliveryHold::whenReleased([self = weak_from_this()] {
      if (const auto manager = self.lock()) manager->report();
    });
  }
  /// Tells it through `queue`, once the delivery may start.
  void reportOn(std::shared_ptr<NDQueue> queue) {
    NDDeliveryHold::whenReleased([queue = std::move(queue), self = weak_from_this()] {
      queue->async([self] {
        if (const auto manager = self.lock()) manager->report();
      });
    });
  }

 private:
  NDArray<NDHome> homes_;
  std::weak_ptr<NDHomeManagerDelegate> delegate_;
  bool reportsEarly_ = false;
};

}  // namespace nidus
